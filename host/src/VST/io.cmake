# Buses, parameters, presets and editor of the filter: sources for the layer in CMakeLists.txt.
set(ZEB_VST_IO_SOURCES
    src/VSTParameterInfo.cpp
    src/VSTSpeakerArrangement.cpp)
