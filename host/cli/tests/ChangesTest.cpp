#include "cli/watch/Changes.h"

#include "cli/tests/Lamp.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::cli;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

std::vector<std::string> textsOf(const cim::Instances& before, const cim::Instances& now)
{
    std::vector<std::string> texts;
    for (const Change& change : changesBetween(before, now))
        texts.push_back(changeText(change));
    return texts;
}

TEST(Changes, equalAnswersHaveNone)
{
    EXPECT_THAT(textsOf({}, {}), IsEmpty());
    EXPECT_THAT(textsOf({lamp("a"), lamp("b")}, {lamp("a"), lamp("b")}), IsEmpty());
    EXPECT_THAT(textsOf({lamp("a"), lamp("b")}, {lamp("b"), lamp("a")}), IsEmpty());
}

TEST(Changes, areThePropertiesThatAltered)
{
    EXPECT_THAT(
        textsOf({lamp("a"), lamp("b")}, {lamp("a", 10, 3), lamp("b")}),
        ElementsAre("a: HealthState from OK to Degraded/Warning", "a: AlarmState from Off to Alternating"));
}

TEST(Changes, areWhatAppearedAndThenWhatVanished)
{
    EXPECT_THAT(textsOf({lamp("a"), lamp("b")}, {lamp("b", 0), lamp("c")}),
                ElementsAre("b: HealthState from OK to Unknown",
                            "c is there: HealthState OK, OperationalStatus OK, AlarmState Off", "a is gone"));
}

TEST(Changes, arePropertiesThatComeAndGo)
{
    cim::Instance without = lamp("a");
    without.properties.pop_back();
    EXPECT_THAT(textsOf({without}, {lamp("a")}), ElementsAre("a: AlarmState from none to Off"));
    EXPECT_THAT(textsOf({lamp("a")}, {without}), ElementsAre("a: AlarmState from Off to none"));
}

TEST(Changes, areNotLetterCaseOfNames)
{
    cim::Instance other = lamp("a");
    other.path.className = "cim_lamp";
    other.path.keys.back().name = "deviceid";
    other.properties.back().name = "ALARMSTATE";
    EXPECT_THAT(textsOf({lamp("a")}, {other}), IsEmpty());
}

TEST(Changes, mayGoToATerminal)
{
    EXPECT_THAT(textsOf({lamp("a\x1B[2J")}, {}), ElementsAre("a\\x001B[2J is gone"));
}

} // namespace
