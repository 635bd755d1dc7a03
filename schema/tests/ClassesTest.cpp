#include "Classes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using schema::Class;
using schema::Classes;
using schema::readMof;
using testing::ElementsAre;
using testing::IsEmpty;

const char* const family = R"(class Base { [Key] string Id; uint16 State; };
                              class Middle : Base { [Override("State")] uint16 State; };
                              class Leaf : Middle { string Own; };
                              class Stranger : CIM_Unknown {};)";

TEST(Classes, AreFoundByNameInAnyLetterCase)
{
    const Classes classes(readMof(family, "a.mof"));
    ASSERT_NE(classes.find("LEAF"), nullptr);
    EXPECT_EQ(classes.find("LEAF")->name, "Leaf");
    EXPECT_EQ(classes.find("Lea"), nullptr);
    EXPECT_EQ(classes.find(""), nullptr);
}

TEST(Classes, KnowTheirSuperclassesNearestFirst)
{
    const Classes classes(readMof(family, "a.mof"));
    EXPECT_THAT(classes.superclassesOf(*classes.find("Leaf")),
                ElementsAre(classes.find("Middle"), classes.find("Base")));
    EXPECT_THAT(classes.superclassesOf(*classes.find("Base")), IsEmpty());
    EXPECT_THAT(classes.superclassesOf(*classes.find("Stranger")), IsEmpty());
}

TEST(Classes, DeriveFromTheirSuperclassesAndThemselves)
{
    const Classes classes(readMof(family, "a.mof"));
    EXPECT_TRUE(classes.isA("Leaf", "leaf"));
    EXPECT_TRUE(classes.isA("Leaf", "Base"));
    EXPECT_FALSE(classes.isA("Base", "Leaf"));
    EXPECT_FALSE(classes.isA("Stranger", "Base"));
    EXPECT_TRUE(classes.isA("Stranger", "CIM_Unknown"));
    EXPECT_FALSE(classes.isA("Nobody", "Base"));
}

TEST(Classes, InheritFromTheNearestSuperclass)
{
    const Classes classes(readMof(family, "a.mof"));
    const Class& leaf = *classes.find("Leaf");
    EXPECT_EQ(classes.findInherited(leaf, "state"), findProperty(*classes.find("Middle"), "State"));
    EXPECT_EQ(classes.findInherited(leaf, "Id"), findProperty(*classes.find("Base"), "Id"));
    EXPECT_EQ(classes.findInherited(leaf, "Own"), nullptr);
}

TEST(Classes, AreRefusedTwiceAndInCircles)
{
    std::vector<Class> twice = readMof("class A {};", "a.mof");
    twice.push_back(readMof("class a {};", "b.mof").front());
    EXPECT_THROW(Classes{twice}, schema::MofError);
    EXPECT_THROW(Classes{readMof("class A : A {};", "a.mof")}, schema::MofError);
    EXPECT_THROW(Classes{readMof("class A : B {}; class B : C {}; class C : B {};", "a.mof")},
                 schema::MofError);
}

TEST(TypeText, IsThatOfMof)
{
    const Class read = readMof("class A { string One; UINT16 Many[]; CIM_B REF End; };", "a.mof").front();
    EXPECT_EQ(typeText(read.properties[0]), "string");
    EXPECT_EQ(typeText(read.properties[1]), "uint16[]");
    EXPECT_EQ(typeText(read.properties[2]), "CIM_B REF");
}

} // namespace
