# Buses, parameters, presets and editor: sources for the test in CMakeLists.txt.
set(ZEB_VST_IO_TESTS
    VSTParameterInfoTest.cpp
    VSTSpeakerArrangementTest.cpp)
