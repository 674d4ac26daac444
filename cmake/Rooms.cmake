# Each room of the source tree is one static library; includes are written from the root, so
# that every include line names the room it reaches into.

# The presets compile several files of a target as one, in a fraction of the time.

# sensor_profile_room(NAME [COLD] [FUZZED] [PARSES_OPTIONS] SOURCES ...
#                     [USES public libraries ...] [PRIVATELY private libraries ...])
# A COLD room is not optimised in Debug builds: under sanitizers that takes half of the compiler's
# time, and tests spend hardly any in such a room. A FUZZED room is compiled with the counters that
# guide its fuzz target. A room that PARSES_OPTIONS of the command line is hardly optimised: the
# templates for that take longest of all and run once.
function(sensor_profile_room name)
  cmake_parse_arguments(
    room "COLD;FUZZED;PARSES_OPTIONS" "" "SOURCES;USES;PRIVATELY" ${ARGN})
  add_library(${name} STATIC ${room_SOURCES})
  target_include_directories(${name} PUBLIC "${PROJECT_SOURCE_DIR}")
  target_link_libraries(${name} PUBLIC ${room_USES} PRIVATE ${room_PRIVATELY})
  if(room_FUZZED AND SENSOR_PROFILE_FUZZ)
    target_compile_options(${name} PRIVATE -fsanitize=fuzzer-no-link)
  endif()
  if(room_COLD OR room_PARSES_OPTIONS)
    target_compile_options(${name} PRIVATE $<$<CONFIG:Debug>:-O0>)
  endif()
  if(room_PARSES_OPTIONS)
    target_compile_options(${name} PRIVATE $<$<CONFIG:Release>:-O1>)
  endif()
endfunction()

# sensor_profile_test(NAME [SINGLE_THREADED] SOURCES ... [THREADED sources ...]
#                     USES libraries ... [ENVIRONMENT variables ...] [SHARDS number])
# Adds one GoogleTest executable and registers it with CTest. The test framework's headers, which take
# most of the time of each test file, are compiled once and shared. The thread sanitizer has nothing
# to find in SINGLE_THREADED tests, so that it does without them; where some SOURCES are THREADED, it
# takes only these. With SHARDS, CTest runs so many parts of the tests side by side.
function(sensor_profile_test name)
  cmake_parse_arguments(
    test "SINGLE_THREADED" "SHARDS" "SOURCES;THREADED;USES;ENVIRONMENT" ${ARGN})
  if(test_THREADED AND SENSOR_PROFILE_SANITIZE MATCHES "thread")
    set(test_SOURCES ${test_THREADED})
  endif()
  sensor_profile_test_executable(${name} ${test_SOURCES})
  target_precompile_headers(${name} REUSE_FROM test_headers)
  target_link_libraries(${name} PRIVATE ${test_USES} support_log)
  if(test_SINGLE_THREADED AND SENSOR_PROFILE_SANITIZE MATCHES "thread")
    set_target_properties(${name} PROPERTIES EXCLUDE_FROM_ALL TRUE)
    return()
  endif()
  # The settings of the environment must not reach the tests.
  set(environment VORN_INSTRUMENTATION= RYNLOG_LOG=off RYNLOG_TRACE=off LC_ALL=C.UTF-8
    ${test_ENVIRONMENT})
  if(NOT test_SHARDS)
    set(test_SHARDS 1)
  endif()
  math(EXPR last "${test_SHARDS} - 1")
  foreach(index RANGE ${last})
    set(part ${name})
    if(index GREATER 0)
      set(part ${name}_shard_${index})
    endif()
    add_test(NAME ${part} COMMAND ${name})
    set_tests_properties(${part} PROPERTIES
      ENVIRONMENT "${environment};GTEST_TOTAL_SHARDS=${test_SHARDS};GTEST_SHARD_INDEX=${index}"
      # The end of the output where cases were skipped and none failed.
      SKIP_REGULAR_EXPRESSION "  SKIPPED [^\n]*\n$"
      TIMEOUT 300)
  endforeach()
endfunction()

# Adds an executable with the definitions of all tests, which their precompiled headers need, too.
function(sensor_profile_test_executable name)
  add_executable(${name} ${ARGN})
  target_include_directories(${name} PRIVATE "${PROJECT_SOURCE_DIR}")
  target_link_libraries(${name} PRIVATE GTest::gmock GTest::gtest_main)
  target_compile_definitions(${name} PRIVATE
    SENSOR_PROFILE_SOURCE_DIR="${PROJECT_SOURCE_DIR}"
    SENSOR_PROFILE_BINARY_DIR="${PROJECT_BINARY_DIR}")
endfunction()
