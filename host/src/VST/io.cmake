# Buses, parameters, presets and editor of the filter: sources for the layer in CMakeLists.txt.
set(ZEB_VST_IO_SOURCES
    src/VSTAudioFilterEditor.cpp
    src/VSTCustomEditor.cpp
    src/VSTIOConfiguration.cpp
    src/VSTParameterInfo.cpp
    src/VSTParameters.cpp
    src/VSTPresets.cpp
    src/VSTSpeakerArrangement.cpp)
