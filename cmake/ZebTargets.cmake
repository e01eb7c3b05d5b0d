# The targets of the library: one object library per layer, the shared library made of all of them, and tests that
# link the layers they are about. Object libraries keep every static initializer, which registration depends on.

find_package(Boost 1.74 REQUIRED)
find_package(Threads REQUIRED)
find_package(EXPAT REQUIRED)

set_property(GLOBAL PROPERTY ZEB_LAYERS "")

# Warnings, sanitizers and definitions that all of our own targets share.
add_library(zeb_options INTERFACE)
target_compile_options(zeb_options INTERFACE
    -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wsign-conversion -Wnon-virtual-dtor -Wold-style-cast
    -Woverloaded-virtual $<$<BOOL:${ZEB_WARNINGS_AS_ERRORS}>:-Werror>)
# g++ 12 sees overlaps, overflows and bounds broken in its own std::string once it inlines
# operator+ (GCC bugs 105329 and 105651).
target_compile_options(zeb_options INTERFACE
    $<$<AND:$<CXX_COMPILER_ID:GNU>,$<CONFIG:Release>>:-Wno-restrict;-Wno-stringop-overflow;-Wno-array-bounds>)
# Sources of like flags are compiled as one text there, which takes a third of the time. What only neighbours cause is
# no fault; the other presets compile each source alone, under all warnings.
if(CMAKE_UNITY_BUILD)
    set(CMAKE_UNITY_BUILD_BATCH_SIZE 0) # All of a target: which sources are neighbours does not change with another file
    target_compile_options(zeb_options INTERFACE
        -Wno-shadow $<$<CXX_COMPILER_ID:GNU>:-Wno-subobject-linkage>)
endif()

