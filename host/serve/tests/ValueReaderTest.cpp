#include "serve/ValueReader.h"

#include "schema/MofReader.h"

#include "cim/Values.h"
#include "cim/tests/Print.h"
#include "serve/Dtd.h"
#include "serve/Fault.h"

#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::serve;
using testing::HasSubstr;

namespace {

Element elementOf(const std::string& document)
{
    return parseXml(document, {}, &isKnownElement);
}

/// The one key of an INSTANCENAME.
cim::Value keyOf(const std::string& value)
{
    const cim::ObjectPath path = readInstanceName(elementOf(
        R"(<INSTANCENAME CLASSNAME="CIM_A"><KEYBINDING NAME="K">)" + value + "</KEYBINDING></INSTANCENAME>"));
    return path.keys.at(0).value;
}

/// The one property of an INSTANCE.
cim::Value propertyOf(const std::string& property)
{
    return readInstance(elementOf("<INSTANCE CLASSNAME=\"CIM_A\">" + property + "</INSTANCE>"), {})
        .properties.at(0)
        .value;
}

cim::Value scalarOf(const std::string& type, const std::string& text)
{
    return propertyOf(R"(<PROPERTY NAME="P" TYPE=")" + type + "\"><VALUE>" + text + "</VALUE></PROPERTY>");
}

/// The message of the error that reading ends in. Empty: it does not.
template <class Error = ValueError, class Read>
std::string errorOf(const Read& read)
{
    try {
        read();
        return "";
    } catch (const Error& error) {
        return error.what();
    }
}

TEST(KeyReader, readsTheTypesThatKeysHave)
{
    EXPECT_EQ(keyOf("<KEYVALUE> a </KEYVALUE>"), cim::textValue(" a "));
    EXPECT_EQ(keyOf("<KEYVALUE/>"), cim::textValue(""));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"string\">42</KEYVALUE>"), cim::textValue("42"));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"boolean\">True</KEYVALUE>"), cim::booleanValue(true));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"numeric\">42</KEYVALUE>"), cim::unsignedValue(42));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"numeric\"> -42 </KEYVALUE>"), cim::signedValue(-42));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"numeric\">0x2A</KEYVALUE>"), cim::unsignedValue(42));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"numeric\">-0X2a</KEYVALUE>"), cim::signedValue(-42));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"numeric\">1.5e1</KEYVALUE>"), cim::realValue(15));
    EXPECT_EQ(keyOf("<KEYVALUE VALUETYPE=\"numeric\" TYPE=\"uint16\">42</KEYVALUE>"),
              cim::unsignedValue(42, CMPI_uint16));
    EXPECT_EQ(keyOf("<KEYVALUE TYPE=\"datetime\">20260101000000.000000+000</KEYVALUE>"),
              cim::textValue("20260101000000.000000+000", CMPI_dateTime));
}

TEST(KeyReader, refusesWhatIsNoSuchValue)
{
    for (const char* number :
         {"", "x", "1x", "0x", "0xg", "--1", "+-1", "1.2.3", "18446744073709551616", "-9223372036854775809",
          "0x10000000000000000", "nan", "nan(e)", "inf", "1e999"})
        EXPECT_THAT(
            errorOf([&] { keyOf(std::string("<KEYVALUE VALUETYPE=\"numeric\">") + number + "</KEYVALUE>"); }),
            HasSubstr("expected a number of 64 bits"))
            << number;
    EXPECT_THAT(errorOf([] { keyOf("<KEYVALUE VALUETYPE=\"boolean\">1</KEYVALUE>"); }), HasSubstr("boolean"));
    EXPECT_THAT(errorOf<RequestError>([] { keyOf("<KEYVALUE VALUETYPE=\"text\"/>"); }),
                HasSubstr("expected string, boolean or numeric"));
    EXPECT_THAT(errorOf<RequestError>([] { keyOf("<KEYVALUE TYPE=\"int\"/>"); }),
                HasSubstr("one of CIM's types"));
    EXPECT_THAT(errorOf<RequestError>([] { keyOf("<KEYVALUE><VALUE/></KEYVALUE>"); }),
                HasSubstr("text only"));
    EXPECT_THAT(errorOf<RequestError>([] { keyOf(""); }), HasSubstr("expected KEYVALUE or VALUE.REFERENCE"));
}

