# The filter and its editor: sources for the layer in CMakeLists.txt.
set(ZEB_VST3_FILTER_SOURCES
    src/SpeakerArrangements.cpp
    src/VST3AudioFilter.cpp
    src/VST3AudioFilterEditor.cpp
    src/VST3ComponentHandler.cpp
    src/VST3FactoryPresets.cpp
    src/VST3HostServices.cpp
    src/VST3IOConfiguration.cpp
    src/VST3ParameterInfo.cpp
    src/VST3Parameters.cpp
    src/VST3Processing.cpp
    src/VST3State.cpp
    src/VST3Suspension.cpp)
if(APPLE)
    enable_language(OBJCXX)
    list(APPEND ZEB_VST3_FILTER_SOURCES src/mac/HostRunLoop.cpp src/mac/PlatformView.mm)
else()
    list(APPEND ZEB_VST3_FILTER_SOURCES
        src/linux/HostRunLoop.cpp
        src/linux/PlatformView.cpp
        src/linux/RunLoop.cpp)
endif()

# Its loops run over a handful of buses and channels, where vector code costs more to set up than it saves.
set_source_files_properties(src/VST3Processing.cpp PROPERTIES
    COMPILE_OPTIONS "-fno-tree-vectorize;-fno-semantic-interposition")
