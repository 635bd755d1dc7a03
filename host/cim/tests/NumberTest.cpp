#include "cim/Number.h"

#include "cim/Values.h"
#include "cim/tests/Print.h"

#include <cstdint>

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

TEST(Number, hasTheWidestTypeThatItNeeds)
{
    EXPECT_EQ(parseNumber("0"), unsignedValue(0));
    EXPECT_EQ(parseNumber("+7"), unsignedValue(7));
    EXPECT_EQ(parseNumber("18446744073709551615"), unsignedValue(UINT64_MAX));
    EXPECT_EQ(parseNumber("-0"), unsignedValue(0));
    EXPECT_EQ(parseNumber("-9223372036854775808"), signedValue(INT64_MIN));
    EXPECT_EQ(parseNumber("1."), realValue(1));
    EXPECT_EQ(parseNumber("-2.5E-1"), realValue(-0.25));
    EXPECT_EQ(parseNumber("+2.5"), realValue(2.5));
    EXPECT_EQ(parseNumber(".5"), realValue(0.5));
    EXPECT_EQ(parseNumber("0e9"), realValue(0));
    EXPECT_EQ(parseNumber("5e-324"), realValue(5e-324));
    EXPECT_EQ(parseNumber("1.7976931348623157e308"), realValue(1.7976931348623157e308));
}

TEST(Number, isAllOfTheTextAndFits)
{
    for (const char* text : {"", " 1", "1 ", "+", "-", "+-1", "--1", "1-", "0x1", "one", "nan", "inf",
                             "nan(e)", "18446744073709551616", "-9223372036854775809"})
        EXPECT_EQ(parseNumber(text), std::nullopt) << text;
    for (const char* text : {"1e999", "-1e999", "1e-999", "e1", ".", "1e", "1e+", "1.5.", "1e2e3"})
        EXPECT_EQ(parseNumber(text), std::nullopt) << text;
}

} // namespace