TEST(KeyReader, refusesKeysThatRepeatOrHaveNoName)
{
    const std::string key = "<KEYBINDING NAME=\"K\"><KEYVALUE/></KEYBINDING>";
    EXPECT_THAT(errorOf([&] {
                    readInstanceName(
                        elementOf("<INSTANCENAME CLASSNAME=\"C\">" + key + key + "</INSTANCENAME>"));
                }),
                HasSubstr("found the key K again, expected each key once"));
    EXPECT_THAT(errorOf([&] {
                    readInstanceName(elementOf("<INSTANCENAME CLASSNAME=\"C\"><KEYVALUE>a</KEYVALUE>" + key +
                                               "</INSTANCENAME>"));
                }),
                HasSubstr("found a key without its name among others, expected KEYBINDING"));
    EXPECT_THAT(errorOf([&] {
                    keyOf(
                        "<VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"C\"><KEYVALUE>a</KEYVALUE></INSTANCENAME>"
                        "</VALUE.REFERENCE>");
                }),
                HasSubstr("found a key without its name in a reference"));
}

schema::Classes classes()
{
    return schema::Classes(schema::readMof(R"(class CIM_Base { [Key] uint16 Number; };
                                              class CIM_One : CIM_Base { string Text; };
                                              class CIM_Many { [Key] string Text; [Key] boolean Flag;
                                                               [Key] CIM_One REF End; [Key] datetime Time; };)",
                                           "a.mof")
                               .classes);
}

cim::ObjectPath typed(const std::string& className, std::vector<cim::Key> keys)
{
    cim::ObjectPath path{"", "", className, std::move(keys)};
    typeKeys(path, classes());
    return path;
}

TEST(TypeKeys, NamesTheOnlyKey)
{
    const cim::ObjectPath path = readInstanceName(elementOf(
        R"(<INSTANCENAME CLASSNAME="cim_one"><KEYVALUE VALUETYPE="numeric">5</KEYVALUE></INSTANCENAME>)"));
    const cim::ObjectPath whole = typed(path.className, path.keys);
    EXPECT_EQ(whole, (cim::ObjectPath{"", "", "cim_one", {{"Number", cim::unsignedValue(5, CMPI_uint16)}}}));
    EXPECT_THAT(errorOf([] {
                    typed("CIM_Many", {{"", cim::textValue("a")}});
                }),
                HasSubstr("the class CIM_Many is not known to have one key"));
    EXPECT_THAT(errorOf([] {
                    typed("CIM_None", {{"", cim::textValue("a")}});
                }),
                HasSubstr("expected KEYBINDING"));
}

TEST(TypeKeys, TakesTheTypesThatTheClassDeclares)
{
    EXPECT_EQ(typed("CIM_One", {{"number", cim::unsignedValue(7)}}).keys[0].value,
              cim::unsignedValue(7, CMPI_uint16));
    const char* const time = "20260101120000.000000+000";
    EXPECT_EQ(typed("CIM_Many", {{"Time", cim::textValue(time)}}).keys[0].value,
              cim::textValue(time, CMPI_dateTime));
}

TEST(TypeKeys, LeavesWhatIsNotOfTheDeclaredType)
{
    const auto expectUnchanged = [](const char* className, const char* key, const cim::Value& value) {
        EXPECT_EQ(typed(className, {{key, value}}).keys[0].value, value) << className << '.' << key;
    };
    const cim::Value seven = cim::unsignedValue(7);
    const cim::Value text = cim::textValue("7");
    expectUnchanged("CIM_One", "Number", text);
    expectUnchanged("CIM_One", "Number", cim::unsignedValue(70000));
    expectUnchanged("CIM_One", "Number", cim::booleanValue(true));
    expectUnchanged("CIM_One", "Other", seven);
    expectUnchanged("CIM_None", "Number", seven);
    for (const char* const key : {"Text", "Flag", "End", "Time"})
        expectUnchanged("CIM_Many", key, seven);
    for (const char* const key : {"Flag", "End", "Time"})
        expectUnchanged("CIM_Many", key, text);
    expectUnchanged("CIM_Many", "Text", cim::referenceValue({"", "", "CIM_One", {}}));
}

TEST(NameSpaceReader, joinsNames)
{
    const auto read = [](const std::string& first, const std::string& second) {
        return readNameSpace(elementOf("<LOCALNAMESPACEPATH><NAMESPACE NAME=\"" + first +
                                       "\"/><NAMESPACE NAME=\"" + second + "\"/></LOCALNAMESPACEPATH>"));
    };
    EXPECT_EQ(read("root", "a"), "root/a");
    EXPECT_EQ(read("root/a", "b"), "root/a/b");
    for (const char* name : {"", "/", "/a", "a/", "a//b"})
        EXPECT_THAT(errorOf<RequestError>([&] { read("root", name); }),
                    HasSubstr("expected names between slashes"))
            << name;
}

