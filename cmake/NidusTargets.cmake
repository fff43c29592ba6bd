# What every target of the project has in common.

find_package(Threads REQUIRED)
# Paths below the checkout count as relative, so that all checkouts share one cache.
find_program(NIDUS_CCACHE ccache)
if(NIDUS_CCACHE)
  set(CMAKE_CXX_COMPILER_LAUNCHER
    ${CMAKE_COMMAND} -E env CCACHE_BASEDIR=${PROJECT_SOURCE_DIR} CCACHE_NOHASHDIR=1 ${NIDUS_CCACHE})
endif()

set(NIDUS_SANITIZE "" CACHE STRING "Sanitizers of all targets, such as address,undefined")
option(NIDUS_WERROR "Treat warnings as errors" OFF)

# The programs lie beside their libraries as they will when installed, so that a build tree works
# the way an installation does.
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/bin)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/lib)
set(CMAKE_ARCHIVE_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/lib)
set(NIDUS_MODULE_DIRECTORY ${PROJECT_BINARY_DIR}/lib/nidus)

add_library(NidusOptions INTERFACE)
target_compile_options(NidusOptions INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wconversion
  $<$<BOOL:${NIDUS_WERROR}>:-Werror>
  # g++ 12 sees overlapping copies in sums of texts where there are none, once it optimises.
  $<$<AND:$<CONFIG:Release>,$<CXX_COMPILER_ID:GNU>,$<VERSION_LESS:$<CXX_COMPILER_VERSION>,13>>:-Wno-restrict>
  $<$<CXX_COMPILER_ID:Clang>:-Wthread-safety>)
target_link_libraries(NidusOptions INTERFACE NidusHardening Threads::Threads)
if(NIDUS_SANITIZE)
  target_compile_options(NidusOptions INTERFACE
    -fsanitize=${NIDUS_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
  target_link_options(NidusOptions INTERFACE -fsanitize=${NIDUS_SANITIZE})
endif()

# nidus_library(NAME STATIC|SHARED [BUT SOURCES...]): a library of all sources and headers of the
# current folder and those below it, but the sources named. Headers are included as
# "NAME-OF-FOLDER/Header.h" and stand on their own.
function(nidus_library name kind)
  file(GLOB_RECURSE sources CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/*.cpp)
  file(GLOB_RECURSE headers CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/*.h)
  cmake_parse_arguments(PARSE_ARGV 2 library "" "" BUT)
  list(TRANSFORM library_BUT PREPEND ${CMAKE_CURRENT_SOURCE_DIR}/)
  list(REMOVE_ITEM sources ${library_BUT})
  add_library(${name} ${kind} ${sources})
  target_sources(${name} PUBLIC FILE_SET HEADERS
    BASE_DIRS ${PROJECT_SOURCE_DIR}/Sources FILES ${headers})
  target_link_libraries(${name} PRIVATE NidusOptions)
endfunction()

# nidus_test(NAME [LIBRARIES...]): a GoogleTest program of all sources of the current folder and
# those below it; every test becomes a test of CTest. Some machines, such as bare containers, have no
# pseudo-terminals: the tests that need one are then skipped, not failed.
function(nidus_test name)
  file(GLOB_RECURSE sources CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/*.cpp)
  add_executable(${name} ${sources})
  target_include_directories(${name} PRIVATE ${PROJECT_SOURCE_DIR}/Tests)
  target_link_libraries(${name} PRIVATE NidusOptions ${ARGN} GTest::gmock GTest::gtest_main)
  gtest_discover_tests(${name} DISCOVERY_MODE PRE_TEST PROPERTIES
    SKIP_REGULAR_EXPRESSION "\\[  SKIPPED \\]|this machine has no pseudo-terminals")
endfunction()
