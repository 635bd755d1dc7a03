/// \file
/// What tests of the log share.
#ifndef MVLOG_TESTS_LOGGERTEST_H
#define MVLOG_TESTS_LOGGERTEST_H

#include <MVLog/MVLogger.h>

#include "testing/Environment.h"
#include "testing/TemporaryDirectory.h"

#include <cstdio>
#include <cstdlib>
#include <functional>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

inline void log(int level, const std::string& text, const std::string& category = "Mavrel.Test")
{
    MVLog::MVLogger::logLevelMessage("function", "File.cpp", 12, category, level, nullptr, 0, 0, text);
}

inline void trace(int level, const std::string& text, const std::string& category = "Mavrel.Test")
{
    MVLog::MVLogger::traceLevelMessage("function", "File.cpp", 12, category, level, nullptr, 0, 0, text);
}

inline std::vector<std::string> linesOf(const std::string& text)
{
    std::istringstream stream(text);
    std::vector<std::string> lines;
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}

class LoggerTest : public testing::Test
{
protected:
    /// What a process of its own writes to standard error until it has ended well. The log reads its
    /// settings once in a process, so every test that logs does so in a child.
    static std::vector<std::string> standardErrorOf(const std::function<void()>& work)
    {
        const Testing::TemporaryDirectory directory;
        const std::string file = directory.path("stderr");
        std::fflush(nullptr);
        const pid_t child = fork();
        if (child == 0) {
            if (std::freopen(file.c_str(), "a", stderr) == nullptr)
                _exit(99);
            work();
            std::exit(testing::Test::HasFailure() ? 98 : 0);
        }
        int status = -1;
        EXPECT_EQ(waitpid(child, &status, 0), child);
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << status << Testing::contentOf(file);
        return linesOf(Testing::contentOf(file));
    }

    [[nodiscard]] std::vector<std::string> linesIn(const std::string& name) const
    {
        return linesOf(Testing::contentOf(directory.path(name)));
    }

    Testing::TemporaryDirectory directory;
    Testing::Environment level{"MVLOG_LEVEL", std::nullopt};
    Testing::Environment output{"MVLOG_OUTPUT", std::nullopt};
    Testing::Environment file{"MVLOG_FILE", std::nullopt};
    Testing::Environment traceLevel{"MVLOG_TRACE_LEVEL", std::nullopt};
    Testing::Environment traceOutput{"MVLOG_TRACE_OUTPUT", std::nullopt};
    Testing::Environment categories{"MVLOG_CATEGORIES", std::nullopt};
};

#endif