TEST(ReferenceReader, readsPathsOfEveryLength)
{
    const std::string name = "<INSTANCENAME CLASSNAME=\"CIM_B\"/>";
    const std::string nameSpace =
        R"(<LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="b"/></LOCALNAMESPACEPATH>)";
    const std::string place = "<NAMESPACEPATH><HOST>srv</HOST>" + nameSpace + "</NAMESPACEPATH>";
    const auto reference = [](const std::string& path) {
        return keyOf("<VALUE.REFERENCE>" + path + "</VALUE.REFERENCE>");
    };
    EXPECT_EQ(reference(name), cim::referenceValue({"", "", "CIM_B", {}}));
    EXPECT_EQ(reference("<LOCALINSTANCEPATH>" + nameSpace + name + "</LOCALINSTANCEPATH>"),
              cim::referenceValue({"", "root/b", "CIM_B", {}}));
    EXPECT_EQ(reference("<INSTANCEPATH>" + place + name + "</INSTANCEPATH>"),
              cim::referenceValue({"srv", "root/b", "CIM_B", {}}));
    const std::string className = "<CLASSNAME NAME=\"CIM_B\"/>";
    EXPECT_EQ(reference(className), cim::referenceValue({"", "", "CIM_B", {}}));
    EXPECT_EQ(reference("<LOCALCLASSPATH>" + nameSpace + className + "</LOCALCLASSPATH>"),
              cim::referenceValue({"", "root/b", "CIM_B", {}}));
    EXPECT_EQ(reference("<CLASSPATH>" + place + className + "</CLASSPATH>"),
              cim::referenceValue({"srv", "root/b", "CIM_B", {}}));
    EXPECT_THAT(
        errorOf<RequestError>([&] { reference("<INSTANCEPATH>" + name + place + "</INSTANCEPATH>"); }),
        HasSubstr("found this element in INSTANCEPATH, expected NAMESPACEPATH"));
}

TEST(PropertyReader, readsEveryType)
{
    EXPECT_EQ(scalarOf("string", "a"), cim::textValue("a"));
    EXPECT_EQ(scalarOf("boolean", "FALSE"), cim::booleanValue(false));
    EXPECT_EQ(scalarOf("char16", "\u98a8"), cim::unsignedValue(0x98a8, CMPI_char16));
    EXPECT_EQ(scalarOf("real32", "2"), cim::realValue(2, CMPI_real32));
    EXPECT_EQ(scalarOf("real64", "-1.5"), cim::realValue(-1.5));
    EXPECT_EQ(scalarOf("sint8", "-128"), cim::signedValue(-128, CMPI_sint8));
    EXPECT_EQ(scalarOf("sint64", "9223372036854775807"), cim::signedValue(INT64_MAX));
    EXPECT_EQ(scalarOf("uint64", "18446744073709551615"), cim::unsignedValue(UINT64_MAX));
    EXPECT_EQ(scalarOf("datetime", "00000001000000.000000:000"),
              cim::textValue("00000001000000.000000:000", CMPI_dateTime));
}

TEST(PropertyReader, refusesValuesOutsideOfTheType)
{
    const struct
    {
        const char* type;
        const char* text;
    } wrong[] = {{"uint8", "256"},
                 {"uint8", "-1"},
                 {"uint16", "65536"},
                 {"uint32", "1.0"},
                 {"sint8", "128"},
                 {"sint8", "-129"},
                 {"sint64", "9223372036854775808"},
                 {"boolean", "maybe"},
                 {"char16", ""},
                 {"char16", "ab"},
                 {"char16", "\U0001F300"},
                 {"datetime", "now"},
                 {"real64", "x"}};
    for (const auto& entry : wrong)
        EXPECT_THAT(errorOf([&] { scalarOf(entry.type, entry.text); }),
                    HasSubstr(std::string("expected a value of the type ") + entry.type))
            << entry.type << ' ' << entry.text;
}

