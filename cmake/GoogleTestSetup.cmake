# GoogleTest: Debian's library where it fits the build, else compiled from /usr/src/googletest
# (another word size, or sanitizers that want every part instrumented).

if(NOT BUILD_TESTING)
  return()
endif()

if(CMAKE_SIZEOF_VOID_P EQUAL 8 AND NOT COMMONPROVIDER_SANITIZE)
  find_package(GTest REQUIRED)
else()
  set(INSTALL_GTEST OFF)
  add_subdirectory(/usr/src/googletest "${CMAKE_BINARY_DIR}/googletest" EXCLUDE_FROM_ALL SYSTEM)
endif()
include(GoogleTest)

# commonprovider_test(NAME SOURCES file... LIBRARIES target...): one GoogleTest program.
function(commonprovider_test name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  add_executable(${name} ${ARG_SOURCES})
  target_link_libraries(${name} PRIVATE project_options ${ARG_LIBRARIES} GTest::gtest_main GTest::gmock)
  target_precompile_headers(${name} PRIVATE
    "$<$<COMPILE_LANGUAGE:CXX>:<gmock/gmock.h$<ANGLE-R>>"
    "$<$<COMPILE_LANGUAGE:CXX>:<gtest/gtest.h$<ANGLE-R>>")
  gtest_discover_tests(${name} TEST_PREFIX "${name}." DISCOVERY_TIMEOUT 60 PROPERTIES TIMEOUT 120)
endfunction()
