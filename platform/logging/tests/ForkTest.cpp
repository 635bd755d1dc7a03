// A child that was forked while other threads logged can log.

#include "LoggerTest.h"

#include "testing/ForkUnderLoad.h"

#include <regex>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <unistd.h>

namespace {

using testing::SizeIs;

constexpr int children = 300;

using Fork = LoggerTest;

void logUnderLoad()
{
    if (!Testing::childrenMayAllocate)
        GTEST_SKIP() << "the sanitizer's allocator is not made for it";
    EXPECT_EQ(Testing::childrenThatReturn(children, [] { log(6000, "text"); }), children);
}

TEST_F(Fork, childrenWriteToTheFile)
{
    file.set(directory.path("log"));
    standardErrorOf(logUnderLoad);
}

TEST_F(Fork, childrenWriteToStandardError)
{
    standardErrorOf(logUnderLoad);
}

TEST_F(Fork, aChildLogsItsOwnProcessAndThread)
{
    const std::vector<std::string> lines = standardErrorOf([] {
        log(6000, "from the parent");
        const pid_t child = fork();
        if (child == 0) {
            log(6000, "from the child");
            _exit(0);
        }
        waitpid(child, nullptr, 0);
    });
    const std::regex ofTheFirstThread(R"(.* \[([0-9]+):\1\] .*)");
    ASSERT_THAT(lines, SizeIs(2));
    for (const std::string& line : lines)
        EXPECT_TRUE(std::regex_match(line, ofTheFirstThread)) << line;
}

} // namespace
