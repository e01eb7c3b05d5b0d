# Life, audio and host callback of the filter: sources for the layer in CMakeLists.txt.
set(ZEB_VST_FILTER_SOURCES
    src/AudioMasterHandlerMap.cpp
    src/VSTAudioFilter.cpp
    src/VSTHostCallback.cpp
    src/VSTParameterSetting.cpp
    src/VSTPins.cpp
    src/VSTProcessing.cpp
    src/VSTSuspension.cpp
    src/VSTTimeInfo.cpp)
