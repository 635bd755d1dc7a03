# What every program of tests is built with: link against glimmark::test-settings. Its tests become ctest's by
# glimmark_add_tests_of().

if(GLIMMARK_LIBCXX)
    # The package googletest has the sources.
    set(INSTALL_GTEST OFF)
    add_subdirectory(/usr/src/googletest ${CMAKE_CURRENT_BINARY_DIR}/googletest EXCLUDE_FROM_ALL)
    message(WARNING "Left out with libc++: the tests of properties, as RapidCheck is compiled with the other standard library; "
                    "floor-tests, *.SharedObject and ProviderLibrary.IsBuiltAsBrokersNeedIt, as they know that one's names")
else()
    find_package(GTest 1.12 REQUIRED)
    find_package(rapidcheck REQUIRED)
endif()

add_library(glimmark_test_settings INTERFACE)
add_library(glimmark::test-settings ALIAS glimmark_test_settings)
add_library(glimmark_compiled_together INTERFACE)
cmake_path(GET CMAKE_CURRENT_LIST_DIR PARENT_PATH checkout)
target_include_directories(glimmark_test_settings INTERFACE ${checkout})
target_link_libraries(glimmark_test_settings INTERFACE glimmark::settings glimmark_compiled_together GTest::gmock)

# Optimising a test takes three times as long as compiling it and shows nothing: what it tests stays as shipped. Debug
# information is for the preset debug; a failed test says its line itself.
target_compile_options(glimmark_test_settings INTERFACE -O0 $<$<CONFIG:RelWithDebInfo>:-g0>)

# Under the address sanitizer the tests themselves are not watched, only what they test: that takes a third of the time.
if(GLIMMARK_SANITIZE MATCHES "address")
    target_compile_options(glimmark_test_settings INTERFACE -fno-sanitize=all -g0)
endif()

# Where the files of a program are compiled together, they see each other's names. The preset asan compiles each on its
# own, and holds what is not held here.
if(CMAKE_UNITY_BUILD)
    target_compile_options(glimmark_compiled_together INTERFACE -Wno-shadow)
endif()

# The test framework's headers, compiled once for all programs of tests. All of these are compiled as libraries are
# (-fPIC), as what is compiled before must be compiled alike.
target_compile_options(glimmark_test_settings INTERFACE -fPIC)
add_library(test-headers OBJECT ${CMAKE_CURRENT_LIST_DIR}/Empty.cpp)
target_link_libraries(test-headers PRIVATE glimmark::test-settings)
target_precompile_headers(
    test-headers
    PRIVATE
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

# glimmark_add_tests_of(PROGRAM [THREADS] [ALONE TEST...])
#   THREADS: some of them run several threads
#   ALONE: these are skipped beside others, and run in a process of their own, too
#
# The program's tests as two of ctest's, half of them each, so that two run at a time. A process for each test would
# take as long to start as most tests take to run. ./test NAME runs single ones.
function(glimmark_add_tests_of program)
    cmake_parse_arguments(PARSE_ARGV 1 of "THREADS" "" "ALONE")
    target_precompile_headers(${program} REUSE_FROM test-headers)
    set(labels)
    if(of_THREADS)
        list(APPEND labels threads)
        add_dependencies(threads ${program})
    endif()
    foreach(half IN ITEMS 0 1)
        add_test(NAME ${program}.${half} COMMAND ${program} --gtest_brief=1)
        set_tests_properties(${program}.${half} PROPERTIES ENVIRONMENT "GTEST_TOTAL_SHARDS=2;GTEST_SHARD_INDEX=${half}"
                                                           LABELS "${labels}")
    endforeach()
    foreach(test IN LISTS of_ALONE)
        add_test(NAME ${test} COMMAND ${program} --gtest_brief=1 --gtest_filter=${test})
        set_tests_properties(${test} PROPERTIES LABELS "${labels}")
    endforeach()
endfunction()
