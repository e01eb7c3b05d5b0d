# Life, audio and host callback of the filter: sources for the test in CMakeLists.txt.
set(ZEB_VST_FILTER_TESTS
    VSTAudioFilterTest.cpp
    VSTAutomationTest.cpp
    VSTFilterDescriptorTest.cpp
    VSTFilterThreadsTest.cpp
    VSTHandlersTest.cpp
    VSTHostCallbackTest.cpp
    VSTProcessingTest.cpp
    VSTTimeInfoTest.cpp)

# A plug-in's questions under the guard of the process thread.
zeb_add_test(vst_process_path_test UP_TO zeb_vst
    SOURCES VSTProcessPathTest.cpp LIBRARIES zeb_realtime_guard)

# The fixtures' binaries as filters.
zeb_add_test(vst_filter_fixtures_test UP_TO zeb_vst
    SOURCES VSTFilterFixturesTest.cpp)
zeb_use_vst2_fixtures(vst_filter_fixtures_test)
