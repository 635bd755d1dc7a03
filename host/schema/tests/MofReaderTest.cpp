#include "schema/MofReader.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using cimhost::schema::Class;
using cimhost::schema::MofError;
using cimhost::schema::Parameter;
using cimhost::schema::readMof;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

TEST(MofReader, ReadsNothingFromNothing)
{
    EXPECT_THAT(readMof("", "a.mof").classes, IsEmpty());
    EXPECT_THAT(readMof(" \t\r\n// only a comment", "a.mof").classes, IsEmpty());
}

TEST(MofReader, ReadsAClassWithoutAnything)
{
    const std::vector<Class> classes = readMof("class A_B2 {};", "a.mof").classes;
    ASSERT_THAT(classes, SizeIs(1));
    EXPECT_EQ(classes[0].name, "A_B2");
    EXPECT_EQ(classes[0].superclass, "");
    EXPECT_THAT(classes[0].qualifiers, IsEmpty());
    EXPECT_THAT(classes[0].properties, IsEmpty());
}

TEST(MofReader, ReadsClassesInTheirOrderWithTheirSuperclasses)
{
    const std::vector<Class> classes = readMof("class B : CIM_B {}; CLASS A:CIM_A {};", "a.mof").classes;
    ASSERT_THAT(classes, SizeIs(2));
    EXPECT_EQ(classes[0].name, "B");
    EXPECT_EQ(classes[0].superclass, "CIM_B");
    EXPECT_EQ(classes[1].name, "A");
    EXPECT_EQ(classes[1].superclass, "CIM_A");
}

TEST(MofReader, ReadsPropertiesArraysAndReferences)
{
    const auto properties =
        readMof("class A { UINT16 One; string Many[]; CIM_Other REF End; };", "a.mof").classes[0].properties;
    ASSERT_THAT(properties, SizeIs(3));
    EXPECT_EQ(properties[0].name, "One");
    EXPECT_EQ(properties[0].type, "uint16");
    EXPECT_FALSE(properties[0].isArray);
    EXPECT_FALSE(properties[0].isReference);
    EXPECT_EQ(properties[1].name, "Many");
    EXPECT_EQ(properties[1].type, "string");
    EXPECT_TRUE(properties[1].isArray);
    EXPECT_EQ(properties[2].name, "End");
    EXPECT_EQ(properties[2].type, "CIM_Other");
    EXPECT_TRUE(properties[2].isReference);
    EXPECT_FALSE(properties[2].isArray);
}

TEST(MofReader, ReadsDefaultValues)
{
    const auto properties =
        readMof(R"(class A { uint16 One = 5; string Many[] = {"a", "b"}; string None; };)", "a.mof")
            .classes[0]
            .properties;
    EXPECT_THAT(properties[0].defaultValue.elements, ElementsAre("5"));
    EXPECT_TRUE(properties[1].defaultValue.isArray);
    EXPECT_THAT(properties[1].defaultValue.elements, ElementsAre("a", "b"));
    EXPECT_EQ(properties[2].defaultValue.kind, cimhost::schema::WrittenValue::Null);
}

TEST(MofReader, ReadsClassesAndInstancesOfOneText)
{
    const auto read = readMof("instance of A {}; class A {}; instance of A {};", "a.mof");
    EXPECT_THAT(read.classes, SizeIs(1));
    EXPECT_THAT(read.instances, SizeIs(2));
}

TEST(MofReader, ReadsEveryIntrinsicType)
{
    for (const std::string type : {"boolean", "char16", "datetime", "real32", "real64", "sint8", "sint16",
                                   "sint32", "sint64", "string", "uint8", "uint16", "uint32", "uint64"})
        EXPECT_EQ(readMof("class A { " + type + " P; };", "a.mof").classes[0].properties[0].type, type);
}

TEST(MofReader, ReadsQualifiersOfEveryKind)
{
    const Class read =
        readMof(R"([Association, Version ( "1.0.0" ), MaxLen (64), Min(-1), Experimental(FALSE),
                                   Values { "a", "b" "c" }] class A { [Key] string P; };)",
                "a.mof")
            .classes[0];
    ASSERT_THAT(read.qualifiers, SizeIs(6));
    EXPECT_EQ(read.qualifiers[0].name, "Association");
    EXPECT_EQ(read.qualifiers[0].kind, Parameter::None);
    EXPECT_THAT(read.qualifiers[0].values, IsEmpty());
    EXPECT_EQ(read.qualifiers[1].kind, Parameter::Text);
    EXPECT_THAT(read.qualifiers[1].values, ElementsAre("1.0.0"));
    EXPECT_EQ(read.qualifiers[2].kind, Parameter::Number);
    EXPECT_THAT(read.qualifiers[2].values, ElementsAre("64"));
    EXPECT_THAT(read.qualifiers[3].values, ElementsAre("-1"));
    EXPECT_EQ(read.qualifiers[4].kind, Parameter::Flag);
    EXPECT_THAT(read.qualifiers[4].values, ElementsAre("false"));
    EXPECT_EQ(read.qualifiers[5].kind, Parameter::Texts);
    EXPECT_THAT(read.qualifiers[5].values, ElementsAre("a", "bc"));
    ASSERT_THAT(read.properties[0].qualifiers, SizeIs(1));
    EXPECT_EQ(read.properties[0].qualifiers[0].name, "Key");
}

