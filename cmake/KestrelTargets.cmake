# The functions that the folders of this project build their targets with.

# kestrel_add_plugin(TAG SOURCE...) builds the model library of one model element: tag + "800r" + the system's suffix.
function(kestrel_add_plugin tag)
  set(target plugin_${tag})
  add_library(${target} MODULE ${ARGN})
  set_target_properties(${target} PROPERTIES
    PREFIX ""
    OUTPUT_NAME ${tag}800r
    LIBRARY_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/lib/kestrel/plugins
    BUILD_WITH_INSTALL_RPATH ON
    INSTALL_RPATH "$ORIGIN/../..")
  target_link_libraries(${target} PRIVATE kestrel::kestrel XercesC::XercesC)
  install(TARGETS ${target} LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}/kestrel/plugins)
endfunction()

# kestrel_add_test(ROOM SOURCE... [LIBRARIES LIBRARY...]) builds one GoogleTest program for a room and registers it.
# The programs find test data under KESTREL_SOURCE_DIR and built files under KESTREL_BINARY_DIR.
function(kestrel_add_test room)
  cmake_parse_arguments(PARSE_ARGV 1 TEST "" "" "LIBRARIES")
  set(target test_${room})
  add_executable(${target} ${TEST_UNPARSED_ARGUMENTS})
  target_link_libraries(${target} PRIVATE kestrel::kestrel XercesC::XercesC GTest::gtest GTest::gtest_main Threads::Threads
    ${TEST_LIBRARIES})
  target_include_directories(${target} PRIVATE ${PROJECT_SOURCE_DIR})
  target_compile_definitions(${target} PRIVATE
    KESTREL_SOURCE_DIR="${PROJECT_SOURCE_DIR}" KESTREL_BINARY_DIR="${PROJECT_BINARY_DIR}")
  set_target_properties(${target} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/tests)
  add_test(NAME ${room} COMMAND ${target})
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