# zeb_compile_alone(SOURCES...): for sources with private names that a neighbour has too, which a sanitizer's build then
# calls a redefinition.
function(zeb_compile_alone)
    set_source_files_properties(${ARGN} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
endfunction()

if(ZEB_SANITIZE)
    add_compile_options(-fsanitize=${ZEB_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all
        -g1) # Lines are all that a report needs
    add_link_options(-fsanitize=${ZEB_SANITIZE})
    if(ZEB_SANITIZE MATCHES undefined)
        add_compile_options(-fno-sanitize=vptr) # A plug-in's objects keep to a binary interface, not to our types
        add_link_options(-fno-sanitize=vptr)
    endif()
endif()

# Boost and the standard library, compiled once for all layers.
file(GENERATE OUTPUT ${PROJECT_BINARY_DIR}/precompiled.cpp CONTENT "// Carries the precompiled header.\n")
add_library(zeb_precompiled OBJECT ${PROJECT_BINARY_DIR}/precompiled.cpp)
target_compile_options(zeb_precompiled PRIVATE -Winvalid-pch)
target_link_libraries(zeb_precompiled PRIVATE zeb_options Boost::boost Threads::Threads)
target_precompile_headers(zeb_precompiled PRIVATE ${PROJECT_SOURCE_DIR}/cmake/Precompiled.h)

# The same for tests, with GoogleTest.
if(ZEB_BUILD_TESTS)
    find_package(GTest REQUIRED)
    file(GENERATE OUTPUT ${PROJECT_BINARY_DIR}/precompiled_test.cpp CONTENT "int main() {}\n")
    add_executable(zeb_test_precompiled EXCLUDE_FROM_ALL ${PROJECT_BINARY_DIR}/precompiled_test.cpp)
    target_link_libraries(zeb_test_precompiled PRIVATE zeb_options Boost::boost Threads::Threads GTest::gmock)
    target_precompile_headers(zeb_test_precompiled PRIVATE
        ${PROJECT_SOURCE_DIR}/cmake/Precompiled.h <gmock/gmock.h> <gtest/gtest.h>)
endif()

# zeb_add_layer(NAME SOURCES ... PUBLIC_HEADERS ... DEPENDS ... LIBRARIES ...)
#   PUBLIC_HEADERS  installed, and compiled alone by the header check
#   DEPENDS         layers below
#   LIBRARIES       outside libraries, private to the layer
function(zeb_add_layer name)
    cmake_parse_arguments(arg "" "" "SOURCES;PUBLIC_HEADERS;DEPENDS;LIBRARIES" ${ARGN})
    add_library(${name} OBJECT ${arg_SOURCES})
    target_link_libraries(${name} PUBLIC ${arg_DEPENDS} Boost::boost Threads::Threads PRIVATE zeb_options ${arg_LIBRARIES})
    target_include_directories(${name} PUBLIC $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}>)
    target_precompile_headers(${name} REUSE_FROM zeb_precompiled)
    set(other_language ${arg_SOURCES})
    list(FILTER other_language INCLUDE REGEX "\\.mm$")
    if(other_language)
        set_source_files_properties(${other_language} PROPERTIES SKIP_PRECOMPILE_HEADERS ON) # It is C++
    endif()
    target_sources(${name} PUBLIC FILE_SET HEADERS BASE_DIRS ${PROJECT_SOURCE_DIR} FILES ${arg_PUBLIC_HEADERS})
    set_property(TARGET ${name} PROPERTY ZEB_LIBRARIES "${arg_LIBRARIES}")
    set_property(GLOBAL APPEND PROPERTY ZEB_LAYERS ${name})
endfunction()

function(zeb_add_shared_library)
    get_property(layers GLOBAL PROPERTY ZEB_LAYERS)
    file(GENERATE OUTPUT ${PROJECT_BINARY_DIR}/shared.cpp CONTENT "// The library is made of its layers.\n")
    add_library(zebaudiofilterhost SHARED ${PROJECT_BINARY_DIR}/shared.cpp)
    add_library(zebaudiofilterhost::zebaudiofilterhost ALIAS zebaudiofilterhost)
    set_target_properties(zebaudiofilterhost PROPERTIES
        VERSION ${PROJECT_VERSION} SOVERSION ${PROJECT_VERSION_MAJOR}.${PROJECT_VERSION_MINOR})
    foreach(layer IN LISTS layers)
        get_target_property(libraries ${layer} ZEB_LIBRARIES)
        get_target_property(headers ${layer} HEADER_SET)
        target_link_libraries(zebaudiofilterhost PRIVATE $<BUILD_INTERFACE:${layer}> ${libraries})
        target_sources(zebaudiofilterhost PUBLIC FILE_SET HEADERS BASE_DIRS ${PROJECT_SOURCE_DIR} FILES ${headers})
    endforeach()
    target_include_directories(zebaudiofilterhost PUBLIC
        $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}> $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}/zebaudiofilterhost>)
    target_link_libraries(zebaudiofilterhost PUBLIC Boost::boost Threads::Threads)
    target_compile_features(zebaudiofilterhost PUBLIC cxx_std_20)
    if(NOT APPLE)
        target_link_options(zebaudiofilterhost PRIVATE LINKER:--exclude-libs,ALL
            LINKER:--version-script=${PROJECT_SOURCE_DIR}/cmake/zebaudiofilterhost.map)
        set_property(TARGET zebaudiofilterhost APPEND PROPERTY LINK_DEPENDS
            ${PROJECT_SOURCE_DIR}/cmake/zebaudiofilterhost.map)
    endif()
endfunction()

# zeb_link_layers(NAME UP_TO): links every layer from the lowest up to UP_TO.
function(zeb_link_layers name up_to)
    get_property(layers GLOBAL PROPERTY ZEB_LAYERS)
    foreach(layer IN LISTS layers)
        get_target_property(libraries ${layer} ZEB_LIBRARIES)
        target_link_libraries(${name} PRIVATE ${layer} ${libraries})
        if(layer STREQUAL up_to)
            break()
        endif()
    endforeach()
endfunction()

# zeb_add_test(NAME SOURCES ... UP_TO layer [LIBRARIES ...] [NEEDS targets...] [DEFINITIONS ...] [LABELS ...])
#   Links every layer from the lowest up to UP_TO, so that a test reaches internal classes.
function(zeb_add_test name)
    cmake_parse_arguments(arg "" "UP_TO" "SOURCES;LIBRARIES;NEEDS;DEFINITIONS;LABELS" ${ARGN})
    add_executable(${name} ${arg_SOURCES})
    target_precompile_headers(${name} REUSE_FROM zeb_test_precompiled)
    target_link_libraries(${name} PRIVATE zeb_options)
    zeb_link_layers(${name} ${arg_UP_TO})
    target_link_libraries(${name} PRIVATE GTest::gtest_main GTest::gmock ${arg_LIBRARIES})
    target_compile_definitions(${name} PRIVATE ${arg_DEFINITIONS})
    if(arg_NEEDS)
        add_dependencies(${name} ${arg_NEEDS})
    endif()
    add_test(NAME ${name} COMMAND ${name})
    set_tests_properties(${name} PROPERTIES LABELS "${arg_LABELS}")
endfunction()
