#include "cli/InstanceTable.h"

#include "cim/Literal.h"
#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/FittedTable.h"
#include "cli/ValueWords.h"

#include <algorithm>
#include <functional>
#include <iterator>
#include <set>
#include <string_view>

namespace cimhost::cli {

namespace {

/// How one item of a property is shown; of a number with a word that word.
using ItemText = std::function<std::string(const std::string& number, std::string_view word)>;

std::string wordOnly(const std::string& /*number*/, std::string_view word)
{
    return std::string(word);
}

std::string numberAndWord(const std::string& number, std::string_view word)
{
    return number + " (" + std::string(word) + ')';
}

std::string itemText(std::string_view property, const cim::Value::Scalar& item, CMPIType type,
                     const ItemText& worded)
{
    if (const auto* text = std::get_if<std::string>(&item))
        return *text;
    if (const auto* path = std::get_if<std::shared_ptr<const cim::ObjectPath>>(&item);
        path != nullptr && *path)
        return cim::toText(**path);
    if (const auto* number = std::get_if<std::uint64_t>(&item))
        if (const auto word = valueWord(property, *number))
            return worded(std::to_string(*number), *word);
    return cim::literal(item, type);
}

/// The value as a cell; nothing for a null.
std::string cellText(std::string_view property, const cim::Value& value, const ItemText& worded)
{
    const auto type = static_cast<CMPIType>(value.type & ~CMPI_ARRAY);
    std::string text;
    for (const cim::Value::Scalar& item : value.items)
        text += (text.empty() ? "" : ", ") + itemText(property, item, type, worded);
    return text;
}

/// The value of a property, or of a key of the path where the instance lacks the property.
const cim::Value* findValue(const cim::Instance& instance, std::string_view name)
{
    const cim::Value* value = cim::findProperty(instance, name);
    return value != nullptr ? value : cim::findKey(instance.path, name);
}

bool contains(const std::vector<std::string>& names, std::string_view name)
{
    return std::any_of(names.begin(), names.end(),
                       [&](const std::string& entry) { return cim::sameName(entry, name); });
}

void addOnce(std::vector<std::string>& names, const std::string& name)
{
    if (!contains(names, name))
        names.push_back(name);
}

std::vector<std::string> keyNames(const cim::ObjectPaths& paths)
{
    std::vector<std::string> names;
    for (const cim::ObjectPath& path : paths)
        for (const cim::Key& key : path.keys)
            addOnce(names, key.name);
    return names;
}

cim::ObjectPaths pathsOf(const cim::Instances& instances)
{
    cim::ObjectPaths paths;
    std::transform(instances.begin(), instances.end(), std::back_inserter(paths),
                   [](const cim::Instance& instance) { return instance.path; });
    return paths;
}

/// Without the keys that only repeat the class and the system, where any other is left.
std::vector<std::string> tellingKeyNames(const cim::ObjectPaths& paths)
{
    static const std::vector<std::string> repeating{"CreationClassName", "SystemCreationClassName",
                                                    "SystemName"};
    const std::vector<std::string> all = keyNames(paths);
    std::vector<std::string> telling;
    std::copy_if(all.begin(), all.end(), std::back_inserter(telling),
                 [](const std::string& name) { return !contains(repeating, name); });
    return telling.empty() ? all : telling;
}

Column::Kind kindOf(const std::string& name, const std::vector<std::string>& identifiers,
                    const cim::Instances& instances)
{
    if (contains(identifiers, name))
        return Column::identifier;
    const bool isList = std::any_of(instances.begin(), instances.end(), [&](const cim::Instance& instance) {
        const cim::Value* const value = findValue(instance, name);
        return value != nullptr && cim::isArray(*value);
    });
    return isList ? Column::list : Column::plain;
}

/// A column for each of the names.
std::vector<Column> columnsOf(const std::vector<std::string>& names, const cim::Instances& instances)
{
    const std::vector<std::string> identifiers = tellingKeyNames(pathsOf(instances));
    std::vector<Column> columns;
    columns.reserve(names.size());
    for (const std::string& name : names)
        columns.push_back({name, kindOf(name, identifiers, instances)});
    return columns;
}

std::string columnsTable(const std::vector<Column>& columns, const cim::Instances& instances,
                         std::size_t width)
{
    std::vector<cim::Row> rows;
    for (const cim::Instance& instance : instances) {
        cim::Row& row = rows.emplace_back();
        for (const Column& column : columns) {
            const cim::Value* value = findValue(instance, column.name);
            row.push_back(value != nullptr ? cellText(column.name, *value, wordOnly) : "");
        }
    }
    return fittedTable(columns, rows, width);
}

/// Of CIM_ManagedSystemElement and CIM_AlarmDevice: what people look at first.
const std::vector<std::string>& stateNames()
{
    static const std::vector<std::string> names{"HealthState", "OperationalStatus", "AlarmState"};
    return names;
}

bool hasAllStates(const cim::Instance& instance)
{
    return std::all_of(stateNames().begin(), stateNames().end(),
                       [&](const std::string& name) { return findValue(instance, name) != nullptr; });
}

/// Of CIM_ManagedElement and its kinds: what people call an instance.
const std::vector<std::string>& nameNames()
{
    static const std::vector<std::string> names{"Name", "ElementName"};
    return names;
}

/// Whether the property has another value in each of the instances.
bool tellsApart(const std::string& property, const cim::Instances& instances)
{
    std::set<std::string> values;
    for (const cim::Instance& instance : instances)
        if (const cim::Value* const value = cim::findProperty(instance, property))
            values.insert(valueText(property, *value));
    values.erase("");
    return values.size() == instances.size();
}

bool isAnywhere(const std::string& property, const cim::Instances& instances)
{
    return std::any_of(instances.begin(), instances.end(), [&](const cim::Instance& instance) {
        return cim::findProperty(instance, property) != nullptr;
    });
}

/// Name, states, then the keys if there is room; where no name tells the instances apart, keys, states, then
/// the name.
std::string summaryTable(const cim::Instances& instances, const std::vector<std::string>& states,
                         std::size_t width)
{
    const std::vector<std::string> keys = tellingKeyNames(pathsOf(instances));
    const auto telling = std::find_if(nameNames().begin(), nameNames().end(),
                                      [&](const std::string& name) { return tellsApart(name, instances); });
    const auto present = std::find_if(nameNames().begin(), nameNames().end(),
                                      [&](const std::string& name) { return isAnywhere(name, instances); });
    const std::vector<std::string> name(present, present == nameNames().end() ? present : std::next(present));
    const bool hasTelling = telling != nameNames().end();
    std::vector<std::string> names = hasTelling ? std::vector<std::string>{*telling} : keys;
    const std::size_t leading = names.size();
    for (const std::vector<std::string>& more : {states, hasTelling ? keys : name})
        for (const std::string& added : more)
            addOnce(names, added);
    std::vector<Column> columns = columnsOf(names, instances);
    for (std::size_t i = leading; i < columns.size(); ++i)
        columns[i].mayGo = !contains(states, columns[i].name);
    return columnsTable(columns, instances, width);
}

bool hasWord(const cim::Property& property)
{
    return std::any_of(property.value.items.begin(), property.value.items.end(), [&](const auto& item) {
        const auto* const number = std::get_if<std::uint64_t>(&item);
        return number != nullptr && valueWord(property.name, *number).has_value();
    });
}

std::vector<std::string> wordedProperties(const cim::Instances& instances)
{
    std::vector<std::string> names;
    for (const cim::Instance& instance : instances)
        for (const cim::Property& property : instance.properties)
            if (hasWord(property))
                addOnce(names, property.name);
    return names;
}

std::size_t widestName(const cim::Instance& instance)
{
    std::size_t width = 0;
    for (const cim::Property& property : instance.properties)
        width = std::max(width, cim::displayWidth(cim::printable(property.name)));
    return width;
}

std::string block(const cim::Instance& instance)
{
    const std::size_t width = widestName(instance);
    std::string text = cim::toText(instance.path) + '\n';
    for (const cim::Property& property : instance.properties) {
        const std::string name = cim::printable(property.name);
        const std::string value = cim::printable(cellText(property.name, property.value, numberAndWord));
        const std::string gap(width - cim::displayWidth(name) + 2, ' ');
        text += "  " + name + (value.empty() ? "" : gap + value) + '\n';
    }
    return text;
}

} // namespace

std::string nameTable(const cim::ObjectPaths& paths, std::size_t width)
{
    if (paths.empty())
        return "No names.\n";
    const bool oneClass = std::all_of(paths.begin(), paths.end(), [&](const cim::ObjectPath& path) {
        return cim::sameName(path.className, paths.front().className);
    });
    const std::vector<std::string> keys = keyNames(paths);
    const bool hasClass = !oneClass || keys.empty();
    std::vector<Column> columns;
    if (hasClass)
        columns.push_back({"Class", Column::plain});
    for (const std::string& key : keys)
        columns.push_back({key, Column::identifier});

    std::vector<cim::Row> rows;
    for (const cim::ObjectPath& path : paths) {
        cim::Row& row = rows.emplace_back();
        if (hasClass)
            row.push_back(path.className);
        for (const std::string& key : keys) {
            const cim::Value* value = cim::findKey(path, key);
            row.push_back(value != nullptr ? cellText(key, *value, wordOnly) : "");
        }
    }
    return fittedTable(columns, rows, width);
}

std::string instanceTable(const cim::Instances& instances, const cim::PropertyList& properties,
                          std::size_t width)
{
    if (instances.empty())
        return "No instances.\n";
    if (properties) {
        std::vector<std::string> names = tellingKeyNames(pathsOf(instances));
        for (const std::string& property : *properties)
            addOnce(names, property);
        return columnsTable(columnsOf(names, instances), instances, width);
    }
    if (std::all_of(instances.begin(), instances.end(), hasAllStates))
        return summaryTable(instances, stateNames(), width);
    return instanceBlocks(instances);
}

std::string stateTable(const cim::Instances& instances, std::size_t width)
{
    if (instances.empty())
        return "No instances.\n";
    const bool haveAllStates = std::all_of(instances.begin(), instances.end(), hasAllStates);
    return summaryTable(instances, haveAllStates ? stateNames() : wordedProperties(instances), width);
}

std::string shortName(const cim::ObjectPath& path)
{
    std::string text;
    for (const std::string& key : tellingKeyNames({path}))
        text += (text.empty() ? "" : ", ") + cellText(key, *cim::findKey(path, key), wordOnly);
    return text;
}

std::string valueText(std::string_view property, const cim::Value& value)
{
    return cellText(property, value, wordOnly);
}

std::string instanceBlocks(const cim::Instances& instances)
{
    std::string text;
    for (const cim::Instance& instance : instances)
        text += (text.empty() ? "" : "\n") + block(instance);
    return text;
}

} // namespace cimhost::cli
