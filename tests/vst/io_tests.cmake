# Buses, parameters, presets and editor: sources for the test in CMakeLists.txt.
set(ZEB_VST_IO_TESTS
    VSTAudioFilterEditorTest.cpp
    VSTIOConfigurationTest.cpp
    VSTParameterInfoTest.cpp
    VSTPresetsTest.cpp
    VSTSpeakerArrangementTest.cpp)
