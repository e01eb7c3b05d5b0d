# zeb_audio_unit(TARGET SOURCES ... TYPE aufx SUBTYPE gain NAME "Maker: Name" FACTORY function [BUNDLE name]
#                [MANUFACTURER zebx] [FOLDER components] [LIBRARIES ...] [DEFINITIONS ...])
#   A real bundle: <build>/FOLDER/BUNDLE.component with Contents/Info.plist and Contents/<arch>-linux/BUNDLE.so; on
#   macOS Contents/MacOS/BUNDLE. Without BUNDLE it is called like the target. Names of the interface stay open in it: it
#   finds them in the process that loads it.
function(zeb_audio_unit name)
    cmake_parse_arguments(arg "" "BUNDLE;FOLDER;TYPE;SUBTYPE;MANUFACTURER;NAME;FACTORY" "SOURCES;LIBRARIES;DEFINITIONS"
        ${ARGN})
    foreach(default IN ITEMS BUNDLE=${name} FOLDER=components MANUFACTURER=zebx)
        string(REPLACE "=" ";" default ${default})
        list(POP_FRONT default key)
        if(NOT arg_${key})
            set(arg_${key} ${default})
        endif()
    endforeach()
    set(bundle ${PROJECT_BINARY_DIR}/${arg_FOLDER}/${arg_BUNDLE}.component)
    add_library(${name} MODULE ${arg_SOURCES})
    target_link_libraries(${name} PRIVATE zeb_options ${arg_LIBRARIES})
    target_compile_definitions(${name} PRIVATE ${arg_DEFINITIONS})
    set_target_properties(${name} PROPERTIES PREFIX "" OUTPUT_NAME ${arg_BUNDLE})
    configure_file(${PROJECT_SOURCE_DIR}/cmake/ComponentInfo.plist.in ${bundle}/Contents/Info.plist @ONLY)
    if(APPLE)
        target_link_libraries(${name} PRIVATE "-framework AudioToolbox" "-framework CoreFoundation")
        set_target_properties(${name} PROPERTIES SUFFIX "" LIBRARY_OUTPUT_DIRECTORY ${bundle}/Contents/MacOS)
    else()
        target_link_libraries(${name} PRIVATE zeb_audio_unit_interface)
        set_target_properties(${name} PROPERTIES
            LIBRARY_OUTPUT_DIRECTORY ${bundle}/Contents/${CMAKE_SYSTEM_PROCESSOR}-linux)
    endif()
endfunction()
