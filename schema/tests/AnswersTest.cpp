#include "Answers.h"

#include "cim/Values.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using cimhost::cim::arrayValue;
using cimhost::cim::booleanValue;
using cimhost::cim::Instance;
using cimhost::cim::nullValue;
using cimhost::cim::ObjectPath;
using cimhost::cim::referenceValue;
using cimhost::cim::textValue;
using cimhost::cim::unsignedValue;
using cimhost::schema::Classes;
using cimhost::schema::readMof;
using testing::ElementsAre;
using testing::IsEmpty;

class Answers : public testing::Test
{
protected:
    [[nodiscard]] std::vector<std::string> departuresOf(const ObjectPath& path) const
    {
        return departures(path, *classes.find(path.className), classes);
    }
    [[nodiscard]] std::vector<std::string> departuresOf(const Instance& instance) const
    {
        return departures(instance, *classes.find(instance.path.className), classes);
    }

    Classes classes{readMof(R"(class Base {};
        class A : Base { [Key] string Id; [ValueMap{"1", "2"}, Values{"a", "b"}] uint16 States[]; boolean Flag; };
        class B : Base { [Key] string Id; };
        class Link { [Key] Base REF One; [Key] A REF Other; };)",
                            "a.mof")
                        .classes};
    ObjectPath pathOfA{"", "root/cimv2", "A", {{"Id", textValue("1")}}};
    ObjectPath pathOfB{"", "root/cimv2", "B", {{"Id", textValue("2")}}};
    Instance instanceOfA{pathOfA,
                         {{"Id", textValue("1")},
                          {"States", arrayValue(CMPI_uint16, {std::uint64_t{1}})},
                          {"Flag", booleanValue(true)}}};
    ObjectPath link{
        "", "root/cimv2", "Link", {{"One", referenceValue(pathOfB)}, {"Other", referenceValue(pathOfA)}}};
};

TEST_F(Answers, AreRight)
{
    EXPECT_THAT(departuresOf(pathOfA), IsEmpty());
    EXPECT_THAT(departuresOf(instanceOfA), IsEmpty());
    EXPECT_THAT(departuresOf(link), IsEmpty());
    instanceOfA.properties[1].value = arrayValue(CMPI_uint16, {});
    EXPECT_THAT(departuresOf(instanceOfA), IsEmpty());
}

TEST_F(Answers, AreOfTheDeclaredClass)
{
    EXPECT_THAT(departures(pathOfA, *classes.find("B"), classes), ElementsAre("a path of A instead of B"));
}

TEST_F(Answers, HaveNoUndeclaredKey)
{
    pathOfA.keys.push_back({"Flag", booleanValue(true)});
    EXPECT_THAT(departuresOf(pathOfA), ElementsAre("A.Flag: is no declared key"));
    pathOfA.keys.back().name = "New";
    EXPECT_THAT(departuresOf(pathOfA), ElementsAre("A.New: is no declared key"));
}

TEST_F(Answers, HaveEveryDeclaredKey)
{
    pathOfA.keys.clear();
    EXPECT_THAT(departuresOf(pathOfA), ElementsAre("A.Id: the key is missing"));
}

TEST_F(Answers, NameKeysLetterByLetter)
{
    pathOfA.keys[0].name = "ID";
    EXPECT_THAT(departuresOf(pathOfA), ElementsAre("A.ID: is no declared key", "A.Id: the key is missing"));
}

TEST_F(Answers, HaveKeysOfTheDeclaredType)
{
    pathOfA.keys[0].value = unsignedValue(1, CMPI_uint16);
    EXPECT_THAT(departuresOf(pathOfA), ElementsAre("A.Id: is a uint16, declared as a string"));
    pathOfA.keys[0].value = nullValue(CMPI_string);
    EXPECT_THAT(departuresOf(pathOfA), ElementsAre("A.Id: has no value"));
}

TEST_F(Answers, HaveNoUndeclaredProperty)
{
    instanceOfA.properties.push_back({"New", textValue("")});
    EXPECT_THAT(departuresOf(instanceOfA), ElementsAre("A.New: is not declared"));
}

TEST_F(Answers, HaveEveryDeclaredProperty)
{
    instanceOfA.properties.pop_back();
    EXPECT_THAT(departuresOf(instanceOfA), ElementsAre("A.Flag: is not returned"));
}

TEST_F(Answers, NamePropertiesLetterByLetter)
{
    instanceOfA.properties[2].name = "flag";
    EXPECT_THAT(departuresOf(instanceOfA), ElementsAre("A.flag: is not declared", "A.Flag: is not returned"));
}

TEST_F(Answers, HavePropertiesOfTheDeclaredType)
{
    instanceOfA.properties[1].value = unsignedValue(1, CMPI_uint16);
    instanceOfA.properties[2].value = textValue("true");
    EXPECT_THAT(departuresOf(instanceOfA), ElementsAre("A.States: is a uint16, declared as a uint16[]",
                                                       "A.Flag: is a string, declared as a boolean"));
    instanceOfA.properties[1].value = arrayValue(CMPI_uint32, {});
    instanceOfA.properties[2].value = nullValue(CMPI_boolean);
    EXPECT_THAT(departuresOf(instanceOfA),
                ElementsAre("A.States: is a uint32[], declared as a uint16[]", "A.Flag: has no value"));
    instanceOfA.properties[1].value = arrayValue(CMPI_uint16, {});
    instanceOfA.properties[2].value = referenceValue(pathOfB);
    EXPECT_THAT(departuresOf(instanceOfA), ElementsAre("A.Flag: is a ref, declared as a boolean"));
}

TEST_F(Answers, LookIntoThePathsOfInstances)
{
    instanceOfA.path.keys.clear();
    EXPECT_THAT(departuresOf(instanceOfA), ElementsAre("A.Id: the key is missing"));
}

TEST_F(Answers, HaveNumbersOfTheValueMap)
{
    instanceOfA.properties[1].value =
        arrayValue(CMPI_uint16, {std::uint64_t{2}, std::uint64_t{3}, std::uint64_t{0}});
    EXPECT_THAT(departuresOf(instanceOfA),
                ElementsAre("A.States: 0 is not in its ValueMap", "A.States: 3 is not in its ValueMap"));
}

TEST_F(Answers, ReferToTheDeclaredClassOrASubclass)
{
    link.keys[1].value = referenceValue(pathOfB);
    EXPECT_THAT(departuresOf(link), ElementsAre("Link.Other: refers to a B, which is no A"));
    link.keys[1].value = textValue("A.Id=\"1\"");
    EXPECT_THAT(departuresOf(link), ElementsAre("Link.Other: is a string, declared as a A REF"));
}

TEST_F(Answers, LookIntoReferences)
{
    pathOfB.keys[0].name = "New";
    link.keys[0].value = referenceValue(pathOfB);
    EXPECT_THAT(departuresOf(link), ElementsAre("B.New: is no declared key", "B.Id: the key is missing"));
}

TEST_F(Answers, UseEveryNumberOfAValueMap)
{
    EXPECT_THAT(unusedValues({}, *classes.find("A")),
                ElementsAre("A.States: no instance has 1", "A.States: no instance has 2"));
    EXPECT_THAT(unusedValues({instanceOfA}, *classes.find("A")), ElementsAre("A.States: no instance has 2"));
    Instance other = instanceOfA;
    other.properties[1].value = arrayValue(CMPI_uint16, {std::uint64_t{2}});
    EXPECT_THAT(unusedValues({instanceOfA, other}, *classes.find("A")), IsEmpty());
}

} // namespace
