# Tests of the filter against plug-ins inside the test.
zeb_add_test(vst3_filter_test
    SOURCES
        FakeComponent.cpp
        FakeController.cpp
        FakePlugin.cpp
        FilterEditorTest.cpp
        FilterHostServicesTest.cpp
        FilterIOConfigurationTest.cpp
        FilterLifecycleTest.cpp
        FilterParametersTest.cpp
        FilterProcessingTest.cpp
        FilterStateTest.cpp
        FilterThreadsTest.cpp
        IndexWalkTest.cpp
        RunLoopTest.cpp
        SpeakerArrangementsTest.cpp
    UP_TO zeb_vst3)
