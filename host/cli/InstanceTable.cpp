#include "cli/InstanceTable.h"

#include "cim/Literal.h"
#include "cim/ObjectPathText.h"
#include "cim/Table.h"
#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/ValueWords.h"

#include <algorithm>
#include <functional>
#include <iterator>
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

std::vector<std::string> keyNames(const std::vector<cim::ObjectPath>& paths)
{
    std::vector<std::string> names;
    for (const cim::ObjectPath& path : paths)
        for (const cim::Key& key : path.keys)
            addOnce(names, key.name);
    return names;
}

std::vector<cim::ObjectPath> pathsOf(const std::vector<cim::Instance>& instances)
{
    std::vector<cim::ObjectPath> paths;
    std::transform(instances.begin(), instances.end(), std::back_inserter(paths),
                   [](const cim::Instance& instance) { return instance.path; });
    return paths;
}

/// Without the keys that only repeat the class and the system, where any other is left.
std::vector<std::string> tellingKeyNames(const std::vector<cim::ObjectPath>& paths)
{
    static const std::vector<std::string> repeating{"CreationClassName", "SystemCreationClassName",
                                                    "SystemName"};
    const std::vector<std::string> all = keyNames(paths);
    std::vector<std::string> telling;
    std::copy_if(all.begin(), all.end(), std::back_inserter(telling),
                 [](const std::string& name) { return !contains(repeating, name); });
    return telling.empty() ? all : telling;
}

std::string columnsTable(const std::vector<std::string>& columns, const std::vector<cim::Instance>& instances)
{
    std::vector<cim::Row> rows;
    for (const cim::Instance& instance : instances) {
        cim::Row& row = rows.emplace_back();
        for (const std::string& column : columns) {
            const cim::Value* value = findValue(instance, column);
            row.push_back(value != nullptr ? cellText(column, *value, wordOnly) : "");
        }
    }
    return cim::table(columns, rows);
}

const std::vector<std::string>& deviceColumns()
{
    static const std::vector<std::string> columns{"DeviceID", "Name", "HealthState", "OperationalStatus",
                                                  "AlarmState"};
    return columns;
}

bool isAlarmDevice(const cim::Instance& instance)
{
    return std::all_of(deviceColumns().begin(), deviceColumns().end(),
                       [&](const std::string& column) { return findValue(instance, column) != nullptr; });
}

bool hasWord(const cim::Property& property)
{
    return std::any_of(property.value.items.begin(), property.value.items.end(), [&](const auto& item) {
        const auto* const number = std::get_if<std::uint64_t>(&item);
        return number != nullptr && valueWord(property.name, *number).has_value();
    });
}

std::vector<std::string> wordedProperties(const std::vector<cim::Instance>& instances)
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

std::string nameTable(const std::vector<cim::ObjectPath>& paths)
{
    if (paths.empty())
        return "No names.\n";
    const bool oneClass = std::all_of(paths.begin(), paths.end(), [&](const cim::ObjectPath& path) {
        return cim::sameName(path.className, paths.front().className);
    });
    const std::vector<std::string> keys = keyNames(paths);
    cim::Row heading = keys;
    if (!oneClass || keys.empty())
        heading.insert(heading.begin(), "Class");

    std::vector<cim::Row> rows;
    for (const cim::ObjectPath& path : paths) {
        cim::Row& row = rows.emplace_back();
        if (heading.size() > keys.size())
            row.push_back(path.className);
        for (const std::string& key : keys) {
            const cim::Value* value = cim::findKey(path, key);
            row.push_back(value != nullptr ? cellText(key, *value, wordOnly) : "");
        }
    }
    return cim::table(heading, rows);
}

std::string instanceTable(const std::vector<cim::Instance>& instances, const cim::PropertyList& properties)
{
    if (instances.empty())
        return "No instances.\n";
    if (properties) {
        std::vector<std::string> columns = tellingKeyNames(pathsOf(instances));
        for (const std::string& property : *properties)
            addOnce(columns, property);
        return columnsTable(columns, instances);
    }
    if (std::all_of(instances.begin(), instances.end(), isAlarmDevice))
        return columnsTable(deviceColumns(), instances);
    return instanceBlocks(instances);
}

std::string stateTable(const std::vector<cim::Instance>& instances)
{
    const bool areAlarmDevices = std::all_of(instances.begin(), instances.end(), isAlarmDevice);
    return instanceTable(instances, areAlarmDevices ? cim::PropertyList() : wordedProperties(instances));
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

std::string instanceBlocks(const std::vector<cim::Instance>& instances)
{
    std::string text;
    for (const cim::Instance& instance : instances)
        text += (text.empty() ? "" : "\n") + block(instance);
    return text;
}

} // namespace cimhost::cli
