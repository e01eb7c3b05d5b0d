# Life, audio and host callback of the filter: sources for the test in CMakeLists.txt.
set(ZEB_VST_FILTER_TESTS
    VSTAudioFilterTest.cpp
    VSTFilterDescriptorTest.cpp
    VSTFilterThreadsTest.cpp
    VSTHandlersTest.cpp
    VSTHostCallbackTest.cpp
    VSTProcessingTest.cpp
    VSTTimeInfoTest.cpp)
