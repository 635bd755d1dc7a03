#include "Settings.h"

#include <map>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using MVLog::Output;
using MVLog::Settings;
using testing::IsEmpty;

Settings settingsFrom(const std::map<std::string, std::string>& environment)
{
    return MVLog::readSettings([&](const char* name) {
        const auto found = environment.find(name);
        return found == environment.end() ? nullptr : found->second.c_str();
    });
}

TEST(Settings, withoutVariablesAreErrorsOnStandardError)
{
    const Settings settings = settingsFrom({});
    EXPECT_EQ(settings.log.leastLevel, 6000);
    EXPECT_EQ(settings.trace.leastLevel, MVLog::off);
    EXPECT_EQ(settings.log.output.kind, Output::standardError);
    EXPECT_EQ(settings.trace.output.kind, Output::standardError);
    EXPECT_THAT(settings.categories, IsEmpty());
    EXPECT_THAT(settings.complaints, IsEmpty());
}

TEST(Settings, daemonsHaveTheSocketsOfTheSystem)
{
    const Settings settings = settingsFrom({{"MVLOG_OUTPUT", "syslog"}, {"MVLOG_TRACE_OUTPUT", "journal"}});
    EXPECT_EQ(settings.log.output.kind, Output::syslog);
    EXPECT_EQ(settings.log.output.path, "/dev/log");
    EXPECT_EQ(settings.trace.output.kind, Output::journal);
    EXPECT_EQ(settings.trace.output.path, "/run/systemd/journal/socket");
}

TEST(Settings, pathsMayHaveColonsAndCommas)
{
    EXPECT_EQ(settingsFrom({{"MVLOG_OUTPUT", "file:/a:b,c"}}).log.output.path, "/a:b,c");
}

TEST(Settings, aBadOutputOfTheTraceLeavesThatOfTheLog)
{
    const Settings settings = settingsFrom({{"MVLOG_FILE", "/a"}, {"MVLOG_TRACE_OUTPUT", "printer"}});
    EXPECT_EQ(settings.trace.output.kind, Output::file);
    EXPECT_EQ(settings.trace.output.path, "/a");
    EXPECT_EQ(settings.complaints.size(), 1U);
}

} // namespace
