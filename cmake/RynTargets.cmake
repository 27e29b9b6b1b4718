# How the project's libraries are declared.
#
# ryn_folder(NAME [SHARED_CORE] SOURCES ... [USES ...] [LINKS ...])
#   one folder under src/, one library target ryn_NAME. USES names the folders whose headers it may
#   include (tools/check_layers.py holds the same table and reads the #includes against it); LINKS
#   are private outside libraries. SHARED_CORE puts the folder into the one shared library `ryncore`,
#   so that each type and each static exists once in a process.

add_library(ryn_options INTERFACE)
target_compile_options(
    ryn_options INTERFACE -Wall -Wextra -Wpedantic -Wconversion -Wshadow -Wnon-virtual-dtor
                          -Woverloaded-virtual -Werror)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
    # g++ 12 sees overlapping copies in plain concatenations of strings (its bug 105651).
    target_compile_options(ryn_options INTERFACE -Wno-restrict)
endif()
target_include_directories(ryn_options INTERFACE ${CMAKE_SOURCE_DIR}/src)
if(RYN_SANITIZE)
    target_compile_options(
        ryn_options INTERFACE -fsanitize=address,undefined -fno-sanitize-recover=undefined
                              -fno-omit-frame-pointer)
    if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
        # Instrumented code hides from g++ what the plain build, which has this warning, sees.
        target_compile_options(ryn_options INTERFACE -Wno-maybe-uninitialized)
    endif()
    target_link_options(ryn_options INTERFACE -fsanitize=address,undefined)
endif()
if(RYN_FUZZ)
    target_compile_options(ryn_options INTERFACE -fsanitize=fuzzer-no-link,address,undefined
                                                 -fno-sanitize-recover=undefined)
    target_link_options(ryn_options INTERFACE -fsanitize=address,undefined)
endif()

set_property(GLOBAL PROPERTY RYN_CORE_FOLDERS "")
set_property(GLOBAL PROPERTY RYN_FOLDERS "")

function(ryn_folder name)
    cmake_parse_arguments(ARG "SHARED_CORE" "" "SOURCES;USES;LINKS" ${ARGN})
    set_property(GLOBAL APPEND PROPERTY RYN_FOLDERS ${name})
    if(ARG_SHARED_CORE)
        add_library(ryn_${name} OBJECT ${ARG_SOURCES})
        set_property(GLOBAL APPEND PROPERTY RYN_CORE_FOLDERS ${name})
        set_property(GLOBAL APPEND PROPERTY RYN_CORE_LINKS ${ARG_LINKS})
        target_link_libraries(ryn_${name} PUBLIC ryn_options)
    else()
        add_library(ryn_${name} STATIC ${ARG_SOURCES})
        target_link_libraries(ryn_${name} PUBLIC ryn_options ryncore)
        foreach(used IN LISTS ARG_USES)
            if(NOT TARGET ryn_${used})
                continue()
            endif()
            get_target_property(kind ryn_${used} TYPE)
            if(kind STREQUAL "STATIC_LIBRARY")
                target_link_libraries(ryn_${name} PUBLIC ryn_${used})
            endif()
        endforeach()
    endif()
    target_link_libraries(ryn_${name} PRIVATE ${ARG_LINKS})
endfunction()

# The shared library of the folders declared with SHARED_CORE; called once, after the last of them.
function(ryn_core_library)
    get_property(folders GLOBAL PROPERTY RYN_CORE_FOLDERS)
    get_property(links GLOBAL PROPERTY RYN_CORE_LINKS)
    list(REMOVE_DUPLICATES links)
    set(objects "")
    foreach(folder IN LISTS folders)
        list(APPEND objects $<TARGET_OBJECTS:ryn_${folder}>)
    endforeach()
    add_library(ryncore SHARED ${objects})
    target_link_libraries(ryncore PUBLIC ryn_options fmt::fmt PRIVATE ${links})
    if(NOT RYN_SANITIZE AND NOT RYN_FUZZ)
        target_link_options(ryncore PRIVATE -Wl,--no-undefined)
    endif()
    install(TARGETS ryncore LIBRARY DESTINATION lib)
endfunction()

# For every program: what its sanitizer build needs besides.
function(ryn_program name)
    if(RYN_SANITIZE)
        target_sources(${name} PRIVATE ${CMAKE_SOURCE_DIR}/tests/support/leak_suppressions.cpp)
    endif()
endfunction()
