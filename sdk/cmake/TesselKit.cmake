# Tests without a host, with GoogleTest, once find_package(Tessel) has found the SDK:
#
# tessel_add_unit_test(NAME source...)
#   A program of tests that runs on the recording host: the whole SDK in memory, which answers as it is told and remembers
#   what it was asked (tests/support/RecordingHost.h). The sources of the module are among those of the program.
# tessel_add_contract_tests(NAME source...)
#   What every host must do, run over one: the sources define its startHost() (tests/contract/HostUnderTest.h).
#
# Both become tests of ctest.
include("${CMAKE_CURRENT_LIST_DIR}/TesselKitSources.cmake")

# What both are made of, when it is first needed.
function(tessel_make_recording_values)
  if(NOT TARGET tessel_recording_values)
    add_library(tessel_recording_values STATIC EXCLUDE_FROM_ALL
      "${TESSEL_KIT}/tests/support/recording/RecordingValue.cpp")
    target_include_directories(tessel_recording_values PUBLIC "${TESSEL_KIT}")
    target_link_libraries(tessel_recording_values PUBLIC Tessel::sdk)
  endif()
endfunction()

function(tessel_make_recording_host)
  if(TARGET tessel_recording_host)
    return()
  endif()
  tessel_make_recording_values()
  list(TRANSFORM TESSEL_RECORDING_SOURCES PREPEND "${TESSEL_KIT}/" OUTPUT_VARIABLE sources)
  list(REMOVE_ITEM sources "${TESSEL_KIT}/tests/support/recording/RecordingValue.cpp")
  tessel_count_result_buffers("${TESSEL_KIT}")
  add_library(tessel_recording_host STATIC EXCLUDE_FROM_ALL ${sources})
  set_target_properties(tessel_recording_host PROPERTIES UNITY_BUILD ON)
  target_link_libraries(tessel_recording_host PUBLIC tessel_recording_values PRIVATE ICU::uc)
endfunction()

# In the calling function, and for it.
macro(tessel_find_test_libraries)
  find_package(GTest REQUIRED)
  find_package(ICU REQUIRED COMPONENTS uc)
  include(GoogleTest)
endmacro()

function(tessel_add_unit_test name)
  tessel_find_test_libraries()
  tessel_make_recording_host()
  list(TRANSFORM TESSEL_RECORDING_PROGRAM_SOURCES PREPEND "${TESSEL_KIT}/" OUTPUT_VARIABLE sources)
  add_executable(${name} ${ARGN} ${sources})
  target_compile_definitions(${name} PRIVATE RECORDING_HOST_REMOVES_TS_LISP=true)
  target_link_libraries(${name} PRIVATE tessel_recording_host GTest::gmock_main)
  gtest_discover_tests(${name} TEST_PREFIX "${name}.")
endfunction()

function(tessel_add_contract_tests name)
  tessel_find_test_libraries()
  list(TRANSFORM TESSEL_CONTRACT_SOURCES PREPEND "${TESSEL_KIT}/" OUTPUT_VARIABLE sources)
  tessel_make_recording_values()
  add_executable(${name} ${ARGN} ${sources})
  set_target_properties(${name} PROPERTIES UNITY_BUILD ON UNITY_BUILD_BATCH_SIZE 16)
  set_source_files_properties(${ARGN} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
  target_compile_options(${name} PRIVATE $<$<CXX_COMPILER_ID:GNU>:-Wno-subobject-linkage>)
  target_link_libraries(${name} PRIVATE tessel_recording_values GTest::gmock_main)
  gtest_discover_tests(${name} TEST_PREFIX "${name}.")
endfunction()