TEST(MofReader, JoinsTextsAndReadsTheirEscapes)
{
    const Class read =
        readMof("[Description ( \"one \"\n   \"\\\"two\\\" \\\\ // three\" )] class A {};", "a.mof")
            .classes[0];
    EXPECT_THAT(read.qualifiers[0].values, ElementsAre("one \"two\" \\ // three"));
}

TEST(MofReader, SkipsCommentsAndPragmas)
{
    const std::string text = "// first\n#pragma locale (\"en_US\")\n/* class B {};\n */ class A { // rest\n"
                             "string /**/ P; /* * / */ };\n#pragma include (\"b.mof\")";
    const std::vector<Class> classes = readMof(text, "a.mof").classes;
    ASSERT_THAT(classes, SizeIs(1));
    ASSERT_THAT(classes[0].properties, SizeIs(1));
    EXPECT_EQ(classes[0].properties[0].name, "P");
}

struct BadText
{
    const char* text;
    const char* error;
};

void PrintTo(const BadText& bad, std::ostream* stream)
{
    *stream << testing::PrintToString(bad.text); // escapes what is not to be printed
}

class MofReaderRefuses : public testing::TestWithParam<BadText>
{};

TEST_P(MofReaderRefuses, WithThePlaceAndWhatWasExpected)
{
    try {
        readMof(GetParam().text, "a.mof");
        FAIL() << "read it";
    } catch (const MofError& error) {
        EXPECT_STREQ(error.what(), GetParam().error);
    }
}

INSTANTIATE_TEST_SUITE_P(
    Texts, MofReaderRefuses,
    testing::Values(
        BadText{"class", "a.mof:1:6: expected the name of the class, found the end of the file"},
        BadText{"klass A {};", "a.mof:1:1: expected class, found \"klass\""},
        BadText{"class 1A {};", "a.mof:1:7: expected the name of the class, found \"1\""},
        BadText{"class A : {};", "a.mof:1:11: expected the name of the superclass, found \"{\""},
        BadText{"class A;", "a.mof:1:8: expected {, found \";\""},
        BadText{"class A {", "a.mof:1:10: expected the type of a property, found the end of the file"},
        BadText{"class A {}", "a.mof:1:11: expected ;, found the end of the file"},
        BadText{"class A {\n};\n}", "a.mof:3:1: expected class, found \"}\""},
        BadText{"class A {};\nclass a {};", "a.mof:2:1: there is already a class a"},
        BadText{"class A { string P };", "a.mof:1:20: expected ;, found \"}\""},
        BadText{"class A { string; };", "a.mof:1:17: expected the name of the property, found \";\""},
        BadText{"class A {\n text\nP; };", "a.mof:2:2: expected the type of a property, found \"text\""},
        BadText{"class A { string P; uint8 p; };", "a.mof:1:21: there is already a property p"},
        BadText{"class A { string P[; };", "a.mof:1:20: expected ], found \";\""},
        BadText{"class A { string P[2]; };", "a.mof:1:20: expected ], found \"2\""},
        BadText{"class A { B REF E[]; };", "a.mof:1:18: expected ;, found \"[\""},
        BadText{"class A { B REF; };", "a.mof:1:16: expected the name of the property, found \";\""},
        BadText{"class A { string P = x; };", "a.mof:1:22: expected a value, found \"x\""},
        BadText{"class A { B REF E = 1; };", "a.mof:1:19: expected ;, found \"=\""},
        BadText{"class A { uint32 Method(); };", "a.mof:1:24: expected ;, found \"(\""},
        BadText{"Qualifier Key : boolean;", "a.mof:1:1: expected class, found \"Qualifier\""},
        BadText{"[] class A {};", "a.mof:1:2: expected the name of a qualifier, found \"]\""},
        BadText{"[Key class A {};", "a.mof:1:6: expected ], found \"class\""},
        BadText{"[Key,] class A {};", "a.mof:1:6: expected the name of a qualifier, found \"]\""},
        BadText{"[Key, key] class A {};", "a.mof:1:7: there is already a qualifier key"},
        BadText{"[Key : ToSubclass] class A {};", "a.mof:1:6: expected ], found \":\""},
        BadText{"[Version ( 1.0 )] class A {};", "a.mof:1:13: expected ), found \".\""},
        BadText{"[Version ( )] class A {};", "a.mof:1:12: expected the value of the qualifier, found \")\""},
        BadText{"[Version ( \"1\" ] class A {};", "a.mof:1:16: expected ), found \"]\""},
        BadText{"[Values { }] class A {};", "a.mof:1:11: expected a text in quotes, found \"}\""},
        BadText{"[Values { \"a\", }] class A {};", "a.mof:1:16: expected a text in quotes, found \"}\""},
        BadText{"[Values { \"a\" ] class A {};", "a.mof:1:15: expected }, found \"]\""},
        BadText{"[Values { 1 }] class A {};", "a.mof:1:11: expected a text in quotes, found \"1\""},
        BadText{"\n[Description ( \"open\n\" )] class A {};",
                "a.mof:2:16: the text has no closing quote on its line"},
        BadText{"[Description ( \"open", "a.mof:1:16: the text has no closing quote on its line"},
        BadText{"[Description ( \"\\n\" )] class A {};",
                "a.mof:1:18: expected \\\" or \\\\ after a backslash"},
        BadText{"[Description ( \"\\", "a.mof:1:18: expected \\\" or \\\\ after a backslash"},
        BadText{"class A {\n/* open\n};", "a.mof:2:1: the comment has no end"},
        BadText{"#include <x>", "a.mof:1:2: expected pragma, found \"include\""},
        BadText{"#pragma locale", "a.mof:1:15: expected (, found the end of the file"},
        BadText{"#pragma locale ()", "a.mof:1:17: expected a text in quotes, found \")\""},
        BadText{"\xff", "a.mof:1:1: expected class, found \"\xef\xbf\xbd\""}));

