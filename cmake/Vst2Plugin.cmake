# zeb_vst2_plugin(TARGET SOURCES ... [TITLE name] [FOLDER vst2|vst2fixtures|vst2hazards] [LAYOUT bundle|plain|flat|suffixed]
#                 [LIBRARIES ...] [DEFINITIONS ...])
#   A real VST 2 plug-in. Without TITLE it is called like the target. Layouts on Linux:
#     bundle    <build>/FOLDER/TITLE.vst/Contents/<arch>-linux/TITLE.so
#     plain     <build>/FOLDER/TITLE.so
#     flat      <build>/FOLDER/TITLE.vst/TITLE.so
#     suffixed  <build>/FOLDER/TITLE.vst/TITLE-vst.so
#   macOS knows bundles only, with the binary in Contents/MacOS/TITLE.
function(zeb_vst2_plugin name)
    cmake_parse_arguments(arg "" "TITLE;FOLDER;LAYOUT" "SOURCES;LIBRARIES;DEFINITIONS" ${ARGN})
    if(NOT arg_FOLDER)
        set(arg_FOLDER vst2)
    endif()
    if(NOT arg_TITLE)
        set(arg_TITLE ${name})
    endif()
    if(NOT arg_LAYOUT)
        set(arg_LAYOUT bundle)
    endif()
    add_library(${name} MODULE ${arg_SOURCES})
    target_link_libraries(${name} PRIVATE zeb_options Threads::Threads ${arg_LIBRARIES})
    target_include_directories(${name} PRIVATE ${PROJECT_SOURCE_DIR})
    target_compile_definitions(${name} PRIVATE ${arg_DEFINITIONS})
    set_target_properties(${name} PROPERTIES PREFIX "" OUTPUT_NAME ${arg_TITLE})
    set(folder ${PROJECT_BINARY_DIR}/${arg_FOLDER})
    if(APPLE)
        set_target_properties(${name} PROPERTIES
            BUNDLE TRUE BUNDLE_EXTENSION vst
            MACOSX_BUNDLE_INFO_PLIST ${PROJECT_SOURCE_DIR}/cmake/EffectInfo.plist.in
            MACOSX_BUNDLE_GUI_IDENTIFIER org.zeb.examples.${arg_TITLE}
            LIBRARY_OUTPUT_DIRECTORY ${folder})
        return()
    endif()
    if(arg_LAYOUT STREQUAL bundle)
        string(APPEND folder /${arg_TITLE}.vst/Contents/${CMAKE_SYSTEM_PROCESSOR}-linux)
    elseif(NOT arg_LAYOUT STREQUAL plain)
        string(APPEND folder /${arg_TITLE}.vst)
    endif()
    if(arg_LAYOUT STREQUAL suffixed)
        set_target_properties(${name} PROPERTIES OUTPUT_NAME ${arg_TITLE}-vst)
    endif()
    target_link_options(${name} PRIVATE LINKER:--exclude-libs,ALL)
    set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${folder})
endfunction()
