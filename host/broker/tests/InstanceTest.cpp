#include "BrokerFixture.h"

namespace cimhost {

namespace {

using testing::ElementsAre;

class InstanceTest : public RequestFixture
{
protected:
    CMPIInstance* const instance_ = mb()->eft->newInstance(mb(), newPath(), nullptr);
    const CMPIInstanceFT& ft_ = *instance_->ft;

    CMPIStatus setText(const char* name, const char* text, CMPIInstance* instance = nullptr)
    {
        return ft_.setProperty(instance == nullptr ? instance_ : instance, name, chars(text), CMPI_chars);
    }
    CMPIStatus setReference(const char* name, const cim::ObjectPath& path, CMPIInstance* instance = nullptr)
    {
        CMPIValue value{};
        value.ref = request_.path(path);
        return ft_.setProperty(instance == nullptr ? instance_ : instance, name, &value, CMPI_ref);
    }
    CMPIStatus filter(std::vector<const char*> properties, std::vector<const char*> keys)
    {
        properties.push_back(nullptr);
        keys.push_back(nullptr);
        return ft_.setPropertyFilter(instance_, properties.data(), keys.data());
    }
    std::vector<std::string> propertyNames()
    {
        std::vector<std::string> names;
        const cim::Instance instance = *read(instance_);
        for (const cim::Property& property : instance.properties)
            names.push_back(property.name);
        return names;
    }
    cim::ObjectPath pathOf(const CMPIInstance* instance) const
    {
        return *read(ft_.getObjectPath(instance, nullptr));
    }
};

TEST_F(InstanceTest, FindsPropertiesIgnoringLetterCase)
{
    EXPECT_EQ(setText("Name", "one"), CMPI_RC_OK);
    const CMPIData property = ft_.getProperty(instance_, "nAME", &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(property.type, CMPI_string);
    EXPECT_EQ(property.state, CMPI_goodValue);
    EXPECT_EQ(textOf(property.value.string), "one");
}

TEST_F(InstanceTest, SaysThatAPropertyIsMissing)
{
    EXPECT_EQ(ft_.getProperty(instance_, "Name", &rc_).state, CMPI_notFound);
    EXPECT_EQ(code(), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(ft_.getPropertyAt(instance_, 0, nullptr, &rc_).state, CMPI_notFound);
    EXPECT_EQ(code(), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    expectNoMisuse();
}

TEST_F(InstanceTest, ListsPropertiesInTheirOrder)
{
    setText("Second", "2");
    setText("First", "1");
    setText("SECOND", "two");
    EXPECT_EQ(ft_.getPropertyCount(instance_, &rc_), 2U);
    EXPECT_EQ(code(), CMPI_RC_OK);
    CMPIString* name = nullptr;
    const CMPIData property = ft_.getPropertyAt(instance_, 0, &name, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(name), "Second");
    EXPECT_EQ(textOf(property.value.string), "two");
}

TEST_F(InstanceTest, KeepsTheTypeThatIsGiven)
{
    setText("Name", "one");
    CMPIValue value{};
    value.uint8 = 7;
    EXPECT_EQ(ft_.setProperty(instance_, "Name", &value, CMPI_uint8), CMPI_RC_OK);
    EXPECT_EQ(ft_.getProperty(instance_, "Name", nullptr).type, CMPI_uint8);
    EXPECT_EQ(ft_.setPropertyWithOrigin(instance_, "Name", chars("x"), CMPI_chars, "TEST_Base"), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getProperty(instance_, "Name", nullptr).value.string), "x");
}

TEST_F(InstanceTest, NeedsAPropertyName)
{
    EXPECT_EQ(setText(nullptr, "x"), CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIInstanceFT.setProperty: the name is null");
}

TEST_F(InstanceTest, DropsWhatTheFilterDoesNotName)
{
    EXPECT_EQ(filter({"wanted", "Empty"}, {"kEY"}), CMPI_RC_OK);
    EXPECT_EQ(setText("Wanted", "1"), CMPI_RC_OK);
    EXPECT_EQ(setText("Other", "2"), CMPI_RC_OK);
    EXPECT_EQ(setText("Key", "3"), CMPI_RC_OK);
    EXPECT_THAT(propertyNames(), ElementsAre("Wanted", "Key"));
    EXPECT_EQ(ft_.getProperty(instance_, "Other", &rc_).state, CMPI_notFound);
    EXPECT_EQ(code(), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    expectNoMisuse();
}

TEST_F(InstanceTest, HasAFilterOfItsOwn)
{
    // A provider has one list for its instances, and may change it between two of them.
    const char* list[] = {"First", "Second", nullptr};
    CMPIInstance* const others[] = {mb()->eft->newInstance(mb(), newPath(), nullptr),
                                    mb()->eft->newInstance(mb(), newPath(), nullptr)};
    EXPECT_EQ(ft_.setPropertyFilter(instance_, list, nullptr), CMPI_RC_OK);
    EXPECT_EQ(ft_.setPropertyFilter(others[0], list, nullptr), CMPI_RC_OK);
    list[1] = nullptr;
    EXPECT_EQ(ft_.setPropertyFilter(others[1], list, nullptr), CMPI_RC_OK);
    for (CMPIInstance* const instance : {instance_, others[0], others[1]})
        for (const char* name : {"first", "second", "third"})
            setText(name, "x", instance);
    EXPECT_THAT(propertyNames(), ElementsAre("first", "second"));
    EXPECT_EQ(read(others[0])->properties.size(), 2U);
    EXPECT_EQ(read(others[1])->properties.size(), 1U);
}

TEST_F(InstanceTest, FiltersWhatIsThereAlready)
{
    setText("Other", "2");
    setText("Wanted", "1");
    setText("Another", "2");
    filter({"Wanted"}, {});
    EXPECT_THAT(propertyNames(), ElementsAre("Wanted"));
}

TEST_F(InstanceTest, AnEmptyFilterLeavesTheKeys)
{
    filter({}, {"Key"});
    setText("Key", "1");
    setText("Other", "2");
    EXPECT_THAT(propertyNames(), ElementsAre("Key"));
}

TEST_F(InstanceTest, NoListIsNoFilter)
{
    filter({"Wanted"}, {"Key"});
    EXPECT_EQ(ft_.setPropertyFilter(instance_, nullptr, nullptr), CMPI_RC_OK);
    setText("Other", "2");
    EXPECT_THAT(propertyNames(), ElementsAre("Other"));
}

TEST_F(InstanceTest, HasThePathThatItWasMadeWith)
{
    CMPIObjectPath* const path = request_.path(thingPath("one"));
    CMPIInstance* const instance = mb()->eft->newInstance(mb(), path, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    path->ft->setNameSpace(path, "root/later");
    setReference("Owner", thingPath("three"), instance); // a reference, but no key: the path has its keys
    CMPIObjectPath* const own = ft_.getObjectPath(instance, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(read(own), thingPath("one"));
    own->ft->setNameSpace(own, "root/mine");
    EXPECT_EQ(pathOf(instance), thingPath("one"));
}

TEST_F(InstanceTest, TakesAnotherPath)
{
    EXPECT_EQ(ft_.setObjectPath(instance_, request_.path(thingPath("three"))), CMPI_RC_OK);
    EXPECT_EQ(pathOf(instance_), thingPath("three"));
    EXPECT_EQ(ft_.setObjectPath(instance_, nullptr), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIInstanceFT.setObjectPath: the object path is null");
}

TEST_F(InstanceTest, TakesKeysOfTheKeyListFromTheProperties)
{
    filter({"Size"}, {"Name", "Unset"});
    setText("Name", "one");
    setText("Size", "3");
    EXPECT_EQ(pathOf(instance_), thingPath("one"));
    EXPECT_EQ(read(instance_)->path, thingPath("one"));
}

TEST_F(InstanceTest, LeavesTheKeysThatThePathHas)
{
    CMPIInstance* const instance = mb()->eft->newInstance(mb(), request_.path(thingPath("one")), nullptr);
    const char* keys[] = {"Name", "Extra", nullptr};
    ft_.setPropertyFilter(instance, nullptr, keys);
    setText("Name", "other", instance);
    setText("Extra", "more", instance);
    cim::ObjectPath expected = thingPath("one");
    expected.keys.push_back({"Extra", cim::textValue("more")});
    EXPECT_EQ(pathOf(instance), expected);
}

cim::ObjectPath linkPath()
{
    return {"",
            testNameSpace,
            "TEST_Thing",
            {{"Left", cim::referenceValue(thingPath("one"))},
             {"Right", cim::referenceValue(thingPath("three"))}}};
}

TEST_F(InstanceTest, TakesTheReferencesOfAnAssociationAsKeys)
{
    setReference("Left", thingPath("one"));
    setReference("Right", thingPath("three"));
    setText("Note", "no key");
    EXPECT_EQ(pathOf(instance_), linkPath());
    EXPECT_EQ(read(instance_)->path, linkPath());
    EXPECT_EQ(read(instance_)->properties.size(), 3U);
}

TEST_F(InstanceTest, TakesThemWhenTheKeyListNamesOthers)
{
    const char* keys[] = {"Antecedent", "Dependent", nullptr};
    ft_.setPropertyFilter(instance_, nullptr, keys);
    setReference("Left", thingPath("one"));
    setReference("Right", thingPath("three"));
    EXPECT_EQ(pathOf(instance_), linkPath());
}

TEST_F(InstanceTest, TakesThemWhenTheFilterKeepsThemOut)
{
    setReference("Left", thingPath("one"));
    filter({"Note"}, {"Antecedent", "Dependent"});
    setReference("Right", thingPath("three"));
    setText("Note", "wanted");
    EXPECT_EQ(pathOf(instance_), linkPath());
    EXPECT_THAT(propertyNames(), ElementsAre("Note"));
}

TEST_F(InstanceTest, ReturnsAndHoldsInstancesWithCompletePaths)
{
    setReference("Left", thingPath("one"));
    setReference("Right", thingPath("three"));
    request_.result()->ft->returnInstance(request_.result(), instance_);
    EXPECT_EQ(request_.answer({CMPI_RC_OK, nullptr}).instances.at(0).path, linkPath());

    CMPIInstance* const outer = mb()->eft->newInstance(mb(), newPath(), nullptr);
    CMPIValue value{};
    value.inst = instance_;
    EXPECT_EQ(ft_.setProperty(outer, "Embedded", &value, CMPI_instance), CMPI_RC_OK);
    const CMPIData embedded = ft_.getProperty(outer, "Embedded", nullptr);
    EXPECT_EQ(embedded.type, CMPI_instance);
    EXPECT_EQ(read(embedded.value.inst)->path, linkPath());
}

TEST_F(InstanceTest, IgnoresNullReferencesAsKeys)
{
    EXPECT_EQ(ft_.setProperty(instance_, "Left", nullptr, CMPI_ref), CMPI_RC_OK);
    EXPECT_EQ(pathOf(instance_), classPath("TEST_Thing"));
}

TEST_F(InstanceTest, ClonesGoTheirOwnWay)
{
    setText("Name", "one");
    CMPIInstance* const copy = ft_.clone(instance_, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    setText("Name", "two", copy);
    EXPECT_EQ(textOf(ft_.getProperty(instance_, "Name", nullptr).value.string), "one");
    ft_.release(instance_);
    EXPECT_EQ(textOf(ft_.getProperty(copy, "Name", nullptr).value.string), "two");
}

} // namespace

} // namespace cimhost