TEST(PropertyReader, readsNullsArraysAndReferences)
{
    EXPECT_EQ(propertyOf("<PROPERTY NAME=\"P\" TYPE=\"uint8\"/>"), cim::nullValue(CMPI_uint8));
    EXPECT_EQ(propertyOf("<PROPERTY.ARRAY NAME=\"P\" TYPE=\"uint8\"/>"), cim::nullValue(CMPI_uint8A));
    EXPECT_EQ(propertyOf("<PROPERTY.ARRAY NAME=\"P\" TYPE=\"uint8\"><QUALIFIER/><VALUE.ARRAY><VALUE>1</VALUE>"
                         "<VALUE.NULL/></VALUE.ARRAY></PROPERTY.ARRAY>"),
              cim::arrayValue(CMPI_uint8, {std::uint64_t{1}, std::monostate()}));
    EXPECT_EQ(propertyOf("<PROPERTY.REFERENCE NAME=\"P\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"B\"/>"
                         "</VALUE.REFERENCE></PROPERTY.REFERENCE>"),
              cim::referenceValue({"", "", "B", {}}));
    EXPECT_EQ(propertyOf("<PROPERTY.REFERENCE NAME=\"P\"/>"), cim::nullValue(CMPI_ref));
    EXPECT_THAT(errorOf<RequestError>(
                    [] { propertyOf("<PROPERTY NAME=\"P\" TYPE=\"uint8\"><VALUE.ARRAY/></PROPERTY>"); }),
                HasSubstr("expected one VALUE"));
    EXPECT_THAT(errorOf<RequestError>([] { propertyOf("<PROPERTY NAME=\"P\"/>"); }),
                HasSubstr("no attribute TYPE"));
    EXPECT_THAT(errorOf([] {
                    propertyOf("<PROPERTY NAME=\"P\" TYPE=\"uint8\"/><PROPERTY NAME=\"p\" TYPE=\"uint8\"/>");
                }),
                HasSubstr("found the property p again"));
}

TEST(PropertyReader, readsEmbeddedInstances)
{
    const auto embedded = [](const std::string& text) {
        return propertyOf(R"(<PROPERTY NAME="P" TYPE="string" EmbeddedObject="instance"><VALUE>)" + text +
                          "</VALUE></PROPERTY>");
    };
    EXPECT_EQ(embedded("<![CDATA[<INSTANCE CLASSNAME=\"B\"/>]]>"),
              cim::instanceValue({{"", "", "B", {}}, {}}));
    EXPECT_EQ(embedded("&lt;INSTANCE CLASSNAME=\"B\"/&gt;"), cim::instanceValue({{"", "", "B", {}}, {}}));
    EXPECT_THAT(errorOf([&] { embedded("B"); }), HasSubstr("text that is no embedded instance"));
    EXPECT_THAT(errorOf([&] { embedded("&lt;CLASS/&gt;"); }), HasSubstr("expected an embedded INSTANCE"));
}

TEST(PropertyReader, boundsInstancesEmbeddedInEachOther)
{
    std::string document = "<INSTANCE CLASSNAME=\"B\"/>";
    const auto escaped = [](const std::string& text) {
        std::string result;
        for (const char byte : text)
            result += byte == '<' ? "&lt;" : byte == '&' ? "&amp;" : std::string(1, byte);
        return result;
    };
    const auto embed = [&](const std::string& inside) {
        return R"(<INSTANCE CLASSNAME="B"><PROPERTY NAME="P" TYPE="string" EmbeddedObject="instance"><VALUE>)" +
               escaped(inside) + "</VALUE></PROPERTY></INSTANCE>";
    };
    for (int depth = 0; depth < 7; ++depth)
        document = embed(document);
    EXPECT_EQ(errorOf([&] { readInstance(elementOf(document), {}); }), "");
    EXPECT_THAT(errorOf([&] { readInstance(elementOf(embed(document)), {}); }),
                HasSubstr("deep in each other"));
}

TEST(PropertyReader, knowsEachOfManyNames)
{
    const auto instance = [](const std::string& last) {
        std::string properties;
        for (int i = 0; i < 19000; ++i)
            properties += R"(<PROPERTY NAME="p)" + std::to_string(i) + R"(" TYPE="string"/>)";
        return elementOf(R"(<INSTANCE CLASSNAME="B">)" + properties + R"(<PROPERTY NAME=")" + last +
                         R"(" TYPE="string"/></INSTANCE>)");
    };
    EXPECT_EQ(readInstance(instance("p19000"), {}).properties.size(), 19001U);
    EXPECT_THAT(errorOf([&] { readInstance(instance("P7"), {}); }), HasSubstr("the property P7 again"));
}

} // namespace
