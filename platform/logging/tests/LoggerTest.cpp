#include "LoggerTest.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <string>
#include <thread>
#include <type_traits>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

namespace {

using namespace std::string_literals;
using MVLog::MVLogger;
using testing::ContainsRegex;
using Testing::contentOf;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

using Signature = void(const char*, const char*, int, const std::string&, int, const char*, int, int,
                       const std::string&);
static_assert(std::is_same_v<decltype(MVLogger::logLevelMessage), Signature>);
static_assert(std::is_same_v<decltype(MVLogger::traceLevelMessage), Signature>);

using Logger = LoggerTest;

TEST_F(Logger, writesAllThatItIsToldInOneLine)
{
    EXPECT_THAT(
        standardErrorOf([] {
            MVLogger::logLevelMessage("setVector", "Glimmark.cpp", 120, "Mavrel.Glimmark", 6000, nullptr, 0,
                                      0, "A text.");
        }),
        ElementsAre(ContainsRegex(
            "^[0-9]{4}-[0-9]{2}-[0-9]{2}T[0-9]{2}:[0-9]{2}:[0-9]{2}\\.[0-9]{3}[+-][0-9]{2}:[0-9]{2} "
            "\\[[0-9]+:[0-9]+\\] 6000 log Mavrel\\.Glimmark setVector\\(\\) Glimmark\\.cpp:120: A text\\.$")));
}

TEST_F(Logger, namesTheTraceChannel)
{
    traceLevel.set("0");
    EXPECT_THAT(standardErrorOf([] {
                    MVLogger::traceLevelMessage("f", "F.cpp", -1, "C", 7000, "reserved", 5, 6, "text");
                }),
                ElementsAre(EndsWith("] 7000 trace C f() F.cpp:-1: text")));
}

TEST_F(Logger, takesNullTexts)
{
    EXPECT_THAT(
        standardErrorOf([] { MVLogger::logLevelMessage(nullptr, nullptr, 0, "", 6000, nullptr, 0, 0, ""); }),
        ElementsAre(EndsWith("] 6000 log  ?() ?:0: ")));
}

TEST_F(Logger, startsAtLevel6000)
{
    EXPECT_THAT(standardErrorOf([] {
                    log(std::numeric_limits<int>::min(), "least");
                    log(3000, "flow");
                    log(5999, "below");
                    log(6000, "error");
                    log(std::numeric_limits<int>::max(), "most");
                }),
                ElementsAre(EndsWith(": error"), EndsWith(": most")));
}

TEST_F(Logger, startsAtTheLevelOfTheEnvironment)
{
    level.set("3000");
    EXPECT_THAT(standardErrorOf([] {
                    log(2999, "below");
                    log(3000, "flow");
                }),
                ElementsAre(EndsWith(": flow")));
}

TEST_F(Logger, levelZeroDropsNegativeLevelsOnly)
{
    level.set("0");
    EXPECT_THAT(standardErrorOf([] {
                    log(-1, "below");
                    log(0, "zero");
                }),
                ElementsAre(EndsWith(": zero")));
}

TEST_F(Logger, theHighestLevelSilences)
{
    level.set("2147483647");
    EXPECT_THAT(standardErrorOf([] { log(6000, "error"); }), IsEmpty());
}

TEST_F(Logger, emptyVariablesCountAsUnset)
{
    level.set("");
    file.set("");
    EXPECT_THAT(standardErrorOf([] {
                    log(5999, "below");
                    log(6000, "error");
                }),
                ElementsAre(EndsWith(": error")));
}

class BadLevel : public LoggerTest, public testing::WithParamInterface<const char*>
{};

TEST_P(BadLevel, isComplainedOfOnceAndTheDefaultTaken)
{
    level.set(GetParam());
    EXPECT_THAT(standardErrorOf([] {
                    log(5999, "below");
                    log(6000, "first");
                    log(6000, "second");
                }),
                ElementsAre(EndsWith(std::string("MVLOG_LEVEL is \"") + GetParam() +
                                     "\", expected a whole number from 0 to 2147483647 or off; taking 6000"),
                            EndsWith(": first"), EndsWith(": second")));
}

INSTANTIATE_TEST_SUITE_P(Values, BadLevel,
                         testing::Values("error", "-1", "6000x", " 6000", "6000 ", "+1", "1.5", "0x10",
                                         "2147483648", "99999999999999999999", "{}", "%s"));

TEST_F(Logger, aComplaintIsOneLineWhateverTheEnvironmentHolds)
{
    level.set("3000\n\x1B[31m");
    EXPECT_THAT(standardErrorOf([] { log(6000, "text"); }),
                ElementsAre(HasSubstr("MVLOG_LEVEL is \"3000\\n\\x001B[31m\""), EndsWith(": text")));
}

TEST_F(Logger, appendsToTheFileOfTheEnvironment)
{
    file.set(directory.file("log", "before\n"));
    EXPECT_THAT(standardErrorOf([] { log(6000, "one"); }), IsEmpty());
    EXPECT_THAT(standardErrorOf([] { log(6000, "two"); }), IsEmpty());
    EXPECT_THAT(linesOf(contentOf(directory.path("log"))),
                ElementsAre("before", EndsWith(": one"), EndsWith(": two")));
}

TEST_F(Logger, makesTheFileForItsOwnerAndGroupOnly)
{
    file.set(directory.path("log"));
    standardErrorOf([] { log(6000, "text"); });
    struct stat status
    {};
    ASSERT_EQ(stat(directory.path("log").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0007U, 0U);
}

TEST_F(Logger, aFileThatCannotBeOpenedIsComplainedOfOnce)
{
    mkfifo(directory.path("pipe").c_str(), 0600);
    for (const std::string& name :
         {directory.path("missing/log"), directory.path(""), directory.path("pipe")}) {
        file.set(name);
        EXPECT_THAT(
            standardErrorOf([] {
                log(6000, "first");
                log(6000, "second");
            }),
            ElementsAre(testing::AllOf(HasSubstr("MVLOG_FILE: cannot open " + name + ": "),
                                       EndsWith("expected a file to append to; taking standard error")),
                        EndsWith(": first"), EndsWith(": second")));
    }
}

TEST_F(Logger, everyBadVariableIsComplainedOf)
{
    level.set("loud");
    file.set(directory.path("missing/log"));
    EXPECT_THAT(standardErrorOf([] { log(6000, "text"); }),
                ElementsAre(HasSubstr("MVLOG_LEVEL"), HasSubstr("MVLOG_FILE"), EndsWith(": text")));
}

TEST_F(Logger, aLineThatCannotBeWrittenIsComplainedOfOnce)
{
    file.set("/dev/full");
    EXPECT_THAT(
        standardErrorOf([] {
            log(6000, "first");
            log(6000, "second");
        }),
        ElementsAre(EndsWith("a log line is lost: cannot write to /dev/full: No space left on device")));
}

TEST_F(Logger, survivesAClosedStandardError)
{
    EXPECT_THAT(standardErrorOf([] {
                    close(STDERR_FILENO);
                    log(6000, "lost");
                }),
                IsEmpty());
}

TEST_F(Logger, escapesControlCharactersAndNothingElse)
{
    EXPECT_THAT(standardErrorOf([] { log(6000, "a\nb\tc\0d\x7F \xC3\xA4 {} %v \\"s); }),
                ElementsAre(EndsWith(": a\\nb\\tc\\x0000d\\x007F \xC3\xA4 {} %v \\")));
}

TEST_F(Logger, escapesWhatDrivesATerminalOrMisleadsAReader)
{
    const std::vector<std::pair<std::string, std::string>> shown{
        {"\x01\b\t\n\f\r\x1F ~\x7F", R"(\x0001\b\t\n\f\r\x001F ~\x007F)"},
        {"\u0080\u0085\u009B\u009F\u00A0", "\\x0080\\x0085\\x009B\\x009F\u00A0"},
        {"\u061B\u061C\u200D\u200E\u200F\u2010", "\u061B\\x061C\u200D\\x200E\\x200F\u2010"},
        // NOLINTNEXTLINE(misc-misleading-bidirectional): they are what is escaped.
        {"\u2027\u2028\u2029\u202A\u202E\u202F", "\u2027\\x2028\\x2029\\x202A\\x202E\u202F"},
        // NOLINTNEXTLINE(misc-misleading-bidirectional)
        {"\u2065\u2066\u2067\u2068\u2069\u206A", "\u2065\\x2066\\x2067\\x2068\\x2069\u206A"},
        {"\u07FF\u0800\uD7FF\uE000\uFFFF\U00010000\U0010FFFF",
         "\u07FF\u0800\uD7FF\uE000\uFFFF\U00010000\U0010FFFF"},
    };
    for (const auto& [text, line] : shown) {
        EXPECT_THAT(standardErrorOf([&, text = text] { log(6000, text); }),
                    ElementsAre(EndsWith(": " + line)));
    }
}

TEST_F(Logger, putsAMarkInThePlaceOfEachByteThatIsNotUtf8)
{
    // Cut in the middle, nothing to go on with, one byte too long, too large, a surrogate, no beginning.
    for (const char* const bytes :
         {"\xC3", "\xE2\x80", "\xF0\x9F\x98", "\x80", "\xC0\xAF", "\xE0\x9F\xBF", "\xF0\x8F\xBF\xBF",
          "\xF4\x90\x80\x80", "\xED\xA0\x80", "\xF8\x88\x80\x80\x80", "\xFF"}) {
        std::string marks;
        for (std::size_t i = 0; i < std::strlen(bytes); ++i)
            marks += "\uFFFD";
        std::string text = bytes;
        text.append("a").append(bytes);
        std::string shown = ": " + marks;
        shown.append("a").append(marks);
        EXPECT_THAT(standardErrorOf([&] { log(6000, text); }), ElementsAre(EndsWith(shown)));
    }
}

TEST_F(Logger, writesLongLinesWhole)
{
    const std::string text(1000000, 'x');
    EXPECT_THAT(standardErrorOf([&] { log(6000, text); }), ElementsAre(EndsWith(": " + text)));
}

TEST_F(Logger, keepsLinesOfThreadsWhole)
{
    constexpr int threadCount = 8;
    constexpr int lineCount = 200;
    const std::string filling(300, '.');
    auto lines = standardErrorOf([&] {
        std::vector<std::thread> threads;
        threads.reserve(threadCount);
        for (int number = 0; number < threadCount; ++number)
            threads.emplace_back([&, number] {
                for (int line = 0; line < lineCount; ++line)
                    log(6000, std::to_string(number) + filling + "end");
            });
        for (std::thread& thread : threads)
            thread.join();
    });
    ASSERT_THAT(lines, SizeIs(threadCount * lineCount));
    for (int number = 0; number < threadCount; ++number) {
        const std::string end = ": " + std::to_string(number) + filling + "end";
        EXPECT_EQ(std::count_if(lines.begin(), lines.end(),
                                [&](const std::string& line) {
                                    return line.size() > end.size() &&
                                           line.compare(line.size() - end.size(), end.size(), end) == 0;
                                }),
                  lineCount);
    }
}

/// Made before anything of the test has logged, so it goes after all that logging set up.
struct LogsAtTheEnd
{
    bool isOn = false;
    ~LogsAtTheEnd()
    {
        if (isOn)
            log(6000, "from the end");
    }
};
LogsAtTheEnd logsAtTheEnd;

TEST_F(Logger, logsWhileStaticObjectsAreDestroyed)
{
    EXPECT_THAT(standardErrorOf([] {
                    logsAtTheEnd.isOn = true;
                    log(6000, "from the work");
                }),
                ElementsAre(EndsWith(": from the work"), EndsWith(": from the end")));
}

TEST_F(Logger, logsForTheFirstTimeWhileStaticObjectsAreDestroyed)
{
    EXPECT_THAT(standardErrorOf([] { logsAtTheEnd.isOn = true; }), ElementsAre(EndsWith(": from the end")));
}

} // namespace
