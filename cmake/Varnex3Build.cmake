# How every target of the project is compiled: one place for the language level, warnings and sanitizers.
set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_POSITION_INDEPENDENT_CODE ON) # the same objects go into the static and the shared library
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
if(NOT CMAKE_BUILD_TYPE AND NOT CMAKE_CONFIGURATION_TYPES)
    set(CMAKE_BUILD_TYPE Release)
endif()

add_library(varnex3_build INTERFACE)
target_include_directories(varnex3_build INTERFACE ${PROJECT_SOURCE_DIR})
target_compile_options(varnex3_build INTERFACE
    -Wall -Wextra -Wpedantic -Wconversion -Wsign-conversion -Wnon-virtual-dtor -Wold-style-cast
    -Wcast-align -Woverloaded-virtual
    $<$<CXX_COMPILER_ID:GNU>:-fno-semantic-interposition> # nobody replaces our functions: they may be inlined
    $<$<CXX_COMPILER_ID:GNU>:-Wshadow=local>
    $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict> # false alarms of g++ 12 on u"literal" + text
    $<$<CXX_COMPILER_ID:Clang>:-Wshadow>)
if(VARNEX3_WERROR)
    target_compile_options(varnex3_build INTERFACE -Werror)
endif()
if(VARNEX3_SANITIZE)
    add_compile_options(-fsanitize=address,undefined -fno-sanitize-recover=all -fno-omit-frame-pointer)
    add_link_options(-fsanitize=address,undefined)
endif()

# A library of headers alone. For another system than this one its folder is shown by itself: the folder that it stands in
# has this system's headers, too.
function(varnex3_find_headers target package version folder)
    if(NOT CMAKE_CROSSCOMPILING)
        find_package(${package} ${version} REQUIRED GLOBAL)
        return()
    endif()
    find_path(${package}_FOLDER ${folder} PATHS /usr/include NO_DEFAULT_PATH NO_CMAKE_FIND_ROOT_PATH REQUIRED)
    file(MAKE_DIRECTORY ${PROJECT_BINARY_DIR}/headers)
    file(CREATE_LINK ${${package}_FOLDER}/${folder} ${PROJECT_BINARY_DIR}/headers/${folder} SYMBOLIC)
    add_library(${target} INTERFACE IMPORTED GLOBAL)
    target_include_directories(${target} SYSTEM INTERFACE ${PROJECT_BINARY_DIR}/headers)
endfunction()

# A layer of the library: its objects, compiled with nothing but the layers below it on the link line, so that a
# dependency that points up does not link.
function(varnex3_layer name)
    varnex3_substitute(${name} ${ARGN})
    set_property(GLOBAL APPEND PROPERTY VARNEX3_LAYERS varnex3_${name})
endfunction()

# Objects that programs may link beside a layer or in its place; the library itself does not have them.
function(varnex3_substitute name)
    cmake_parse_arguments(ARG "" "" "SOURCES;USES" ${ARGN})
    add_library(varnex3_${name} OBJECT ${ARG_SOURCES})
    target_link_libraries(varnex3_${name} PRIVATE varnex3_build)
    set(objects varnex3_${name})
    foreach(used IN LISTS ARG_USES)
        get_property(below GLOBAL PROPERTY VARNEX3_OBJECTS_${used})
        list(APPEND objects ${below})
    endforeach()
    list(REMOVE_DUPLICATES objects)
    set_property(GLOBAL PROPERTY VARNEX3_OBJECTS_${name} ${objects})
endfunction()

# Links a program with one layer and what lies below it, and with nothing above it.
function(varnex3_link_layer target layer)
    get_property(objects GLOBAL PROPERTY VARNEX3_OBJECTS_${layer})
    target_link_libraries(${target} PRIVATE varnex3_build ${objects})
endfunction()
