#include "schema/Classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using cimhost::schema::Class;
using cimhost::schema::Classes;
using cimhost::schema::readMof;
using testing::ElementsAre;
using testing::IsEmpty;

const char* const family = R"(class Base { [Key] string Id; uint16 State; };
                              class Middle : Base { [Override("State")] uint16 State; };
                              class Leaf : Middle { string Own; };
                              class Stranger : CIM_Unknown {};)";

TEST(Classes, AreFoundByNameInAnyLetterCase)
{
    const Classes classes(readMof(family, "a.mof").classes);
    ASSERT_NE(classes.find("LEAF"), nullptr);
    EXPECT_EQ(classes.find("LEAF")->name, "Leaf");
    EXPECT_EQ(classes.find("Lea"), nullptr);
    EXPECT_EQ(classes.find(""), nullptr);
}

TEST(Classes, KnowTheirSuperclassesNearestFirst)
{
    const Classes classes(readMof(family, "a.mof").classes);
    EXPECT_THAT(classes.superclassesOf(*classes.find("Leaf")),
                ElementsAre(classes.find("Middle"), classes.find("Base")));
    EXPECT_THAT(classes.superclassesOf(*classes.find("Base")), IsEmpty());
    EXPECT_THAT(classes.superclassesOf(*classes.find("Stranger")), IsEmpty());
}

TEST(Classes, DeriveFromTheirSuperclassesAndThemselves)
{
    const Classes classes(readMof(family, "a.mof").classes);
    EXPECT_TRUE(classes.isA("Leaf", "leaf"));
    EXPECT_TRUE(classes.isA("Leaf", "Base"));
    EXPECT_FALSE(classes.isA("Base", "Leaf"));
    EXPECT_FALSE(classes.isA("Stranger", "Base"));
    EXPECT_TRUE(classes.isA("Stranger", "CIM_Unknown"));
    EXPECT_FALSE(classes.isA("Nobody", "Base"));
}

TEST(Classes, InheritFromTheNearestSuperclass)
{
    const Classes classes(readMof(family, "a.mof").classes);
    const Class& leaf = *classes.find("Leaf");
    EXPECT_EQ(classes.findInherited(leaf, "state"), findProperty(*classes.find("Middle"), "State"));
    EXPECT_EQ(classes.findInherited(leaf, "Id"), findProperty(*classes.find("Base"), "Id"));
    EXPECT_EQ(classes.findInherited(leaf, "Own"), nullptr);
}

std::vector<std::string> names(const std::vector<const Class*>& classes)
{
    std::vector<std::string> result;
    result.reserve(classes.size());
    for (const Class* const declaration : classes)
        result.push_back(declaration->name);
    return result;
}

TEST(Classes, KnowTheirSubclasses)
{
    const Classes classes(readMof(family, "a.mof").classes);
    EXPECT_THAT(names(classes.subclassesOf("base", false)), ElementsAre("Middle"));
    EXPECT_THAT(names(classes.subclassesOf("base", true)), ElementsAre("Middle", "Leaf"));
    EXPECT_THAT(names(classes.subclassesOf("CIM_Unknown", true)), ElementsAre("Stranger"));
    EXPECT_THAT(names(classes.subclassesOf("", false)), ElementsAre("Base", "Stranger"));
    EXPECT_THAT(names(classes.subclassesOf("", true)), ElementsAre("Base", "Middle", "Leaf", "Stranger"));
    EXPECT_THAT(classes.subclassesOf("Leaf", true), IsEmpty());
}

TEST(Classes, AreCompletedByWhatTheyInherit)
{
    const Classes classes(
        readMof(R"([Version("1"), Description("base")] class Base { [Key, Description("id")] string Id;
                       [Description("state"), MaxLen(3)] uint16 State; };
                   [Version("2")] class Leaf : Base { string Own;
                       [Override("State"), Description("leaf's")] uint16 State; };)",
                "a.mof")
            .classes);
    const Class leaf = classes.completed(*classes.find("Leaf"));
    const auto said = [](const std::vector<cimhost::schema::Qualifier>& qualifiers) {
        std::string text;
        for (const auto& qualifier : qualifiers)
            text += qualifier.name + (qualifier.values.empty() ? "" : "=" + qualifier.values[0]) +
                    (qualifier.isInherited ? " inherited;" : ";");
        return text;
    };
    EXPECT_EQ(said(leaf.qualifiers), "Version=2;Description=base inherited;");
    ASSERT_EQ(leaf.properties.size(), 3U);
    EXPECT_EQ(leaf.properties[0].name, "Id");
    EXPECT_TRUE(leaf.properties[0].isInherited);
    EXPECT_EQ(leaf.properties[0].origin, "Base");
    EXPECT_EQ(said(leaf.properties[0].qualifiers), "Key inherited;Description=id inherited;");
    EXPECT_EQ(leaf.properties[1].name, "State");
    EXPECT_FALSE(leaf.properties[1].isInherited);
    EXPECT_EQ(leaf.properties[1].origin, "Base");
    EXPECT_EQ(said(leaf.properties[1].qualifiers), "Override=State;Description=leaf's;MaxLen=3 inherited;");
    EXPECT_EQ(leaf.properties[2].name, "Own");
    EXPECT_EQ(leaf.properties[2].origin, "Leaf");
}

TEST(Classes, HaveTheKeysThatTheyInherit)
{
    const Classes classes(readMof(family, "a.mof").classes);
    EXPECT_THAT(classes.keysOf("leaf"), ElementsAre("Id"));
    EXPECT_THAT(classes.keysOf("Stranger"), IsEmpty());
    EXPECT_THAT(classes.keysOf("Nobody"), IsEmpty());
}

TEST(Classes, TellWhereAPropertyComesFrom)
{
    const Classes classes(readMof(family, "a.mof").classes);
    EXPECT_EQ(classes.originOf("Leaf", "state"), "Base");
    EXPECT_EQ(classes.originOf("Leaf", "Own"), "Leaf");
    EXPECT_EQ(classes.originOf("Middle", "Own"), "");
    EXPECT_EQ(classes.originOf("Nobody", "Own"), "");
}

TEST(Classes, DeriveFromSixtyFourOthersAtMost)
{
    std::string text = "class C0 {};";
    for (int depth = 1; depth <= 64; ++depth)
        text += "class C" + std::to_string(depth) + " : C" + std::to_string(depth - 1) + " {};";
    EXPECT_NO_THROW(Classes{readMof(text, "a.mof").classes});
    EXPECT_THROW(Classes{readMof(text + "class D : C64 {};", "a.mof").classes}, cimhost::schema::MofError);
}

TEST(Classes, AreRefusedTwiceAndInCircles)
{
    std::vector<Class> twice = readMof("class A {};", "a.mof").classes;
    twice.push_back(readMof("class a {};", "b.mof").classes.front());
    EXPECT_THROW(Classes{twice}, cimhost::schema::MofError);
    EXPECT_THROW(Classes{readMof("class A : A {};", "a.mof").classes}, cimhost::schema::MofError);
    EXPECT_THROW(Classes{readMof("class A : B {}; class B : C {}; class C : B {};", "a.mof").classes},
                 cimhost::schema::MofError);
}

TEST(TypeText, IsThatOfMof)
{
    const Class read =
        readMof("class A { string One; UINT16 Many[]; CIM_B REF End; };", "a.mof").classes.front();
    EXPECT_EQ(typeText(read.properties[0]), "string");
    EXPECT_EQ(typeText(read.properties[1]), "uint16[]");
    EXPECT_EQ(typeText(read.properties[2]), "CIM_B REF");
}

} // namespace
