#include "cim/Nearest.h"

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

TEST(Nearest, isTheNameWithTheFewestOtherLetters)
{
    const std::vector<std::string> names{"Caption", "Name", "ElementName", "HealthState"};
    EXPECT_EQ(nearestName("Nmae", names), "Name");
    EXPECT_EQ(nearestName("elementname", names), "ElementName");
    EXPECT_EQ(nearestName("HelthStates", names), "HealthState");
    EXPECT_EQ(nearestName("Captain", names), "Caption");
}

TEST(Nearest, isNothingFarAway)
{
    EXPECT_EQ(nearestName("Bogus", {"Name", "HealthState"}), "");
    EXPECT_EQ(nearestName("", {"HealthState"}), "");
    EXPECT_EQ(nearestName("Name", {}), "");
    EXPECT_EQ(nearestName(std::string(100000, 'a'), {"Name"}), "");
}

TEST(Nearest, isAsked)
{
    EXPECT_EQ(didYouMean("Nmae", {"Name"}), "; did you mean Name?");
    EXPECT_EQ(didYouMean("Bogus", {"Name"}), "");
}

} // namespace
