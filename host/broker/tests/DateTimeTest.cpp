#include "broker/DateTime.h"

#include <gtest/gtest.h>

namespace cimhost {

namespace {

constexpr std::uint64_t second = 1'000'000;
constexpr std::uint64_t day = 86'400 * second;

TEST(DateTimeTest, KnowsItsTwoForms)
{
    EXPECT_TRUE(isDateTime("20240229123456.789012+060"));
    EXPECT_TRUE(isDateTime("2024**********.******-000"));
    EXPECT_TRUE(isDateTime("00000002030405.000006:000"));
    EXPECT_FALSE(isInterval("20240229123456.789012+060"));
    EXPECT_TRUE(isInterval("00000002030405.000006:000"));
}

TEST(DateTimeTest, RefusesEverythingElse)
{
    for (const char* const text :
         {"", "20240229123456.789012+06", "20240229123456.789012+0600", "20240229123456,789012+060",
          "20240229123456.789012 060", "2024022912345x.789012+060", "20241329123456.789012+060",
          "20240229243456.789012+060", "20240229126056.789012+060", "20240229123460.789012+060",
          "20240200123456.789012+060", "00000002030405.000006:001", "00000002240405.000006:000"})
        EXPECT_FALSE(isDateTime(text)) << text;
}

TEST(DateTimeTest, CountsMicrosecondsFrom1970InUtc)
{
    EXPECT_EQ(toMicroseconds("19700101000000.000000+000"), 0U);
    EXPECT_EQ(toMicroseconds("19700101000001.000002+000"), second + 2);
    EXPECT_EQ(toMicroseconds("20000301000000.000000+000"), 11'017 * day);
    EXPECT_EQ(toMicroseconds("19700101010000.000000+060"), 0U);
    EXPECT_EQ(toMicroseconds("19700101000000.000000-060"), 3'600 * second);
    EXPECT_EQ(toMicroseconds("19700101000000.000000+001"), 0U); // before 1970
    EXPECT_EQ(toMicroseconds("1970**********.******+000"), 0U); // what is not given is the first
}

TEST(DateTimeTest, CountsTheMicrosecondsOfIntervals)
{
    EXPECT_EQ(toMicroseconds("00000002030405.000006:000"), 2 * day + (3 * 3'600 + 4 * 60 + 5) * second + 6);
}

TEST(DateTimeTest, WritesWhatItReads)
{
    for (const char* const text :
         {"19700101000000.000000+000", "19991231235959.999999+000", "20000229120000.000001+000",
          "21000301000000.000000+000", "99991231235959.999999+000", "00000002030405.000006:000",
          "99999999235959.999999:000"})
        EXPECT_EQ(toDateTime(toMicroseconds(text), isInterval(text)), text);
}

TEST(DateTimeTest, StaysWithinWhatTheTextHolds)
{
    EXPECT_EQ(toDateTime(~std::uint64_t{0}, false), "99991231235959.999999+000");
    EXPECT_EQ(toDateTime(~std::uint64_t{0}, true), "99999999235959.999999:000");
}

TEST(DateTimeTest, KnowsNow)
{
    const std::string now = currentDateTime();
    EXPECT_TRUE(isDateTime(now));
    EXPECT_GT(toMicroseconds(now), 50 * (365 * day));
}

} // namespace

} // namespace cimhost
