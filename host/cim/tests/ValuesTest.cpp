#include "cim/Values.h"

#include "cim/tests/Print.h"

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

ObjectPath fan(Value number)
{
    return {"", "root/cimv2", "CIM_Fan", {{"Number", std::move(number)}, {"Name", textValue("x")}}};
}

TEST(Values, areEqualInTypeStateAndContent)
{
    EXPECT_EQ(unsignedValue(1), unsignedValue(1));
    EXPECT_NE(unsignedValue(1), unsignedValue(2));
    EXPECT_NE(unsignedValue(1), unsignedValue(1, CMPI_uint16));
    EXPECT_NE(unsignedValue(1), signedValue(1));
    EXPECT_NE(nullValue(CMPI_string), nullValue(CMPI_uint16));
    EXPECT_NE(nullValue(CMPI_string), textValue(""));
    EXPECT_NE(arrayValue(CMPI_boolean, {true}), arrayValue(CMPI_boolean, {true, true}));
    EXPECT_NE(arrayValue(CMPI_boolean, {true}), booleanValue(true));
}

TEST(Values, compareWhatReferencesAndEmbeddedInstancesHold)
{
    EXPECT_EQ(referenceValue(fan(unsignedValue(1))), referenceValue(fan(unsignedValue(1))));
    EXPECT_NE(referenceValue(fan(unsignedValue(1))), referenceValue(fan(unsignedValue(2))));
    const Instance instance{fan(unsignedValue(1)), {{"Name", textValue("x")}}};
    EXPECT_EQ(instanceValue(instance), instanceValue(instance));
    EXPECT_NE(instanceValue(instance), instanceValue({instance.path, {{"Name", textValue("y")}}}));
    EXPECT_NE(instanceValue(instance), instanceValue({instance.path, {{"name", textValue("x")}}}));
    EXPECT_NE(instanceValue(instance), instanceValue({{}, instance.properties}));
}

TEST(Values, keepTheirTypes)
{
    EXPECT_EQ(booleanValue(true).type, CMPI_boolean);
    EXPECT_EQ(signedValue(-1, CMPI_sint8).type, CMPI_sint8);
    EXPECT_EQ(realValue(1, CMPI_real32).type, CMPI_real32);
    EXPECT_EQ(textValue("", CMPI_dateTime).type, CMPI_dateTime);
    EXPECT_EQ(arrayValue(CMPI_uint16, {}).type, CMPI_uint16A);
    EXPECT_FALSE(arrayValue(CMPI_uint16, {}).isNull);
    EXPECT_TRUE(nullValue(CMPI_uint16A).isNull);
    EXPECT_EQ(nullValue(CMPI_uint16A).type, CMPI_uint16A);
}

TEST(Names, areTheSameInAnyLetterCase)
{
    EXPECT_TRUE(sameName("CIM_Fan", "cim_fAN"));
    EXPECT_TRUE(sameName("", ""));
    EXPECT_FALSE(sameName("CIM_Fan", "CIM_Fa"));
    EXPECT_FALSE(sameName("CIM_Fan", "CIM_Fam"));
}

TEST(KeyValues, areTheSameNumberWhateverTheirWidthAndSign)
{
    EXPECT_TRUE(sameKeyValue(unsignedValue(7, CMPI_uint16), unsignedValue(7)));
    EXPECT_TRUE(sameKeyValue(unsignedValue(7), signedValue(7)));
    EXPECT_TRUE(sameKeyValue(signedValue(INT64_MIN), signedValue(INT64_MIN)));
    EXPECT_FALSE(sameKeyValue(unsignedValue(7), signedValue(-7)));
    EXPECT_FALSE(sameKeyValue(unsignedValue(UINT64_MAX), signedValue(-1)));
    EXPECT_FALSE(sameKeyValue(unsignedValue(7), textValue("7")));
    EXPECT_FALSE(sameKeyValue(unsignedValue(1), booleanValue(true)));
}

TEST(KeyValues, takeADatetimeForItsText)
{
    EXPECT_TRUE(sameKeyValue(textValue("20", CMPI_dateTime), textValue("20")));
    EXPECT_FALSE(sameKeyValue(textValue("a"), textValue("A")));
}

TEST(KeyValues, tellNullsAndArraysFromScalars)
{
    EXPECT_TRUE(sameKeyValue(nullValue(CMPI_string), nullValue(CMPI_uint16)));
    EXPECT_FALSE(sameKeyValue(nullValue(CMPI_string), textValue("")));
    EXPECT_FALSE(sameKeyValue(arrayValue(CMPI_boolean, {true}), booleanValue(true)));
}

TEST(Objects, areTheSameWhateverTheHostAndTheLetterCaseOfNames)
{
    const ObjectPath path = fan(unsignedValue(1));
    EXPECT_TRUE(sameObject(path, {"srv",
                                  "ROOT/CIMV2",
                                  "cim_fan",
                                  {{"NAME", textValue("x")}, {"number", unsignedValue(1, CMPI_uint8)}}}));
    ObjectPath anywhere = path;
    anywhere.nameSpace.clear();
    EXPECT_TRUE(sameObject(path, anywhere));
}

