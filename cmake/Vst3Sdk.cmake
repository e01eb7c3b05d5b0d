# The VST 3 SDK as a quarantined target: system includes, static, hidden, linked into the VST 3 layer only. It is a
# copy of its own in the library and in each plug-in, so none of its symbols may be exported.

set(VST3_SDK_ROOT "/usr/share/juce/modules/juce_audio_processors/format_types/VST3_SDK" CACHE PATH
    "Folder of the VST 3 SDK, 3.7.2 or newer, that holds pluginterfaces/ and base/")
if(NOT EXISTS ${VST3_SDK_ROOT}/pluginterfaces/base/funknown.h)
    message(FATAL_ERROR "No VST 3 SDK in ${VST3_SDK_ROOT}: install juce-modules-source-data, or give -DVST3_SDK_ROOT=")
endif()

add_library(zeb_vst3_sdk STATIC EXCLUDE_FROM_ALL
    ${VST3_SDK_ROOT}/pluginterfaces/base/coreiids.cpp
    ${VST3_SDK_ROOT}/pluginterfaces/base/funknown.cpp
    ${VST3_SDK_ROOT}/pluginterfaces/base/ustring.cpp
    ${VST3_SDK_ROOT}/base/source/baseiids.cpp
    ${VST3_SDK_ROOT}/base/source/fobject.cpp
    ${VST3_SDK_ROOT}/base/source/fstring.cpp
    ${VST3_SDK_ROOT}/base/thread/source/flock.cpp
    ${VST3_SDK_ROOT}/public.sdk/source/vst/vstinitiids.cpp
    ${PROJECT_SOURCE_DIR}/host/src/VST3/src/VST3InterfaceIDs.cpp)
target_include_directories(zeb_vst3_sdk SYSTEM PUBLIC ${VST3_SDK_ROOT})
target_compile_definitions(zeb_vst3_sdk PUBLIC RELEASE=1)
set_property(TARGET zeb_vst3_sdk PROPERTY UNITY_BUILD OFF) # It defines by macros what a neighbour defines too
# The SDK's interfaces have no virtual destructor, and nobody deletes through them.
target_compile_options(zeb_vst3_sdk PRIVATE -w INTERFACE -Wno-non-virtual-dtor)
if(APPLE)
    target_link_libraries(zeb_vst3_sdk PUBLIC "-framework CoreFoundation")
endif()

# zeb_vst3_plugin(TARGET SOURCES ... [BUNDLE name] [FOLDER vst3|fixtures|hazards] [LIBRARIES ...] [DEFINITIONS ...])
#   A real bundle: <build>/FOLDER/BUNDLE.vst3/Contents/<arch>-linux/BUNDLE.so; on macOS Contents/MacOS/BUNDLE. Without
#   BUNDLE it is called like the target.
function(zeb_vst3_plugin name)
    cmake_parse_arguments(arg "" "BUNDLE;FOLDER" "SOURCES;LIBRARIES;DEFINITIONS" ${ARGN})
    if(NOT arg_FOLDER)
        set(arg_FOLDER vst3)
    endif()
    if(NOT arg_BUNDLE)
        set(arg_BUNDLE ${name})
    endif()
    add_library(${name} MODULE ${arg_SOURCES})
    target_link_libraries(${name} PRIVATE zeb_options zeb_vst3_sdk Threads::Threads ${arg_LIBRARIES})
    target_compile_definitions(${name} PRIVATE ${arg_DEFINITIONS})
    set_target_properties(${name} PROPERTIES PREFIX "" OUTPUT_NAME ${arg_BUNDLE})
    if(APPLE)
        set_target_properties(${name} PROPERTIES BUNDLE TRUE BUNDLE_EXTENSION vst3
            MACOSX_BUNDLE_INFO_PLIST ${PROJECT_SOURCE_DIR}/cmake/EffectInfo.plist.in
            MACOSX_BUNDLE_GUI_IDENTIFIER org.zeb.examples.${arg_BUNDLE}
            LIBRARY_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/${arg_FOLDER})
    else()
        target_link_options(${name} PRIVATE LINKER:--exclude-libs,ALL)
        set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY
            ${PROJECT_BINARY_DIR}/${arg_FOLDER}/${arg_BUNDLE}.vst3/Contents/${CMAKE_SYSTEM_PROCESSOR}-linux)
    endif()
endfunction()
