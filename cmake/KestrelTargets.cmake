# The functions that the folders of this project build their targets with.

include(${CMAKE_CURRENT_LIST_DIR}/KestrelPlugin.cmake)

# The headers say the version too, for the plug-ins that are built with them.
file(STRINGS ${PROJECT_SOURCE_DIR}/kestrel/platform/Export.h plugin_version REGEX "define KESTREL_PLUGIN_VERSION")
if(NOT plugin_version MATCHES "\"${PROJECT_VERSION_MAJOR}\\.${PROJECT_VERSION_MINOR}\"")
  message(FATAL_ERROR "KESTREL_PLUGIN_VERSION in kestrel/platform/Export.h is not the project's version")
endif()

# kestrel_place_program(TARGET FOLDER) puts a program into a folder of the build tree; on Windows, where a program finds
# its libraries beside it and nowhere else, all lie together.
function(kestrel_place_program target folder)
  if(NOT WIN32)
    set_target_properties(${target} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/${folder})
  endif()
endfunction()

# kestrel_add_test(ROOM [COUNTS_ALLOCATIONS] SOURCE... [LIBRARIES LIBRARY...]) builds one GoogleTest program for a room and
# registers it. The programs find test data under KESTREL_SOURCE_DIR and built files under KESTREL_BINARY_DIR. One that
# counts allocations can ask tests/support/AllocationCount.h and tests that it is told of them.
function(kestrel_add_test room)
  cmake_parse_arguments(PARSE_ARGV 1 TEST "COUNTS_ALLOCATIONS" "" "LIBRARIES")
  set(target test_${room})
  add_executable(${target} ${TEST_UNPARSED_ARGUMENTS} ${KESTREL_TEST_SETTINGS})
  if(TEST_COUNTS_ALLOCATIONS)
    set(count ${PROJECT_SOURCE_DIR}/tests/support/AllocationCount)
    target_sources(${target} PRIVATE ${count}$<$<BOOL:${WIN32}>:_windows>.cpp ${count}Test.cpp)
  endif()
  target_link_libraries(${target} PRIVATE kestrel::kestrel XercesC::XercesC GTest::gtest GTest::gtest_main Threads::Threads
    ${TEST_LIBRARIES})
  target_include_directories(${target} PRIVATE ${PROJECT_SOURCE_DIR})
  target_compile_definitions(${target} PRIVATE
    KESTREL_SOURCE_DIR="${PROJECT_SOURCE_DIR}" KESTREL_BINARY_DIR="${PROJECT_BINARY_DIR}")
  kestrel_place_program(${target} tests)
  # Some systems look for libraries in the current folder, where none of ours must lie.
  add_test(NAME ${room} COMMAND ${target} WORKING_DIRECTORY ${PROJECT_BINARY_DIR})
  kestrel_set_test_environment(${room})
endfunction()

# The address sanitizer opens libraries on the program's behalf, so the core's own run path is not asked there: the
# loader has to be told where the plug-ins are.
function(kestrel_set_test_environment test)
  if(KESTREL_SANITIZE)
    set_tests_properties(${test} PROPERTIES ENVIRONMENT
      "LD_LIBRARY_PATH=${PROJECT_BINARY_DIR}/lib:${PROJECT_BINARY_DIR}/lib/kestrel/plugins;ASAN_OPTIONS=detect_leaks=1;UBSAN_OPTIONS=print_stacktrace=1")
  endif()
endfunction()

# kestrel_find_plugins_in(TEST FOLDER) lets a test find the model libraries in a folder of the build tree. Where the
# system asks the loader's own paths first, as on Linux, before the real ones.
function(kestrel_find_plugins_in test folder)
  if(NOT WIN32)
    set(change LD_LIBRARY_PATH=path_list_prepend:${PROJECT_BINARY_DIR}/${folder})
  elseif(CMAKE_CROSSCOMPILING)
    set(change WINEPATH=set:${PROJECT_BINARY_DIR}/${folder})
  else()
    set(change PATH=path_list_prepend:${PROJECT_BINARY_DIR}/${folder})
  endif()
  set_property(TEST ${test} APPEND PROPERTY ENVIRONMENT_MODIFICATION ${change})
endfunction()