TEST(MofReader, ReadsInstancesInTheirOrderWithTheirValues)
{
    const std::vector<cimhost::schema::WrittenInstance> instances =
        cimhost::schema::readMof(
            "// first\ninstance of B { Name = \"a\" \"b\"; Count = -3; On = TRUE; None = NULL; };\n"
            "INSTANCE OF A { Names = {\"x\", \"y\"}; Types = {2, 3}; };",
            "a.mof")
            .instances;
    ASSERT_THAT(instances, SizeIs(2));
    EXPECT_EQ(instances[0].className, "B");
    ASSERT_THAT(instances[0].values, SizeIs(4));
    EXPECT_EQ(instances[0].values.at("Name").kind, cimhost::schema::WrittenValue::Text);
    EXPECT_FALSE(instances[0].values.at("Name").isArray);
    EXPECT_THAT(instances[0].values.at("Name").elements, ElementsAre("ab"));
    EXPECT_EQ(instances[0].values.at("Count").kind, cimhost::schema::WrittenValue::Number);
    EXPECT_THAT(instances[0].values.at("Count").elements, ElementsAre("-3"));
    EXPECT_EQ(instances[0].values.at("On").kind, cimhost::schema::WrittenValue::Flag);
    EXPECT_THAT(instances[0].values.at("On").elements, ElementsAre("true"));
    EXPECT_EQ(instances[0].values.at("None").kind, cimhost::schema::WrittenValue::Null);
    EXPECT_THAT(instances[0].values.at("None").elements, IsEmpty());
    EXPECT_EQ(instances[1].className, "A");
    EXPECT_TRUE(instances[1].values.at("Names").isArray);
    EXPECT_THAT(instances[1].values.at("Names").elements, ElementsAre("x", "y"));
    EXPECT_EQ(instances[1].values.at("Types").kind, cimhost::schema::WrittenValue::Number);
    EXPECT_THAT(instances[1].values.at("Types").elements, ElementsAre("2", "3"));
}

INSTANTIATE_TEST_SUITE_P(
    InstanceTexts, MofReaderRefuses,
    testing::Values(BadText{"instance A {};", "a.mof:1:10: expected of, found \"A\""},
                    BadText{"instance of {};", "a.mof:1:13: expected the name of the class, found \"{\""},
                    BadText{"instance of A as $a {};", "a.mof:1:15: expected {, found \"as\""},
                    BadText{"instance of A {}", "a.mof:1:17: expected ;, found the end of the file"},
                    BadText{"instance of A { P; };", "a.mof:1:18: expected =, found \";\""},
                    BadText{"instance of A { P = ; };", "a.mof:1:21: expected a value, found \";\""},
                    BadText{"instance of A { P = word; };", "a.mof:1:21: expected a value, found \"word\""},
                    BadText{"instance of A { P = 1\n};", "a.mof:2:1: expected ;, found \"}\""},
                    BadText{"instance of A { P = 1;\nP = 2; };", "a.mof:2:1: there is already a value of P"},
                    BadText{"instance of A { P = {}; };", "a.mof:1:22: expected a value, found \"}\""},
                    BadText{"instance of A { P = {1, }; };", "a.mof:1:25: expected a value, found \"}\""},
                    BadText{"instance of A { P = {1 2}; };", "a.mof:1:24: expected }, found \"2\""},
                    BadText{"instance of A { P = {1,\n\"a\"}; };",
                            "a.mof:2:1: the elements of the array are of different kinds"}));

TEST(MofReader, RefusesAFileThatCannotBeRead)
{
    EXPECT_THROW(cimhost::schema::readMofFile("/no/such/file.mof"), MofError);
    EXPECT_THROW(cimhost::schema::readMofFile("/"), MofError);
}

} // namespace
