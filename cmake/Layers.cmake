# One library per folder of src/, one test program per folder of tests/, all with the same warnings.

add_library(vespscope_options INTERFACE)
target_include_directories(vespscope_options INTERFACE ${CMAKE_SOURCE_DIR}/src)
target_compile_options(vespscope_options INTERFACE -Wall -Wextra -Wconversion -Wshadow -Wnon-virtual-dtor -fno-omit-frame-pointer
                       -ffile-prefix-map=${CMAKE_SOURCE_DIR}/=)
# -Wrestrict of GCC 12 reports copies that std::string's operator+ never makes (GCC bug 105651).
target_compile_options(vespscope_options INTERFACE $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>)
target_compile_definitions(vespscope_options INTERFACE $<$<CONFIG:Debug>:_GLIBCXX_ASSERTIONS>)
include(Hardening)
find_package(Threads REQUIRED)
target_link_libraries(vespscope_options INTERFACE Threads::Threads)
if(VESPSCOPE_SANITIZE)
  target_compile_options(vespscope_options INTERFACE -fsanitize=${VESPSCOPE_SANITIZE} -fno-sanitize-recover=all)
  target_link_options(vespscope_options INTERFACE -fsanitize=${VESPSCOPE_SANITIZE})
endif()
if(VESPSCOPE_FUZZ)
  target_compile_options(vespscope_options INTERFACE -fsanitize=fuzzer-no-link)
endif()
if(VESPSCOPE_COVERAGE)
  # Counts branches as the source writes them. The counters are a mapped file, so that killed processes count as well.
  target_compile_options(vespscope_options INTERFACE -fprofile-instr-generate -fcoverage-mapping
                         "SHELL:-mllvm -runtime-counter-relocation")
  target_link_options(vespscope_options INTERFACE -fprofile-instr-generate)
endif()

# Precompiles what most files include: a full build takes half the time. In the default build only the tests use it, so
# that a program's file with a missing include does not compile.
function(vespscope_precompiled name)
  file(WRITE ${CMAKE_BINARY_DIR}/${name}.cpp "")
  add_library(${name} OBJECT ${CMAKE_BINARY_DIR}/${name}.cpp)
  target_link_libraries(${name} PRIVATE vespscope_options)
  target_precompile_headers(${name} PRIVATE ${ARGN})
endfunction()
set(standard_headers
    <algorithm> <array> <atomic> <charconv> <chrono> <condition_variable> <cstdint> <deque> <filesystem> <fstream>
    <functional> <map> <memory> <mutex> <optional> <set> <span> <sstream> <string> <string_view> <thread> <tuple>
    <utility> <variant> <vector>)
if(VESPSCOPE_PRECOMPILED)
  vespscope_precompiled(precompiled ${standard_headers})
endif()
# The code under test is fully optimised; optimising the tests themselves would take longer than it saves.
set(test_options $<$<CONFIG:Release>:-O0> $<$<CONFIG:Release>:-U_FORTIFY_SOURCE>)
if(VESPSCOPE_TESTS)
  vespscope_precompiled(precompiled_tests ${standard_headers} <gmock/gmock.h> <gtest/gtest.h>)
  target_compile_options(precompiled_tests PRIVATE ${test_options})
  target_link_libraries(precompiled_tests PRIVATE GTest::gmock)
endif()

# vespscope_reuse(NAME FROM): lets a target use the precompiled headers, if there are any.
function(vespscope_reuse name from)
  if(TARGET ${from})
    target_precompile_headers(${name} REUSE_FROM ${from})
  endif()
endfunction()

# vespscope_layer(NAME [HOT] [USES layer…]): the library of this folder. A layer includes only what it uses, directly or
# through what it uses; header-only folders become interface libraries. A HOT layer runs for every field of every event
# and omits the checks that cost instructions there.
function(vespscope_layer name)
  cmake_parse_arguments(LAYER "HOT" "" "USES" ${ARGN})
  file(GLOB sources CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/*.cpp)
  if(sources)
    add_library(${name} STATIC ${sources})
    target_link_libraries(${name} PUBLIC vespscope_options ${LAYER_USES})
    if(NOT LAYER_HOT)
      vespscope_guard(${name})
    endif()
    vespscope_reuse(${name} precompiled)
  else()
    add_library(${name} INTERFACE)
    target_link_libraries(${name} INTERFACE vespscope_options ${LAYER_USES})
  endif()
endfunction()

# vespscope_tests(NAME [ALONE] [UNTHREADED] [QT] USES layer…): the test program of this folder. Each test runs in its own
# process; in sanitized or measured builds, whose programs start slowly, all tests run in one. ALONE: each test always has
# its own process, because the objects it uses live as long as the process. UNTHREADED: neither the tests nor what they
# test start a thread, so the thread sanitizer's build leaves them out. QT: compiled as the toolkit requires, which the
# precompiled headers are not.
function(vespscope_tests name)
  cmake_parse_arguments(TESTS "ALONE;UNTHREADED;QT" "" "USES" ${ARGN})
  file(GLOB sources CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/*.cpp)
  if(NOT sources OR (TESTS_UNTHREADED AND VESPSCOPE_SANITIZE STREQUAL "thread"))
    return()
  endif()
  add_executable(${name} ${sources})
  target_include_directories(${name} PRIVATE ${CMAKE_SOURCE_DIR}/tests)
  target_compile_options(${name} PRIVATE ${test_options})
  target_link_libraries(${name} PRIVATE vespscope_options ${TESTS_USES} GTest::gmock_main)
  if(NOT TESTS_QT)
    vespscope_reuse(${name} precompiled_tests)
  endif()
  target_compile_definitions(${name} PRIVATE VESPSCOPE_SOURCE_DIR="${CMAKE_SOURCE_DIR}"
                             VESPSCOPE_BIN_DIR="${CMAKE_RUNTIME_OUTPUT_DIRECTORY}")
  if(VESPSCOPE_TESTS_TOGETHER AND NOT TESTS_ALONE)
    add_test(NAME ${name} COMMAND ${name} --gtest_brief=1)
    set_tests_properties(${name} PROPERTIES TIMEOUT 900)
  else()
    gtest_discover_tests(${name} DISCOVERY_MODE PRE_TEST DISCOVERY_TIMEOUT 60 TEST_PREFIX ${name}. PROPERTIES TIMEOUT 300)
  endif()
endfunction()

# vespscope_program(NAME SOURCES file… USES layer…): a program in bin/, part of the target `programs`.
add_custom_target(programs)
function(vespscope_program name)
  cmake_parse_arguments(PROGRAM "" "" "SOURCES;USES" ${ARGN})
  add_executable(${name} ${PROGRAM_SOURCES})
  target_link_libraries(${name} PRIVATE vespscope_options ${PROGRAM_USES})
  vespscope_guard(${name})
  vespscope_reuse(${name} precompiled)
  add_dependencies(programs ${name})
endfunction()
