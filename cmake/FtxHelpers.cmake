# Shared helpers for the project's targets. Every folder lists its sources by glob so
# that adding a file never needs a second edit elsewhere.

# ftx_glob(VAR dir...): the .c/.cpp files directly inside each dir.
function(ftx_glob var)
  set(out)
  foreach(d ${ARGN})
    file(GLOB f CONFIGURE_DEPENDS ${d}/*.c ${d}/*.cpp)
    list(APPEND out ${f})
  endforeach()
  set(${var} ${out} PARENT_SCOPE)
endfunction()

# ftx_add_gtest(NAME SOURCES ... LIBS ...): one GoogleTest executable registered with CTest.
function(ftx_add_gtest name)
  cmake_parse_arguments(A "" "" "SOURCES;LIBS" ${ARGN})
  add_executable(${name} ${A_SOURCES} ${PROJECT_SOURCE_DIR}/tests/support/test_env.cpp)
  target_compile_definitions(${name} PRIVATE FTX_TEST_SOURCE_DIR="${PROJECT_SOURCE_DIR}"
    FTX_TEST_BUILD_DIR="${CMAKE_BINARY_DIR}")
  target_link_libraries(${name} PRIVATE ${A_LIBS} GTest::gtest GTest::gtest_main GTest::gmock Threads::Threads)
  target_include_directories(${name} PRIVATE ${PROJECT_SOURCE_DIR}/tests)
  set_target_properties(${name} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/tests)
  gtest_discover_tests(${name} DISCOVERY_MODE PRE_TEST)
endfunction()

# ftx_add_fuzz(NAME SOURCES ... LIBS ... INCLUDES ...): a libFuzzer target (fuzz builds only).
function(ftx_add_fuzz name)
  cmake_parse_arguments(A "" "" "SOURCES;LIBS;INCLUDES" ${ARGN})
  add_executable(${name} ${A_SOURCES})
  target_link_libraries(${name} PRIVATE ${A_LIBS} Threads::Threads)
  target_include_directories(${name} PRIVATE ${A_INCLUDES})
  target_link_options(${name} PRIVATE -fsanitize=fuzzer,address,undefined)
  set_target_properties(${name} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/fuzz)
  set_property(GLOBAL APPEND PROPERTY FTX_FUZZ_TARGETS ${name})
endfunction()

# ftx_add_bench(NAME SOURCES ... LIBS ...): a benchmark program run by `./ftx bench`.
function(ftx_add_bench name)
  cmake_parse_arguments(A "" "" "SOURCES;LIBS" ${ARGN})
  add_executable(${name} ${A_SOURCES})
  target_link_libraries(${name} PRIVATE ${A_LIBS} Threads::Threads)
  set_target_properties(${name} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bench)
endfunction()

# ftx_add_device_bench(name source): a benchmark that starts the real ftx-mmi headless
# through the tests' device support (bench/support for its process figures).
function(ftx_add_device_bench name source)
  ftx_add_bench(${name} SOURCES ${source} ${PROJECT_SOURCE_DIR}/tests/support/device_under_test.cpp)
  target_include_directories(${name} PRIVATE ${PROJECT_SOURCE_DIR}/tests ${PROJECT_SOURCE_DIR}/bench)
  target_compile_definitions(${name} PRIVATE FTX_BENCH_SOURCE_DIR="${PROJECT_SOURCE_DIR}"
    FTX_BENCH_BUILD_DIR="${CMAKE_BINARY_DIR}")
endfunction()

# ftx_subdirs(dir): add every direct subfolder of dir that has a CMakeLists.txt.
function(ftx_subdirs dir)
  file(GLOB children CONFIGURE_DEPENDS ${dir}/*/CMakeLists.txt)
  list(SORT children)
  foreach(c ${children})
    get_filename_component(d ${c} DIRECTORY)
    add_subdirectory(${d})
  endforeach()
endfunction()
