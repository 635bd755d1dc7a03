// The registrations for OpenPegasus against those for the small-footprint broker, and against what
// OpenPegasus asks of them.

#include "schema/MofReader.h"

#include "broker/Registration.h"

#include <algorithm>
#include <ostream>
#include <set>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace cimhost {

/// Equal in all that is registered.
bool operator==(const RegisteredClass& left, const RegisteredClass& right)
{
    return left.className == right.className && left.provider == right.provider &&
           left.location == right.location && left.instance == right.instance &&
           left.association == right.association && left.nameSpaces == right.nameSpaces;
}

void PrintTo(const RegisteredClass& entry, std::ostream* stream)
{
    *stream << entry.className << " by " << entry.provider << " in " << entry.location
            << (entry.instance ? " instance" : "") << (entry.association ? " association" : "");
    for (const std::string& nameSpace : entry.nameSpaces)
        *stream << ' ' << nameSpace;
}

} // namespace cimhost

namespace {

using cimhost::RegisteredClass;
using cimhost::schema::WrittenInstance;
using cimhost::schema::WrittenValue;
using testing::UnorderedElementsAre;
using testing::UnorderedElementsAreArray;

/// The two registrations of the same providers.
struct Registrations
{
    const char* pegasus;
    const char* sfcb;
};

void PrintTo(const Registrations& pair, std::ostream* stream)
{
    *stream << pair.pegasus;
}

std::vector<std::string> namesOf(const std::map<std::string, WrittenValue>& values)
{
    std::vector<std::string> names;
    names.reserve(values.size());
    for (const auto& [name, value] : values)
        names.push_back(name);
    return names;
}

class PegasusRegistration : public testing::TestWithParam<Registrations>
{
protected:
    [[nodiscard]] std::vector<WrittenInstance> instancesOf(const std::string& className) const
    {
        std::vector<WrittenInstance> found;
        std::copy_if(instances.begin(), instances.end(), std::back_inserter(found),
                     [&](const WrittenInstance& instance) { return instance.className == className; });
        return found;
    }

    /// The one text that a property has.
    static std::string text(const WrittenInstance& instance, const std::string& property)
    {
        const WrittenValue& value = instance.values.at(property);
        EXPECT_EQ(value.kind, WrittenValue::Text) << property;
        EXPECT_FALSE(value.isArray) << property;
        return value.elements.at(0);
    }

    static std::vector<std::string> elements(const WrittenInstance& instance, const std::string& property,
                                             WrittenValue::Kind kind)
    {
        const WrittenValue& value = instance.values.at(property);
        EXPECT_EQ(value.kind, kind) << property;
        EXPECT_TRUE(value.isArray) << property;
        return value.elements;
    }

    const std::vector<WrittenInstance> instances =
        cimhost::schema::readMofFile(std::string(SCHEMA_DIRECTORY "/") + GetParam().pegasus).instances;
    const std::vector<RegisteredClass> registered =
        cimhost::readRegistrationFile(std::string(SCHEMA_DIRECTORY "/") + GetParam().sfcb).classes;
};

TEST_P(PegasusRegistration, HasOneModuleOfTheInterfaceThatTheBrokerKnows)
{
    const std::vector<WrittenInstance> modules = instancesOf("PG_ProviderModule");
    ASSERT_EQ(modules.size(), 1U);
    EXPECT_THAT(namesOf(modules[0].values), UnorderedElementsAre("Name", "Vendor", "Version", "InterfaceType",
                                                                 "InterfaceVersion", "Location"));
    EXPECT_EQ(text(modules[0], "InterfaceType"), "CMPI");
    EXPECT_EQ(text(modules[0], "InterfaceVersion"), "2.0.0");
    EXPECT_EQ(text(modules[0], "Version"), PROVIDER_VERSION);
    EXPECT_FALSE(text(modules[0], "Vendor").empty());
}

TEST_P(PegasusRegistration, NamesEachProviderOnce)
{
    std::vector<std::string> providers;
    for (const WrittenInstance& provider : instancesOf("PG_Provider")) {
        EXPECT_THAT(namesOf(provider.values), UnorderedElementsAre("ProviderModuleName", "Name"));
        providers.push_back(text(provider, "Name"));
    }
    std::vector<std::string> expected;
    for (const RegisteredClass& entry : registered)
        expected.push_back(entry.provider);
    EXPECT_THAT(providers, UnorderedElementsAreArray(expected));
}

TEST_P(PegasusRegistration, RegistersTheSameClassesAndTypes)
{
    const std::string location = text(instancesOf("PG_ProviderModule").at(0), "Location");
    std::vector<RegisteredClass> found;
    for (const WrittenInstance& capabilities : instancesOf("PG_ProviderCapabilities")) {
        RegisteredClass entry;
        entry.className = text(capabilities, "ClassName");
        entry.provider = text(capabilities, "ProviderName");
        entry.location = location;
        for (const std::string& type : elements(capabilities, "ProviderType", WrittenValue::Number)) {
            EXPECT_THAT(type, testing::AnyOf("2", "3"));
            (type == "2" ? entry.instance : entry.association) = true;
        }
        entry.nameSpaces = elements(capabilities, "Namespaces", WrittenValue::Text);
        found.push_back(entry);
    }
    EXPECT_THAT(found, UnorderedElementsAreArray(registered));
}

TEST_P(PegasusRegistration, GivesEveryCapabilityItsPropertiesAndAnIdOfItsOwn)
{
    std::set<std::string> ids;
    for (const WrittenInstance& capabilities : instancesOf("PG_ProviderCapabilities")) {
        EXPECT_THAT(namesOf(capabilities.values),
                    UnorderedElementsAre("ProviderModuleName", "ProviderName", "CapabilityID", "ClassName",
                                         "Namespaces", "ProviderType", "SupportedProperties",
                                         "SupportedMethods"));
        EXPECT_EQ(capabilities.values.at("SupportedProperties").kind, WrittenValue::Null);
        EXPECT_EQ(capabilities.values.at("SupportedMethods").kind, WrittenValue::Null);
        const std::string id = text(capabilities, "ProviderName") + '/' + text(capabilities, "CapabilityID");
        EXPECT_TRUE(ids.insert(id).second) << id;
    }
}

/// The broker takes no provider before its module and no capabilities before their provider.
TEST_P(PegasusRegistration, NamesNothingBeforeItIsThere)
{
    std::set<std::string> modules;
    std::set<std::string> providers;
    for (const WrittenInstance& instance : instances) {
        if (instance.className == "PG_ProviderModule") {
            modules.insert(text(instance, "Name"));
            continue;
        }
        EXPECT_EQ(modules.count(text(instance, "ProviderModuleName")), 1U) << instance.className;
        if (instance.className == "PG_Provider")
            providers.insert(text(instance, "Name"));
        else if (instance.className == "PG_ProviderCapabilities")
            EXPECT_EQ(providers.count(text(instance, "ProviderName")), 1U) << text(instance, "ClassName");
        else
            ADD_FAILURE() << "OpenPegasus registers nothing by an instance of " << instance.className;
    }
}

INSTANTIATE_TEST_SUITE_P(Files, PegasusRegistration,
                         testing::Values(Registrations{"glimmark-pegasus.mof", "glimmark.reg"},
                                         Registrations{"computer-system-pegasus.mof",
                                                       "computer-system.reg"}));

} // namespace
