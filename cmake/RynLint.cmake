# Target `lint`: formatting, clang-tidy over every source, and the order of the folders.
find_program(CLANG_FORMAT clang-format-14 REQUIRED)
find_program(RUN_CLANG_TIDY run-clang-tidy-14 REQUIRED)
find_program(CLANG_TIDY clang-tidy-14 REQUIRED)

file(GLOB_RECURSE lint_sources CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/src/*.cpp
     ${CMAKE_SOURCE_DIR}/tests/*.cpp ${CMAKE_SOURCE_DIR}/bench/*.cpp ${CMAKE_SOURCE_DIR}/fuzz/*.cpp)
file(GLOB_RECURSE lint_headers CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/src/*.h
     ${CMAKE_SOURCE_DIR}/tests/*.h)

add_custom_target(
    lint
    COMMAND ${CLANG_FORMAT} --dry-run --Werror ${lint_sources} ${lint_headers}
    COMMAND ${CMAKE_SOURCE_DIR}/tools/check_layers.py ${CMAKE_SOURCE_DIR}
    COMMAND ${RUN_CLANG_TIDY} -quiet -clang-tidy-binary ${CLANG_TIDY} -p ${CMAKE_BINARY_DIR}
            "${CMAKE_SOURCE_DIR}/src/.*"
    WORKING_DIRECTORY ${CMAKE_SOURCE_DIR}
    VERBATIM)
