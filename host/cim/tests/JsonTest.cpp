#include "cim/Json.h"

#include "cim/Values.h"

#include <limits>

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

TEST(Json, keepsTheKindOfValues)
{
    EXPECT_EQ(toJson(nullValue(CMPI_uint16A)), Json(nullptr));
    EXPECT_EQ(toJson(booleanValue(true)), Json(true));
    EXPECT_EQ(toJson(unsignedValue(UINT64_MAX)).dump(), "18446744073709551615");
    EXPECT_EQ(toJson(signedValue(INT64_MIN)).dump(), "-9223372036854775808");
    EXPECT_EQ(toJson(realValue(0.5)).dump(), "0.5");
    EXPECT_EQ(toJson(realValue(2)).dump(), "2.0");
    EXPECT_EQ(toJson(textValue("42")), Json("42"));
    EXPECT_EQ(toJson(unsignedValue('A', CMPI_char16)), Json(65));
    EXPECT_EQ(toJson(arrayValue(CMPI_uint16, {})).dump(), "[]");
    EXPECT_EQ(toJson(arrayValue(CMPI_string, {std::string("a"), std::monostate()})).dump(), "[\"a\",null]");
}

TEST(Json, writesNumbersThatItLacksAsStrings)
{
    EXPECT_EQ(toJson(realValue(-std::numeric_limits<double>::infinity())), Json("-inf"));
    EXPECT_EQ(toJson(realValue(std::numeric_limits<double>::quiet_NaN())), Json("nan"));
}

TEST(Json, writesAPathWithItsText)
{
    const ObjectPath path{"", "root/cimv2", "CIM_A", {{"K", textValue("x")}, {"N", unsignedValue(1)}}};
    EXPECT_EQ(toJson(path).dump(), R"({"text":"root/cimv2:CIM_A.K=\"x\",N=1","host":null,)"
                                   R"("namespace":"root/cimv2","className":"CIM_A","keys":{"K":"x","N":1}})");
    EXPECT_EQ(toJson(ObjectPath{"srv", "", "CIM_A", {}}).dump(),
              R"({"text":"//srv/CIM_A","host":"srv","namespace":null,"className":"CIM_A","keys":{}})");
}

TEST(Json, writesAnInstanceAndWhatItRefersTo)
{
    const ObjectPath end{"", "", "CIM_B", {{"K", unsignedValue(1)}}};
    const Instance instance{{"", "", "CIM_A", {}},
                            {{"Z", referenceValue(end)}, {"A", instanceValue({end, {}})}}};
    const Json json = toJson(instance);
    EXPECT_EQ(json["path"], toJson(instance.path));
    EXPECT_EQ(json["properties"]["Z"], toJson(end));
    EXPECT_EQ(json["properties"]["A"], toJson(Instance{end, {}}));
    EXPECT_EQ(json["properties"].begin().key(), "Z"); // in the instance's order
}

TEST(Json, writesAStatusWithAndWithoutAMessage)
{
    EXPECT_EQ(toJson(Status{CMPI_RC_ERR_FAILED, "why"}).dump(),
              R"({"code":1,"name":"CMPI_RC_ERR_FAILED","message":"why"})");
    EXPECT_EQ(toJson(Status{}).dump(), R"({"code":0,"name":"CMPI_RC_OK","message":null})");
}

TEST(Json, becomesTextThatActsOnNoTerminal)
{
    EXPECT_EQ(toText(Json{{"a", "\x1b\x7f\u009b\u00e9"}}),
              "{\n  \"a\": \"\\u001b\\u007f\\u009b\\u00e9\"\n}\n");
    EXPECT_EQ(toText(Json("a\xff"
                          "b")),
              "\"a\\ufffdb\"\n");
}

} // namespace
