// What holds for every inventory: the identifiers are sorted, each comes once, and the last node with it
// wins.

#include "Generators.h"
#include "Server.h"

#include "cim/Values.h"

#include <algorithm>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace cim = cimhost::cim;
using MadeInventory::Node;

namespace {

constexpr unsigned int indicatorKind = 36;

std::string withoutBlanksAround(const std::string& text)
{
    const auto first = text.find_first_not_of(' ');
    return first == std::string::npos ? "" : text.substr(first, text.find_last_not_of(' ') - first + 1);
}

std::string identifierOf(const Node& node)
{
    return withoutBlanksAround(node.description + ":/" + node.path);
}

/// The indicators as they are to be answered: by identifier, in the order of its bytes.
std::map<std::string, Node> indicatorsOf(const std::vector<Node>& inventory)
{
    std::map<std::string, Node> indicators;
    for (const Node& node : inventory)
        if (node.kind == indicatorKind)
            indicators[identifierOf(node)] = node;
    return indicators;
}

std::vector<std::uint16_t> operationalStatusOf(unsigned int status)
{
    if (status == 0)
        return {};
    if (status == 1)
        return {2, 11};
    if (status == 20)
        return {3, 5};
    return status >= 21 && status <= 26 ? std::vector<std::uint16_t>{3} : std::vector<std::uint16_t>{0};
}

std::uint16_t healthStateOf(unsigned int status)
{
    return status == 1 ? 5 : status >= 20 && status <= 26 ? 10 : 0;
}

std::uint16_t alarmStateOf(const Node& node)
{
    const unsigned int lower16Bits = node.alarmState.value_or(0) % 0x10000U;
    return lower16Bits <= 3 ? static_cast<std::uint16_t>(lower16Bits) : 0;
}

cim::Value uint16Value(std::uint16_t number)
{
    return cim::unsignedValue(number, CMPI_uint16);
}

cim::Value uint16Array(const std::vector<std::uint16_t>& numbers)
{
    std::vector<cim::Value::Scalar> items;
    items.reserve(numbers.size());
    for (const std::uint64_t number : numbers)
        items.emplace_back(number);
    return cim::arrayValue(CMPI_uint16, items);
}

/// What an instance says about a node, by property.
std::map<std::string, cim::Value> expectedValues(const Node& node)
{
    const cim::Value name = cim::textValue(withoutBlanksAround(node.description));
    return {{"DeviceID", cim::textValue(identifierOf(node))},
            {"Description", name},
            {"Name", name},
            {"ElementName", name},
            {"RequestedState", uint16Value(2)},
            {"HealthState", uint16Value(healthStateOf(node.status))},
            {"OperationalStatus", uint16Array(operationalStatusOf(node.status))},
            {"AudibleAlarm", cim::booleanValue(false)},
            {"VisibleAlarm", cim::booleanValue(true)},
            {"MotionAlarm", cim::booleanValue(false)},
            {"AlarmState", uint16Value(alarmStateOf(node))}};
}

std::vector<std::string> identifiersOf(const Server::Paths& paths)
{
    std::vector<std::string> identifiers;
    for (const cim::ObjectPath& path : paths)
        identifiers.push_back(keyOf(path, "DeviceID"));
    return identifiers;
}

RC_GTEST_PROP(Inventories, giveSortedIdentifiersEachOnce, ())
{
    const auto inventory = *Generators::inventories();
    std::vector<std::string> expected;
    for (const auto& [identifier, node] : indicatorsOf(inventory))
        expected.push_back(identifier);
    Server server(inventory);
    RC_ASSERT(identifiersOf(server.names(Server::glimmark)) == expected);
    RC_ASSERT(identifiersOf(pathsOf(server.instances(Server::glimmark))) == expected);
}

RC_GTEST_PROP(Inventories, giveTheStateOfTheLastNodeWithAnIdentifier, ())
{
    const auto inventory = *Generators::inventories();
    const auto expected = indicatorsOf(inventory);
    Server server(inventory);
    const Server::Instances instances = server.instances(Server::glimmark);
    RC_ASSERT(instances.size() == expected.size());
    auto indicator = expected.begin();
    for (const cim::Instance& instance : instances) {
        for (const auto& [name, value] : expectedValues((indicator++)->second)) {
            const cim::Value* const found = cim::findProperty(instance, name);
            RC_ASSERT(found != nullptr);
            RC_ASSERT(*found == value);
        }
    }
}

RC_GTEST_PROP(Inventories, ofDifferentIndicatorsMayComeInAnyOrder, ())
{
    std::vector<Node> inventory;
    for (const auto& [identifier, node] : indicatorsOf(*Generators::inventories()))
        inventory.push_back(node);
    const Server::Instances instances = Server(inventory).instances(Server::glimmark);
    std::reverse(inventory.begin(), inventory.end());
    RC_ASSERT(Server(inventory).instances(Server::glimmark) == instances);
}

RC_GTEST_PROP(Inventories, withAnIndicatorWithoutNameGiveNone, ())
{
    auto inventory = *Generators::inventories();
    const auto position = *rc::gen::inRange<std::size_t>(0, inventory.size() + 1);
    inventory.insert(inventory.begin() + static_cast<std::ptrdiff_t>(position),
                     Node{"", *Generators::texts()});
    Server server(inventory);
    for (const char* const className :
         {Server::glimmark, Server::elementCapabilities, Server::systemDevice}) {
        RC_ASSERT(server.names(className).empty());
        RC_ASSERT(server.instances(className).empty());
    }
    RC_ASSERT(server.names(Server::capabilities).size() == 1U);
}

} // namespace
