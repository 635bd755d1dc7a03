#include "cim/Literal.h"

#include "cim/Values.h"

#include <limits>

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

TEST(Literals, areThoseOfMof)
{
    EXPECT_EQ(literal(nullValue(CMPI_string)), "NULL");
    EXPECT_EQ(literal(booleanValue(true)), "TRUE");
    EXPECT_EQ(literal(booleanValue(false)), "FALSE");
    EXPECT_EQ(literal(unsignedValue(UINT64_MAX)), "18446744073709551615");
    EXPECT_EQ(literal(signedValue(INT64_MIN)), "-9223372036854775808");
    EXPECT_EQ(literal(textValue("a \"b\" \\ \n \u00e9")), "\"a \\\"b\\\" \\\\ \\n \u00e9\"");
    EXPECT_EQ(literal(textValue("20250101000000.000000+000", CMPI_dateTime)),
              "\"20250101000000.000000+000\"");
}

TEST(Literals, writeRealsShortAndAsReals)
{
    EXPECT_EQ(literal(realValue(0.1)), "0.1");
    EXPECT_EQ(literal(realValue(5)), "5.0");
    EXPECT_EQ(literal(realValue(-1e300)), "-1e+300");
    EXPECT_EQ(literal(realValue(std::numeric_limits<double>::infinity())), "inf");
    EXPECT_EQ(literal(realValue(std::numeric_limits<double>::quiet_NaN())), "nan");
}

TEST(Literals, writeCharacters)
{
    EXPECT_EQ(literal(unsignedValue('A', CMPI_char16)), "'A'");
    EXPECT_EQ(literal(unsignedValue('\'', CMPI_char16)), R"('\'')");
    EXPECT_EQ(literal(unsignedValue('\n', CMPI_char16)), R"('\n')");
    EXPECT_EQ(literal(unsignedValue(0, CMPI_char16)), R"('\x0000')");
    EXPECT_EQ(literal(unsignedValue(0xD800, CMPI_char16)), R"('\xD800')");
}

TEST(Literals, writeArrays)
{
    EXPECT_EQ(literal(arrayValue(CMPI_uint16, {})), "{}");
    EXPECT_EQ(literal(arrayValue(CMPI_uint16, {std::uint64_t{2}, std::uint64_t{11}})), "{2, 11}");
    EXPECT_EQ(literal(arrayValue(CMPI_string, {std::string("a,b"), std::monostate()})), "{\"a,b\", NULL}");
    EXPECT_EQ(literal(arrayValue(CMPI_char16, {std::uint64_t{'A'}})), "{'A'}");
}

TEST(Literals, writeReferencesAsQuotedPaths)
{
    const ObjectPath path{"", "root/cimv2", "CIM_A", {{"K", textValue("x\"y")}}};
    EXPECT_EQ(literal(referenceValue(path)), R"("root/cimv2:CIM_A.K=\"x\\\"y\"")");
}

TEST(Literals, writeEmbeddedInstancesAsQuotedMof)
{
    const Instance instance{{"", "", "CIM_A", {}}, {{"P", unsignedValue(1)}}};
    EXPECT_EQ(literal(instanceValue(instance)), R"("// CIM_A\ninstance of CIM_A\n{\n    P = 1;\n};\n")");
}

} // namespace