TEST(Objects, differByClassNamespaceAndKeys)
{
    const ObjectPath path = fan(unsignedValue(1));
    ObjectPath other = path;
    other.className = "CIM_Led";
    EXPECT_FALSE(sameObject(path, other));
    other = path;
    other.nameSpace = "root/other";
    EXPECT_FALSE(sameObject(path, other));
    other = path;
    other.keys.pop_back();
    EXPECT_FALSE(sameObject(path, other));
    EXPECT_FALSE(sameObject(other, path));
    EXPECT_FALSE(sameObject(path, fan(unsignedValue(2))));
    other = path;
    other.keys[0].name = "Other";
    EXPECT_FALSE(sameObject(path, other));
}

TEST(Objects, areTheSameIfTheirReferencesNameTheSameObjects)
{
    const ObjectPath a = fan(unsignedValue(1));
    ObjectPath b = a;
    b.host = "srv";
    const ObjectPath link{"", "", "CIM_Link", {{"Left", referenceValue(a)}}};
    EXPECT_TRUE(sameObject(link, {"", "", "CIM_Link", {{"Left", referenceValue(b)}}}));
    EXPECT_FALSE(sameObject(link, {"", "", "CIM_Link", {{"Left", textValue("x")}}}));
    EXPECT_FALSE(sameObject(link, {"", "", "CIM_Link", {{"Left", referenceValue(fan(unsignedValue(2)))}}}));
}

TEST(LookupTexts, areEqualForTheSameObject)
{
    const ObjectPath path = fan(unsignedValue(1));
    EXPECT_EQ(
        lookupText(path),
        lookupText(
            {"srv", "", "cim_FAN", {{"number", signedValue(1, CMPI_sint8)}, {"NAME", textValue("x")}}}));
    const ObjectPath link{"", "", "CIM_Link", {{"Left", referenceValue(path)}}};
    ObjectPath remote = path;
    remote.host = "srv";
    EXPECT_EQ(lookupText(link), lookupText({"", "", "CIM_Link", {{"Left", referenceValue(remote)}}}));
    EXPECT_EQ(lookupText(fan(realValue(0.0))), lookupText(fan(realValue(-0.0))));
}

TEST(LookupTexts, differByClassAndKeys)
{
    const ObjectPath path = fan(unsignedValue(1));
    ObjectPath other = path;
    other.className = "CIM_Led";
    EXPECT_NE(lookupText(path), lookupText(other));
    other = path;
    other.keys.pop_back();
    EXPECT_NE(lookupText(path), lookupText(other));
    EXPECT_NE(lookupText(path), lookupText(fan(unsignedValue(2))));
    EXPECT_NE(lookupText(path), lookupText(fan(signedValue(-1))));
    EXPECT_NE(lookupText(fan(booleanValue(true))), lookupText(fan(booleanValue(false))));
    EXPECT_NE(lookupText(fan(textValue("a"))), lookupText(fan(textValue("A"))));
    EXPECT_NE(lookupText(fan(referenceValue(path))), lookupText(fan(referenceValue(other))));
}

TEST(Names, findKeysAndProperties)
{
    const ObjectPath path = fan(unsignedValue(1));
    ASSERT_NE(findKey(path, "NUMBER"), nullptr);
    EXPECT_EQ(*findKey(path, "NUMBER"), unsignedValue(1));
    EXPECT_EQ(findKey(path, "Numbe"), nullptr);
    const Instance instance{path, {{"Caption", textValue("c")}}};
    ASSERT_NE(findProperty(instance, "caption"), nullptr);
    EXPECT_EQ(*findProperty(instance, "caption"), textValue("c"));
    EXPECT_EQ(findProperty(instance, "Number"), nullptr);
}

TEST(TypeNames, areThoseOfMof)
{
    EXPECT_EQ(typeName(CMPI_null), "null");
    EXPECT_EQ(typeName(CMPI_boolean), "boolean");
    EXPECT_EQ(typeName(CMPI_char16), "char16");
    EXPECT_EQ(typeName(CMPI_real32), "real32");
    EXPECT_EQ(typeName(CMPI_real64), "real64");
    EXPECT_EQ(typeName(CMPI_uint8), "uint8");
    EXPECT_EQ(typeName(CMPI_uint16), "uint16");
    EXPECT_EQ(typeName(CMPI_uint32), "uint32");
    EXPECT_EQ(typeName(CMPI_uint64), "uint64");
    EXPECT_EQ(typeName(CMPI_sint8), "sint8");
    EXPECT_EQ(typeName(CMPI_sint16), "sint16");
    EXPECT_EQ(typeName(CMPI_sint32), "sint32");
    EXPECT_EQ(typeName(CMPI_sint64), "sint64");
    EXPECT_EQ(typeName(CMPI_string), "string");
    EXPECT_EQ(typeName(CMPI_dateTime), "datetime");
    EXPECT_EQ(typeName(CMPI_instance), "instance");
    EXPECT_EQ(typeName(CMPI_ref), "ref");
    EXPECT_EQ(typeName(CMPI_uint16A), "uint16[]");
    EXPECT_EQ(typeName(CMPI_filter), "type 0x1400");
}

} // namespace
