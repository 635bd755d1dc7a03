#include "Rules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using cimhost::schema::breaches;
using cimhost::schema::Class;
using cimhost::schema::Classes;
using cimhost::schema::readMof;
using testing::ElementsAre;
using testing::IsEmpty;

const char* const superclasses = R"(
    class CIM_Base { [Key] string Id; uint16 State; uint16 States[]; boolean Flag; };
    class CIM_End { [Key] string Id; };
    class CIM_NearEnd : CIM_End {};
    [Association] class CIM_Link { [Key] CIM_End REF One; [Key] CIM_End REF Other; };
    )";

std::vector<std::string> breachesOf(const std::string& mof)
{
    const std::vector<Class> read = readMof(mof, "a.mof").classes;
    std::vector<Class> all = readMof(superclasses, "superclasses.mof").classes;
    all.insert(all.end(), read.begin(), read.end());
    return breaches(read.front(), Classes(all));
}

/// A class that is right but for the properties given.
std::vector<std::string> breachesWith(const std::string& properties)
{
    return breachesOf(R"([Version("1.0.0"), Description("a")] class A : CIM_Base {
                          [Key, Override("Id"), Description("the key")] string Id; )" +
                      properties + "};");
}

std::vector<std::string> breachesOfLink(const std::string& endOne)
{
    return breachesOf(R"([Association, Version("1.0.0"), Description("a")] class A : CIM_Link { )" + endOne +
                      R"([Key, Override("Other"), Description("b")] CIM_NearEnd REF Other; };)");
}

TEST(Rules, AreKeptByARightClass)
{
    EXPECT_THAT(
        breachesWith(R"([Override("State"), Description("b"), ValueMap{"0", "65535"}, Values{"c", "d"}]
                                uint16 State;)"),
        IsEmpty());
    EXPECT_THAT(breachesOfLink(R"([Key, Override("One"), Description("b")] CIM_End REF One; )"), IsEmpty());
}

TEST(Rules, WantAKnownSuperclass)
{
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Description("a")] class A : CIM_None {};)"),
                ElementsAre("A: there is no superclass CIM_None"));
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Description("a")] class A {};)"),
                ElementsAre("A: there is no superclass "));
}

TEST(Rules, WantAnAssociationToSayIt)
{
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Description("a")] class A : CIM_Link {
                               [Key, Override("One"), Description("b")] CIM_End REF One;
                               [Key, Override("Other"), Description("b")] CIM_End REF Other; };)"),
                ElementsAre("A: Association does not agree with CIM_Link"));
    EXPECT_THAT(breachesOf(R"([Association, Version("1.0.0"), Description("a")] class A : CIM_Base {
                               [Key, Override("Id"), Description("b")] string Id; };)"),
                ElementsAre("A: Association does not agree with CIM_Base"));
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Association, Description("a")] class A : CIM_Link {
                               [Key, Override("One"), Description("b")] CIM_End REF One;
                               [Key, Override("Other"), Description("b")] CIM_End REF Other; };)"),
                ElementsAre("A: Association does not come first"));
}

TEST(Rules, WantVersionAndDescription)
{
    const std::string rest = R"(class A : CIM_Base { [Key, Override("Id"), Description("b")] string Id; };)";
    EXPECT_THAT(breachesOf(R"([Description("a")])" + rest),
                ElementsAre("A: has no Version of the form M.N.U"));
    EXPECT_THAT(breachesOf(R"([Version("1.0"), Description("a")])" + rest),
                ElementsAre("A: has no Version of the form M.N.U"));
    EXPECT_THAT(breachesOf(R"([Version("1.0.0")])" + rest), ElementsAre("A: has no Description"));
    EXPECT_THAT(breachesWith(R"([Override("Flag")] boolean Flag;)"),
                ElementsAre("A.Flag: has no Description"));
}

TEST(Rules, WantQualifiersThatDmtfDeclares)
{
    const std::string rest = R"(class A : CIM_Base { [Key, Override("Id"), Description("b")] string Id; };)";
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Description("a"), Colour("red")])" + rest),
                ElementsAre("A: DMTF declares no such qualifier Colour"));
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Description("a"), Key])" + rest),
                ElementsAre("A: DMTF declares no such qualifier Key"));
    EXPECT_THAT(breachesWith(R"([Override("Flag"), Description("b"), Version("1.0.0")] boolean Flag;)"),
                ElementsAre("A.Flag: DMTF declares no such qualifier Version"));
    EXPECT_THAT(breachesWith(R"([Override("Flag"), description("b")] boolean Flag;)"),
                ElementsAre("A.Flag: DMTF declares no such qualifier description"));
    EXPECT_THAT(breachesWith(R"([Override("Flag"), Description{"b"}] boolean Flag;)"),
                ElementsAre("A.Flag: DMTF declares no such qualifier Description"));
}

