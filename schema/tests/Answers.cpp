#include "Answers.h"

#include "cim/Values.h"

#include <algorithm>

namespace cimhost::schema {
namespace {

using cimhost::cim::Instance;
using cimhost::cim::Key;
using cimhost::cim::ObjectPath;
using cimhost::cim::Value;

using Lines = std::vector<std::string>;

/// The path behind a value; null where it is none.
const ObjectPath* referenceIn(const Value& value)
{
    if (value.type != CMPI_ref || value.items.size() != 1)
        return nullptr;
    const auto* const reference = std::get_if<std::shared_ptr<const ObjectPath>>(&value.items.front());
    return reference != nullptr ? reference->get() : nullptr;
}

void append(Lines& lines, const Lines& more)
{
    lines.insert(lines.end(), more.begin(), more.end());
}

Lines inspectReference(const std::string& place, const ObjectPath& path, const Property& property,
                       const Classes& classes)
{
    if (!classes.isA(path.className, property.type))
        return {place + ": refers to a " + path.className + ", which is no " + property.type};
    const Class* const declaration = classes.find(path.className);
    return declaration != nullptr ? departures(path, *declaration, classes) : Lines{};
}

Lines inspectValue(const std::string& place, const Value& value, const Property& property,
                   const Classes& classes)
{
    if (value.isNull)
        return {place + ": has no value"};
    if (property.isReference) {
        const ObjectPath* const path = referenceIn(value);
        if (path != nullptr)
            return inspectReference(place, *path, property, classes);
    } else if (cimhost::cim::typeName(value.type) == typeText(property)) {
        return {};
    }
    return {place + ": is a " + cimhost::cim::typeName(value.type) + ", declared as a " + typeText(property)};
}

std::set<std::string> numbersIn(const Value& value)
{
    std::set<std::string> numbers;
    for (const Value::Scalar& item : value.items)
        if (const auto* const number = std::get_if<std::uint64_t>(&item))
            numbers.insert(std::to_string(*number));
    return numbers;
}

/// Those of the declared ValueMap; empty where there is none.
std::set<std::string> mappedNumbers(const Property& property)
{
    const Qualifier* const map = findQualifier(property.qualifiers, "ValueMap");
    return map != nullptr ? std::set<std::string>(map->values.begin(), map->values.end())
                          : std::set<std::string>();
}

Lines inspectNumbers(const std::string& place, const Value& value, const Property& property)
{
    const std::set<std::string> mapped = mappedNumbers(property);
    if (mapped.empty())
        return {};
    Lines lines;
    for (const std::string& number : numbersIn(value)) {
        if (mapped.count(number) == 0)
            lines.emplace_back(place).append(": ").append(number).append(" is not in its ValueMap");
    }
    return lines;
}

/// Names are compared exactly: clients see them as they are.
template <class Named>
bool hasName(const std::vector<Named>& list, const std::string& name)
{
    return std::any_of(list.begin(), list.end(), [&](const Named& item) { return item.name == name; });
}

/// The declared property of exactly that name; null: none.
const Property* findExactly(const Class& declaration, const std::string& name)
{
    const Property* const property = findProperty(declaration, name);
    return property != nullptr && property->name == name ? property : nullptr;
}

} // namespace

Lines departures(const ObjectPath& path, const Class& declaration, const Classes& classes)
{
    Lines lines;
    if (path.className != declaration.name)
        lines.push_back("a path of " + path.className + " instead of " + declaration.name);
    for (const Key& key : path.keys) {
        const std::string place = declaration.name + "." + key.name;
        const Property* const property = findExactly(declaration, key.name);
        if (property == nullptr || !isKey(*property))
            lines.push_back(place + ": is no declared key");
        else
            append(lines, inspectValue(place, key.value, *property, classes));
    }
    for (const Property& property : declaration.properties)
        if (isKey(property) && !hasName(path.keys, property.name))
            lines.push_back(declaration.name + "." + property.name + ": the key is missing");
    return lines;
}

Lines departures(const Instance& instance, const Class& declaration, const Classes& classes)
{
    Lines lines = departures(instance.path, declaration, classes);
    for (const cimhost::cim::Property& returned : instance.properties) {
        const std::string place = declaration.name + "." + returned.name;
        const Property* const property = findExactly(declaration, returned.name);
        if (property == nullptr) {
            lines.push_back(place + ": is not declared");
        } else {
            append(lines, inspectValue(place, returned.value, *property, classes));
            append(lines, inspectNumbers(place, returned.value, *property));
        }
    }
    for (const Property& property : declaration.properties)
        if (!hasName(instance.properties, property.name))
            lines.push_back(declaration.name + "." + property.name + ": is not returned");
    return lines;
}

Lines unusedValues(const cimhost::cim::Instances& instances, const Class& declaration)
{
    Lines lines;
    for (const Property& property : declaration.properties) {
        std::set<std::string> unused = mappedNumbers(property);
        for (const Instance& instance : instances)
            if (const Value* const value = cimhost::cim::findProperty(instance, property.name))
                for (const std::string& number : numbersIn(*value))
                    unused.erase(number);
        for (const std::string& number : unused)
            lines.push_back(declaration.name + "." + property.name + ": no instance has " + number);
    }
    return lines;
}

} // namespace cimhost::schema
