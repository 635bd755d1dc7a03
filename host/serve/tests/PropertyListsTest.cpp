// Which names of a property list reach a provider.

#include "serve/PropertyLists.h"

#include "schema/MofReader.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::serve;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

std::vector<std::string> shortened(cim::PropertyList list, const std::string& served = "A")
{
    const schema::Classes classes(
        schema::readMof("class A { string Name; string Caption; }; class B : A { string Size; };", "a.mof")
            .classes);
    Registration registration;
    registration.classes.push_back({served, "P", "L", true, false, {}});
    PropertyLists(classes, registration).shorten(list);
    return list.value_or(std::vector<std::string>{"no list"});
}

TEST(PropertyLists, dropNamesThatAreThereAgain)
{
    EXPECT_THAT(shortened({{"Name", "Size", "Name"}}), ElementsAre("Name", "Size"));
    EXPECT_THAT(shortened({{"NAME", "name", "Name", "nAME"}}), ElementsAre("NAME", "Name"));
    EXPECT_THAT(shortened({{"x", "X", "y"}}, "Z"), ElementsAre("x", "y"));
}

TEST(PropertyLists, dropNamesThatNoClassHas)
{
    EXPECT_THAT(shortened({{"x", "Name", "y"}}), ElementsAre("Name"));
    EXPECT_THAT(shortened({{"x", "y"}}), ElementsAre("x"));
}

TEST(PropertyLists, keepWhatAClassThatIsNotKnownMayHave)
{
    EXPECT_THAT(shortened({{"x", "Name", "y"}}, "Z"), ElementsAre("x", "Name", "y"));
}

TEST(PropertyLists, mayBeMissing)
{
    EXPECT_THAT(shortened(std::nullopt), ElementsAre("no list"));
    EXPECT_THAT(shortened(std::vector<std::string>{}), IsEmpty());
}

} // namespace
