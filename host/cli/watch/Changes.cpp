#include "cli/watch/Changes.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/InstanceTable.h"

#include <algorithm>
#include <array>
#include <map>
#include <utility>

namespace cimhost::cli {

namespace {

using ByPath = std::map<std::string, const cim::Instance*>;

ByPath byPath(const cim::Instances& instances)
{
    ByPath found;
    for (const cim::Instance& instance : instances)
        found.emplace(cim::lookupText(instance.path), &instance);
    return found;
}

const cim::Instance* find(const ByPath& instances, const cim::ObjectPath& path)
{
    const auto found = instances.find(cim::lookupText(path));
    return found == instances.end() ? nullptr : found->second;
}

cim::Value valueOf(const cim::Instance& instance, const std::string& property)
{
    const cim::Value* const value = cim::findProperty(instance, property);
    return value == nullptr ? cim::Value{} : *value;
}

void addAlterations(const cim::Instance& before, const cim::Instance& now, std::vector<Change>& changes)
{
    const auto addIfAltered = [&](const std::string& property) {
        Change change{Change::altered, now, property, valueOf(before, property), valueOf(now, property)};
        if (change.before != change.now)
            changes.push_back(std::move(change));
    };
    for (const cim::Property& property : now.properties)
        addIfAltered(property.name);
    for (const cim::Property& property : before.properties)
        if (cim::findProperty(now, property.name) == nullptr)
            addIfAltered(property.name);
}

std::string orNone(const std::string& text)
{
    return text.empty() ? "none" : text;
}

/// The states of an instance that people look at first.
std::string statesText(const cim::Instance& instance)
{
    constexpr std::array<const char*, 3> states{"HealthState", "OperationalStatus", "AlarmState"};
    std::string text;
    for (const char* const state : states)
        if (const cim::Value* const value = cim::findProperty(instance, state))
            text += std::string(text.empty() ? ": " : ", ") + state + ' ' + orNone(valueText(state, *value));
    return text;
}

std::string eventText(const Change& change)
{
    switch (change.kind) {
    case Change::appeared:
        return " is there" + statesText(change.instance);
    case Change::vanished:
        return " is gone";
    default:
        return ": " + change.property + " from " + orNone(valueText(change.property, change.before)) +
               " to " + orNone(valueText(change.property, change.now));
    }
}

} // namespace

std::vector<Change> changesBetween(const cim::Instances& before, const cim::Instances& now)
{
    const ByPath former = byPath(before);
    const ByPath present = byPath(now);
    std::vector<Change> changes;
    for (const cim::Instance& instance : now) {
        if (const cim::Instance* const was = find(former, instance.path))
            addAlterations(*was, instance, changes);
        else
            changes.push_back({Change::appeared, instance, "", {}, {}});
    }
    for (const cim::Instance& instance : before)
        if (find(present, instance.path) == nullptr)
            changes.push_back({Change::vanished, instance, "", {}, {}});
    return changes;
}

std::string changeText(const Change& change, std::size_t width)
{
    constexpr std::size_t leastName = 20;
    const std::string name = cim::printable(shortName(change.instance.path));
    const std::string event = cim::printable(eventText(change));
    const std::size_t eventWidth = cim::displayWidth(event);
    const std::size_t left = width > eventWidth ? width - eventWidth : 0;
    return shortenedAtEnd(shortenedInMiddle(name, std::max(left, leastName)) + event, width);
}

} // namespace cimhost::cli
