# What every executable of tests is built with: link against glimmark::test-settings. Its tests become ctest's by
# glimmark_add_tests_of().

find_package(GTest 1.12 REQUIRED)
include(GoogleTest)

add_library(glimmark_test_settings INTERFACE)
add_library(glimmark::test-settings ALIAS glimmark_test_settings)
target_link_libraries(glimmark_test_settings INTERFACE glimmark::settings GTest::gmock)

# Optimising a test takes three times as long as compiling it and shows nothing: what it tests stays as shipped.
target_compile_options(glimmark_test_settings INTERFACE -O0)

target_precompile_headers(
    glimmark_test_settings
    INTERFACE
    <gmock/gmock.h>
    <gtest/gtest.h>
    <map>
    <memory>
    <sstream>
    <string>
    <vector>)

# glimmark_add_tests_of(EXECUTABLE [TEST_PREFIX PREFIX] [NO_PRETTY_VALUES])
#
# Each test of the executable as one of ctest's, in a process of its own. A sanitizer takes longer to start a process
# than most tests take: there the executable runs as a whole, in as many processes as there are jobs.
function(glimmark_add_tests_of executable)
    if(NOT GLIMMARK_SANITIZE)
        gtest_discover_tests(${executable} DISCOVERY_TIMEOUT 60 ${ARGN})
        return()
    endif()
    foreach(part IN ITEMS 0 1)
        add_test(NAME ${executable}.${part} COMMAND ${executable} --gtest_brief=1)
        set_tests_properties(${executable}.${part} PROPERTIES ENVIRONMENT
                                                              "GTEST_TOTAL_SHARDS=2;GTEST_SHARD_INDEX=${part}")
    endforeach()
endfunction()
