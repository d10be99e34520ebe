# One library per folder of src/, one test program per folder of tests/, all with the same warnings.

add_library(vespscope_options INTERFACE)
target_include_directories(vespscope_options INTERFACE ${CMAKE_SOURCE_DIR}/src)
target_compile_options(vespscope_options INTERFACE -Wall -Wextra -Wconversion -Wshadow -Wnon-virtual-dtor -fno-omit-frame-pointer
                       -ffile-prefix-map=${CMAKE_SOURCE_DIR}/=)
# -Wrestrict of GCC 12 reports copies that std::string's operator+ never makes (GCC bug 105651).
target_compile_options(vespscope_options INTERFACE $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>)
target_compile_definitions(vespscope_options INTERFACE $<$<CONFIG:Debug>:_GLIBCXX_ASSERTIONS>)
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
  target_compile_options(vespscope_options INTERFACE --coverage)
  target_link_options(vespscope_options INTERFACE --coverage)
endif()

# vespscope_layer(NAME [USES layer…]): the library of this folder. A layer includes only what it uses, directly or
# through what it uses; header-only folders become interface libraries.
function(vespscope_layer name)
  cmake_parse_arguments(LAYER "" "" "USES" ${ARGN})
  file(GLOB sources CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/*.cpp)
  if(sources)
    add_library(${name} STATIC ${sources})
    target_link_libraries(${name} PUBLIC vespscope_options ${LAYER_USES})
  else()
    add_library(${name} INTERFACE)
    target_link_libraries(${name} INTERFACE vespscope_options ${LAYER_USES})
  endif()
endfunction()

# vespscope_tests(NAME USES layer…): the test program of this folder, each test run in a process of its own.
function(vespscope_tests name)
  cmake_parse_arguments(TESTS "" "" "USES" ${ARGN})
  file(GLOB sources CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/*.cpp)
  if(NOT sources)
    return()
  endif()
  add_executable(${name} ${sources})
  target_include_directories(${name} PRIVATE ${CMAKE_SOURCE_DIR}/tests)
  if(VESPSCOPE_SANITIZE)
    # What is under test is optimised a little; the tests themselves are compiled twice as fast without.
    target_compile_options(${name} PRIVATE -O0)
  endif()
  target_link_libraries(${name} PRIVATE vespscope_options ${TESTS_USES} GTest::gmock_main)
  target_compile_definitions(${name} PRIVATE VESPSCOPE_SOURCE_DIR="${CMAKE_SOURCE_DIR}"
                             VESPSCOPE_BIN_DIR="${CMAKE_RUNTIME_OUTPUT_DIRECTORY}")
  gtest_discover_tests(${name} DISCOVERY_MODE PRE_TEST DISCOVERY_TIMEOUT 60 TEST_PREFIX ${name}. PROPERTIES TIMEOUT 300)
endfunction()

# vespscope_program(NAME SOURCES file… USES layer…): a program in bin/, part of the target `programs`.
add_custom_target(programs)
function(vespscope_program name)
  cmake_parse_arguments(PROGRAM "" "" "SOURCES;USES" ${ARGN})
  add_executable(${name} ${PROGRAM_SOURCES})
  target_link_libraries(${name} PRIVATE vespscope_options ${PROGRAM_USES})
  add_dependencies(programs ${name})
endfunction()
