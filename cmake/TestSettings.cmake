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

# What the preset tsan builds, and runs by the label of the same name: where one thread is all there is, the thread
# sanitizer has nothing to find.
add_custom_target(threads)

# glimmark_add_tests_of(EXECUTABLE [THREADS] [TEST_PREFIX PREFIX] [NO_PRETTY_VALUES])
#   THREADS: some of them run several threads
#
# Each test of the executable as one of ctest's, in a process of its own. A sanitizer takes longer to start a process
# than most tests take: there the executable runs as a whole, in as many processes as there are jobs.
function(glimmark_add_tests_of executable)
    cmake_parse_arguments(PARSE_ARGV 1 of "THREADS" "" "")
    set(labels)
    if(of_THREADS)
        set(labels LABELS threads)
        add_dependencies(threads ${executable})
    endif()
    if(NOT GLIMMARK_SANITIZE)
        gtest_discover_tests(${executable} DISCOVERY_TIMEOUT 60 ${of_UNPARSED_ARGUMENTS} PROPERTIES ${labels})
        return()
    endif()
    foreach(part IN ITEMS 0 1)
        add_test(NAME ${executable}.${part} COMMAND ${executable} --gtest_brief=1)
        set_tests_properties(${executable}.${part} PROPERTIES ENVIRONMENT "GTEST_TOTAL_SHARDS=2;GTEST_SHARD_INDEX=${part}"
                                                              ${labels})
    endforeach()
endfunction()
