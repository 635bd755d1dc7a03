#include "cli/ValueWords.h"

#include <gtest/gtest.h>

using cimhost::cli::valueWord;

namespace {

TEST(ValueWords, areThoseOfTheSchema)
{
    EXPECT_EQ(valueWord("HealthState", 0), "Unknown");
    EXPECT_EQ(valueWord("HealthState", 5), "OK");
    EXPECT_EQ(valueWord("HealthState", 10), "Degraded/Warning");
    EXPECT_EQ(valueWord("HealthState", 30), "Non-recoverable error");
    EXPECT_EQ(valueWord("OperationalStatus", 0), "Unknown");
    EXPECT_EQ(valueWord("OperationalStatus", 2), "OK");
    EXPECT_EQ(valueWord("OperationalStatus", 3), "Degraded");
    EXPECT_EQ(valueWord("OperationalStatus", 5), "Predictive Failure");
    EXPECT_EQ(valueWord("OperationalStatus", 11), "In Service");
    EXPECT_EQ(valueWord("AlarmState", 0), "Unknown");
    EXPECT_EQ(valueWord("AlarmState", 1), "Off");
    EXPECT_EQ(valueWord("AlarmState", 2), "Steady");
    EXPECT_EQ(valueWord("AlarmState", 3), "Alternating");
    EXPECT_EQ(valueWord("RequestedState", 2), "Enabled");
    EXPECT_EQ(valueWord("RequestedState", 3), "Disabled");
    EXPECT_EQ(valueWord("RequestedAlarmStatesSupported", 1), "Off");
    EXPECT_EQ(valueWord("RequestedAlarmStatesSupported", 2), "Steady");
    EXPECT_EQ(valueWord("RequestedAlarmStatesSupported", 3), "Alternating");
    EXPECT_EQ(valueWord("EnabledState", 2), "Enabled");
    EXPECT_EQ(valueWord("EnabledDefault", 2), "Enabled");
    EXPECT_EQ(valueWord("PrimaryStatus", 1), "OK");
    EXPECT_EQ(valueWord("Dedicated", 0), "Not Dedicated");
}

TEST(ValueWords, ignoreTheLetterCaseOfNames)
{
    EXPECT_EQ(valueWord("HEALTHSTATE", 5), "OK");
}

TEST(ValueWords, areMissingForOtherNumbersAndProperties)
{
    EXPECT_EQ(valueWord("HealthState", 6), std::nullopt);
    EXPECT_EQ(valueWord("RequestedState", 1), std::nullopt);
    EXPECT_EQ(valueWord("Speed", 5), std::nullopt);
}

} // namespace
