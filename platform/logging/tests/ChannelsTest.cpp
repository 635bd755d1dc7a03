// Which lines are written, and where.

#include "LoggerTest.h"

#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;

using Channels = LoggerTest;

/// What a trace point does.
void logAndTrace(int level, const std::string& text, const std::string& category = "Mavrel.Test")
{
    log(level, text, category);
    trace(level, text, category);
}

TEST_F(Channels, withoutSettingsAnErrorAppearsOnce)
{
    EXPECT_THAT(standardErrorOf([] {
                    logAndTrace(3000, "flow");
                    logAndTrace(6000, "error");
                }),
                ElementsAre(EndsWith(" log Mavrel.Test function() File.cpp:12: error")));
}

TEST_F(Channels, theLevelIsThatOfTheLog)
{
    level.set("3000");
    EXPECT_THAT(standardErrorOf([] { logAndTrace(3000, "flow"); }),
                ElementsAre(HasSubstr("] 3000 log Mavrel.Test ")));
}

TEST_F(Channels, theTraceHasALevelOfItsOwn)
{
    traceLevel.set("3000");
    EXPECT_THAT(
        standardErrorOf([] {
            logAndTrace(2999, "below");
            logAndTrace(3000, "flow");
            logAndTrace(6000, "error");
        }),
        ElementsAre(HasSubstr("] 3000 trace "), HasSubstr("] 6000 log "), HasSubstr("] 6000 trace ")));
}

TEST_F(Channels, eachCanBeOff)
{
    level.set("off");
    traceLevel.set("6000");
    EXPECT_THAT(standardErrorOf([] { logAndTrace(2147483647, "error"); }), ElementsAre(HasSubstr(" trace ")));
    traceLevel.set("off");
    EXPECT_THAT(standardErrorOf([] { logAndTrace(2147483647, "error"); }), IsEmpty());
}

TEST_F(Channels, theTraceGoesWhereTheLogGoes)
{
    file.set(directory.path("log"));
    traceLevel.set("6000");
    EXPECT_THAT(standardErrorOf([] { logAndTrace(6000, "error"); }), IsEmpty());
    EXPECT_THAT(linesIn("log"), ElementsAre(HasSubstr(" log "), HasSubstr(" trace ")));
}

TEST_F(Channels, theTraceMayHaveAnOutputOfItsOwn)
{
    file.set(directory.path("log"));
    traceLevel.set("6000");
    traceOutput.set("file:" + directory.path("trace"));
    EXPECT_THAT(standardErrorOf([] { logAndTrace(6000, "error"); }), IsEmpty());
    EXPECT_THAT(linesIn("log"), ElementsAre(HasSubstr(" log ")));
    EXPECT_THAT(linesIn("trace"), ElementsAre(HasSubstr(" trace ")));

    traceOutput.set("stderr");
    EXPECT_THAT(standardErrorOf([] { logAndTrace(6000, "error"); }), ElementsAre(HasSubstr(" trace ")));
}

TEST_F(Channels, theOutputGoesBeforeTheFile)
{
    file.set(directory.path("file"));
    output.set("file:" + directory.path("output"));
    EXPECT_THAT(standardErrorOf([] { log(6000, "error"); }), IsEmpty());
    EXPECT_THAT(linesIn("file"), IsEmpty());
    EXPECT_THAT(linesIn("output"), ElementsAre(EndsWith(": error")));
}

TEST_F(Channels, whatIsOffIsNotOpened)
{
    level.set("off");
    file.set(directory.path("missing/log"));
    traceLevel.set("6000");
    traceOutput.set("stderr");
    EXPECT_THAT(standardErrorOf([] { logAndTrace(6000, "error"); }), ElementsAre(HasSubstr(" trace ")));
}

TEST_F(Channels, anOutputOfBothIsComplainedOfOnce)
{
    traceLevel.set("6000");
    file.set("/dev/full");
    EXPECT_THAT(standardErrorOf([] {
                    logAndTrace(6000, "first");
                    logAndTrace(6000, "second");
                }),
                ElementsAre(HasSubstr("a log line is lost")));
    file.set(directory.path("missing/log"));
    EXPECT_THAT(standardErrorOf([] { logAndTrace(6000, "first"); }),
                ElementsAre(HasSubstr("MVLOG_FILE: cannot open "), HasSubstr(" log "), HasSubstr(" trace ")));
}

TEST_F(Channels, aBadTraceLevelLeavesTheTraceOff)
{
    traceLevel.set("loud");
    EXPECT_THAT(standardErrorOf([] { logAndTrace(6000, "error"); }),
                ElementsAre(EndsWith("MVLOG_TRACE_LEVEL is \"loud\", expected a whole number from 0 to "
                                     "2147483647 or off; taking off"),
                            HasSubstr(" log ")));
}

TEST_F(Channels, aBadOutputIsComplainedOfAndNotUsed)
{
    for (const char* const value : {"printer", "stderr:", "stderr:x", "file", "file:", "/tmp/log",
                                    "syslog:", "journal:", "Syslog", ":", "syslog "}) {
        output.set(value);
        EXPECT_THAT(standardErrorOf([] { log(6000, "error"); }),
                    ElementsAre(EndsWith(std::string("MVLOG_OUTPUT is \"") + value +
                                         "\", expected stderr, file:PATH, syslog, syslog:SOCKET, journal or "
                                         "journal:SOCKET; not used"),
                                EndsWith(": error")));
    }
}

TEST_F(Channels, onlyTheCategoriesNamedAreWritten)
{
    categories.set(",Mavrel.Glimmark,,Mavrel.Loc*,");
    traceLevel.set("6000");
    EXPECT_THAT(standardErrorOf([] {
                    for (const char* const name : {"Mavrel.Glimmark", "Mavrel.GlimmarkProvider",
                                                   "Mavrel.Locale", "Mavrel.Lo", "mavrel.locale", ""})
                        logAndTrace(6000, "text", name);
                }),
                ElementsAre(HasSubstr(" log Mavrel.Glimmark "), HasSubstr(" trace Mavrel.Glimmark "),
                            HasSubstr(" log Mavrel.Locale "), HasSubstr(" trace Mavrel.Locale ")));
}

TEST_F(Channels, aStarNamesAllCategories)
{
    categories.set("*");
    EXPECT_THAT(standardErrorOf([] { log(6000, "text", ""); }), ElementsAre(EndsWith(": text")));
}

} // namespace
