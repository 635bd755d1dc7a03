// What holds for every property list: an instance has its keys and exactly what the list names.

#include "Generators.h"
#include "Server.h"

#include "cim/Values.h"

#include <algorithm>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace cim = cimhost::cim;

namespace {

using Names = std::vector<std::string>;

bool has(const Names& names, const std::string& name)
{
    return std::find(names.begin(), names.end(), name) != names.end();
}

/// Of `all` those that are keys or in the list.
Names keysAndListed(const Names& all, const Names& keys, const Names& list)
{
    Names expected;
    std::copy_if(all.begin(), all.end(), std::back_inserter(expected),
                 [&](const std::string& name) { return has(keys, name) || has(list, name); });
    return expected;
}

Names namesOf(const cim::Instance& instance)
{
    Names names;
    for (const cim::Property& property : instance.properties)
        names.push_back(property.name);
    return names;
}

/// The same instance with fewer properties.
bool isPartOf(const cim::Instance& part, const cim::Instance& whole)
{
    return part.path == whole.path &&
           std::all_of(part.properties.begin(), part.properties.end(), [&](const cim::Property& property) {
               const cim::Value* const value = cim::findProperty(whole, property.name);
               return value != nullptr && *value == property.value;
           });
}

/// Holds the instances of a class with a property list against those with all properties.
/// \param keys  properties that no list leaves out
void checkLists(const std::string& className, const Names& keys)
{
    Server server(*Generators::inventories(), *Generators::computerSystems());
    const Server::Instances whole = server.instances(className);
    if (whole.empty())
        return;
    const Names all = namesOf(whole.front());
    const Names list = *Generators::propertyLists(all);
    const Names expected = keysAndListed(all, keys, list);

    const Server::Instances listed = server.instances(className, list);
    RC_ASSERT(listed.size() == whole.size());
    for (std::size_t i = 0; i < whole.size(); ++i) {
        RC_ASSERT(namesOf(listed[i]) == expected);
        RC_ASSERT(isPartOf(listed[i], whole[i]));
    }
    RC_ASSERT(server.get(whole.back().path, list) == Server::Instances{listed.back()});
}

RC_GTEST_PROP(PropertyLists, ofIndicatorsLeaveTheKeysAndWhatTheyName, ())
{
    checkLists(Server::glimmark, {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"});
}

RC_GTEST_PROP(PropertyLists, ofCapabilitiesLeaveTheKeyAndWhatTheyName, ())
{
    checkLists(Server::capabilities, {"InstanceID"});
}

RC_GTEST_PROP(PropertyLists, ofAssociatedIndicatorsLeaveTheKeysAndWhatTheyName, ())
{
    Server server(*Generators::inventories());
    const Server::Instances whole = server.instances(Server::glimmark);
    const Names list = *Generators::propertyLists({"Caption", "Name", "OperationalStatus", "AlarmState"});
    const cim::ObjectPath capabilities = server.names(Server::capabilities).at(0);
    const cim::ObjectPath system = server.names(Server::computerSystem).at(0);
    // Without an indicator there is none to be had of the element capabilities, and no answer about it
    // either.
    const Server::Instances listed = server.instances(Server::glimmark, list);
    RC_ASSERT(server.associators(capabilities, {Server::elementCapabilities, {}, {}, {}}, list) == listed);
    RC_ASSERT(server.associators(system, {Server::systemDevice, {}, {}, {}}, list) == listed);
}

/// The broker's own filter, which ignores letter case, is all that takes references away.
Names namedReferences(const Names& all, const Names& list)
{
    Names expected;
    std::copy_if(all.begin(), all.end(), std::back_inserter(expected), [&](const std::string& name) {
        return std::any_of(list.begin(), list.end(),
                           [&](const std::string& listed) { return cim::sameName(listed, name); });
    });
    return expected;
}

RC_GTEST_PROP(PropertyLists, ofSystemDevicesLeaveBothKeys, ())
{
    const Names ends{"GroupComponent", "PartComponent"};
    Server server(*Generators::inventories(), *Generators::computerSystems());
    const Server::Instances whole = server.instances(Server::systemDevice);
    RC_ASSERT(server.instances(Server::systemDevice, *Generators::propertyLists(ends)) == whole);
}

// The keys that the provider tells the broker of are not those of this association: a list that does not name
// an end takes it out of the properties, though never out of the path.
RC_GTEST_PROP(PropertyLists, ofElementCapabilitiesLeaveTheEndsTheyName, ())
{
    const Names ends{"ManagedElement", "Capabilities"};
    const Names list = *Generators::propertyLists(ends);
    Server server(*Generators::inventories());
    const Server::Instances listed = server.instances(Server::elementCapabilities, list);
    RC_ASSERT(sameObjects(pathsOf(listed), server.names(Server::elementCapabilities)));
    for (const cim::Instance& instance : listed)
        RC_ASSERT(namesOf(instance) == namedReferences(ends, list));
}

} // namespace