TEST(Rules, WantOverridesOfWhatThereIs)
{
    EXPECT_THAT(breachesWith(R"([Override("New"), Description("b")] string New;)"),
                ElementsAre("A.New: overrides nothing"));
    EXPECT_THAT(breachesWith(R"([Override("flag"), Description("b")] boolean flag;)"),
                ElementsAre("A.flag: overrides nothing"));
    EXPECT_THAT(breachesWith(R"([Description("b")] boolean Flag;)"),
                ElementsAre("A.Flag: has no Override with its own name"));
    EXPECT_THAT(breachesWith(R"([Override("State"), Description("b")] boolean Flag;)"),
                ElementsAre("A.Flag: has no Override with its own name"));
}

TEST(Rules, WantOverridesOfTheSameType)
{
    EXPECT_THAT(breachesWith(R"([Override("Flag"), Description("b")] string Flag;)"),
                ElementsAre("A.Flag: is a string and overrides a boolean"));
    EXPECT_THAT(breachesWith(R"([Override("State"), Description("b")] uint16 State[];)"),
                ElementsAre("A.State: is a uint16[] and overrides a uint16"));
    EXPECT_THAT(breachesWith(R"([Override("States"), Description("b")] uint16 States;)"),
                ElementsAre("A.States: is a uint16 and overrides a uint16[]"));
}

TEST(Rules, WantReferencesToTheSameClassOrASubclass)
{
    EXPECT_THAT(breachesOfLink(R"([Key, Override("One"), Description("b")] CIM_NearEnd REF One; )"),
                IsEmpty());
    EXPECT_THAT(breachesOfLink(R"([Key, Override("One"), Description("b")] CIM_Base REF One; )"),
                ElementsAre("A.One: is a CIM_Base REF and overrides a CIM_End REF"));
    EXPECT_THAT(breachesOfLink(R"([Key, Override("One"), Description("b")] string One; )"),
                ElementsAre("A.One: is a string and overrides a CIM_End REF"));
}

TEST(Rules, WantExactlyTheInheritedKeys)
{
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Description("a")] class A : CIM_Base {};)"),
                ElementsAre("A: the key Id is not declared"));
    EXPECT_THAT(breachesOf(R"([Version("1.0.0"), Description("a")] class A : CIM_Base {
                               [Override("Id"), Description("b")] string Id; };)"),
                ElementsAre("A: the key Id is not declared"));
    EXPECT_THAT(breachesWith(R"([Key, Override("Flag"), Description("b")] boolean Flag;)"),
                ElementsAre("A.Flag: is no key of a superclass"));
}

TEST(Rules, WantAWordForEachValue)
{
    const auto breachesOfValues = [](const std::string& qualifiers) {
        return breachesWith(R"([Override("State"), Description("b"), )" + qualifiers + "] uint16 State;");
    };
    EXPECT_THAT(breachesOfValues(R"(ValueMap{"0"})"),
                ElementsAre("A.State: ValueMap and Values are not of equal number"));
    EXPECT_THAT(breachesOfValues(R"(Values{"a"})"),
                ElementsAre("A.State: ValueMap and Values are not of equal number"));
    EXPECT_THAT(breachesOfValues(R"(ValueMap{"0"}, Values{"a", "b"})"),
                ElementsAre("A.State: ValueMap and Values are not of equal number"));
    EXPECT_THAT(breachesOfValues(R"(ValueMap{"0", "0"}, Values{"a", "b"})"),
                ElementsAre("A.State: ValueMap has a number twice"));
    for (const std::string number : {"65536", "-1", "01", "..", "", "99999999999999999999"})
        EXPECT_THAT(breachesOfValues(R"(ValueMap{")" + number + R"("}, Values{"a"})"),
                    ElementsAre("A.State: ValueMap has " + number + ", which is no uint16"));
    EXPECT_THAT(
        breachesWith(R"([Override("Flag"), Description("b"), ValueMap{"0"}, Values{"a"}] boolean Flag;)"),
        ElementsAre("A.Flag: ValueMap has 0, which is no uint16"));
}

} // namespace
