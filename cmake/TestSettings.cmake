# What every executable of tests is built with: link against glimmark::test-settings.

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
