#include "cli/watch/View.h"

#include "cim/Utf8.h"
#include "cli/tests/Lamp.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::cli;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

namespace {

cim::Answer answerOf(cim::Instances instances)
{
    return {{}, {}, std::move(instances)};
}

std::vector<std::string> plainFrame(const Watched& watched, TerminalSize size = {80, 24})
{
    return watched.frame("CIM_Lamp in root/cimv2", size, false);
}

TEST(View, isATableOfTheInstances)
{
    Watched watched;
    watched.take(answerOf({lamp("a"), lamp("b", 10, 3)}), "12:00");
    EXPECT_THAT(plainFrame(watched),
                ElementsAre("CIM_Lamp in root/cimv2: 2 instances at 12:00", "",
                            "  DeviceID  HealthState       OperationalStatus  AlarmState   Name",
                            "  --------  ----------------  -----------------  -----------  ----",
                            "  a         OK                OK                 Off          L",
                            "  b         Degraded/Warning  OK                 Alternating  L", "", "q ends"));
}

TEST(View, saysThatThereIsNothing)
{
    Watched watched;
    EXPECT_THAT(watched.take(answerOf({}), "12:00"), IsEmpty());
    EXPECT_THAT(plainFrame(watched), ElementsAre("CIM_Lamp in root/cimv2: 0 instances at 12:00", "",
                                                 "  No instances.", "", "q ends"));
}

TEST(View, theFirstAnswerTellsWhatIsThereWithoutMarks)
{
    Watched watched;
    EXPECT_THAT(watched.take(answerOf({lamp("a")}), "12:00"),
                ElementsAre("12:00 a is there: HealthState OK, OperationalStatus OK, AlarmState Off"));
    EXPECT_THAT(plainFrame(watched), Not(Contains(StartsWith("+"))));
}

TEST(View, marksAndTellsChanges)
{
    Watched watched;
    watched.take(answerOf({lamp("a"), lamp("b")}), "12:00");
    EXPECT_THAT(watched.take(answerOf({lamp("a", 5, 2), lamp("c")}), "12:01"),
                ElementsAre("12:01 a: AlarmState from Off to Steady", StartsWith("12:01 c is there"),
                            "12:01 b is gone"));
    EXPECT_THAT(plainFrame(watched),
                ElementsAre("CIM_Lamp in root/cimv2: 2 instances at 12:01", "", StartsWith("  DeviceID"),
                            StartsWith("  ---"), StartsWith("* a "), StartsWith("+ c "), "",
                            "12:01 a: AlarmState from Off to Steady", StartsWith("12:01 c is there"),
                            "12:01 b is gone", "", "q ends"));
}

TEST(View, takesMarksAwayAfterSomeAnswers)
{
    Watched watched;
    watched.take(answerOf({lamp("a")}), "12:00");
    const cim::Answer altered = answerOf({lamp("a", 10)});
    for (int answer = 0; answer < 5; ++answer) {
        watched.take(altered, "12:01");
        EXPECT_THAT(plainFrame(watched), Contains(StartsWith("* L "))) << answer;
    }
    watched.take(altered, "12:02");
    EXPECT_THAT(plainFrame(watched), Contains(StartsWith("  L ")));
}

TEST(View, showsWhatIsMarkedOrNotWellWhereNotAllFit)
{
    Watched watched;
    cim::Instances lamps;
    for (char name = 'a'; name <= 'z'; ++name)
        lamps.push_back(lamp(std::string(1, name), name == 'y' ? 25 : 5));
    watched.take(answerOf(lamps), "12:00");
    EXPECT_THAT(plainFrame(watched, {80, 10}),
                ElementsAre(StartsWith("CIM_Lamp"), "", StartsWith("  DeviceID"), StartsWith("  ---"),
                            StartsWith("  y "), StartsWith("  a "), StartsWith("  b "), "  ... and 23 more",
                            "", "q ends"));
}

TEST(View, fitsIntoAnyTerminal)
{
    Watched watched;
    watched.take(answerOf({lamp("a"), lamp("診断")}), "12:00");
    watched.take(answerOf({lamp("a", 10), lamp("診断", 0)}), "12:00");
    for (std::size_t columns = 0; columns < 70; ++columns)
        for (std::size_t rows = 0; rows < 12; ++rows) {
            const std::vector<std::string> lines = plainFrame(watched, {columns, rows});
            EXPECT_LE(lines.size(), rows);
            for (const std::string& line : lines)
                EXPECT_LE(cim::displayWidth(line), columns) << line;
        }
}

TEST(View, coloursByHealth)
{
    Watched watched;
    watched.take(answerOf({lamp("a"), lamp("b", 10), lamp("c", 15), lamp("d", 30), lamp("e", 0)}), "12:00");
    EXPECT_THAT(watched.frame("", {80, 24}, true),
                ElementsAre(testing::_, testing::_, testing::_, testing::_, StartsWith("\x1B[32m  a "),
                            StartsWith("\x1B[33m  b "), StartsWith("\x1B[31m  c "),
                            StartsWith("\x1B[31m  d "), StartsWith("  e "), "", "q ends"));
    EXPECT_THAT(plainFrame(watched), Not(Contains(HasSubstr("\x1B"))));
}

TEST(View, showsAnErrorUntilItIsOver)
{
    Watched watched;
    watched.take(answerOf({lamp("a")}), "12:00");
    const cim::Answer failed{{CMPI_RC_ERR_FAILED, "no\x1B[2J"}, {}, {}};
    EXPECT_THAT(watched.take(failed, "12:01"), ElementsAre("12:01 CMPI_RC_ERR_FAILED (1): no\\x001B[2J"));
    EXPECT_THAT(watched.take(failed, "12:02"), IsEmpty());
    EXPECT_THAT(plainFrame(watched), Contains("CMPI_RC_ERR_FAILED (1): no\\x001B[2J"));
    EXPECT_EQ(plainFrame(watched).front(), "CIM_Lamp in root/cimv2: no answer at 12:02; before: 1 instance");
    EXPECT_THAT(plainFrame(watched), Contains(StartsWith("  L ")));
    EXPECT_THAT(watched.take(answerOf({lamp("a")}), "12:03"), IsEmpty());
    EXPECT_THAT(plainFrame(watched), Not(Contains(HasSubstr("FAILED"))));
}

TEST(View, tellsNoAnswerFromAnEmptyOne)
{
    Watched watched;
    watched.take(answerOf({}), "12:00");
    watched.take({{CMPI_RC_ERR_FAILED, "no"}, {}, {}}, "12:01");
    EXPECT_THAT(plainFrame(watched),
                ElementsAre("CIM_Lamp in root/cimv2: no answer at 12:01; before: 0 instances",
                            "CMPI_RC_ERR_FAILED (1): no", "", "", "q ends"));
}

TEST(View, showsTheLastMessages)
{
    Watched watched;
    watched.take(answerOf({lamp("a")}), "12:00");
    watched.tell({"1", "2"});
    watched.tell({"3", "4", "5", "6\x1B"});
    const std::vector<std::string> lines = plainFrame(watched, {80, 40});
    EXPECT_THAT(std::vector<std::string>(lines.end() - 7, lines.end()),
                ElementsAre("2", "3", "4", "5", "6\\x001B", "", "q ends"));
}

TEST(View, shortensTheKeysOfAChangeFirst)
{
    Watched watched;
    const std::string id = "chassis-1/system-board-1/indicator-1";
    watched.take(answerOf({lamp(id)}), "12:00");
    watched.take(answerOf({lamp(id, 5, 2)}), "12:01");
    EXPECT_THAT(plainFrame(watched, {70, 24}),
                Contains("12:01 chassis-1/system…rd-1/indicator-1: AlarmState from Off to Steady"));
}

} // namespace
