#include "cim/Values.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <utility>

#include <strings.h>

namespace cimhost::cim {

namespace {

Value scalarValue(CMPIType type, Value::Scalar item)
{
    return {type, false, {std::move(item)}};
}

template <typename Object>
bool equalObjects(const std::shared_ptr<const Object>& a, const std::shared_ptr<const Object>& b)
{
    return a == b || (a && b && *a == *b);
}

bool equalScalars(const Value::Scalar& a, const Value::Scalar& b)
{
    if (a.index() != b.index())
        return false;
    if (const auto* path = std::get_if<std::shared_ptr<const ObjectPath>>(&a))
        return equalObjects(*path, std::get<std::shared_ptr<const ObjectPath>>(b));
    if (const auto* instance = std::get_if<std::shared_ptr<const Instance>>(&a))
        return equalObjects(*instance, std::get<std::shared_ptr<const Instance>>(b));
    return a == b;
}

template <typename Item, typename Equal>
bool equalLists(const std::vector<Item>& a, const std::vector<Item>& b, Equal equal)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), equal);
}

/// Keys and properties alike.
template <typename Named>
bool equalNamed(const std::vector<Named>& a, const std::vector<Named>& b)
{
    return equalLists(a, b,
                      [](const Named& x, const Named& y) { return x.name == y.name && x.value == y.value; });
}

template <typename Named>
const Value* findNamed(const std::vector<Named>& list, std::string_view name)
{
    const auto found =
        std::find_if(list.begin(), list.end(), [&](const Named& item) { return sameName(item.name, name); });
    return found == list.end() ? nullptr : &found->value;
}

/// An integer as sign and size, so that signed and unsigned ones compare; nothing: not an integer.
std::optional<std::pair<bool, std::uint64_t>> integerOf(const Value::Scalar& item)
{
    if (const auto* number = std::get_if<std::uint64_t>(&item))
        return std::pair(false, *number);
    if (const auto* number = std::get_if<std::int64_t>(&item)) {
        const auto bits = static_cast<std::uint64_t>(*number);
        return *number < 0 ? std::pair(true, 0 - bits) : std::pair(false, bits);
    }
    return std::nullopt;
}

bool sameKeyScalar(const Value::Scalar& a, const Value::Scalar& b)
{
    const auto number = integerOf(a);
    if (number)
        return number == integerOf(b);
    const auto* path = std::get_if<std::shared_ptr<const ObjectPath>>(&a);
    const auto* other = std::get_if<std::shared_ptr<const ObjectPath>>(&b);
    if (path != nullptr && other != nullptr && *path && *other)
        return sameObject(**path, **other);
    return equalScalars(a, b);
}

std::string lookupText(const Value& value)
{
    if (value.items.size() != 1)
        return {};
    const Value::Scalar& item = value.items.front();
    if (const auto* text = std::get_if<std::string>(&item))
        return *text;
    if (const auto* flag = std::get_if<bool>(&item))
        return *flag ? "TRUE" : "FALSE";
    if (const auto integer = integerOf(item))
        return (integer->first ? "-" : "") + std::to_string(integer->second);
    if (const auto* path = std::get_if<std::shared_ptr<const ObjectPath>>(&item); path != nullptr && *path)
        return cim::lookupText(**path);
    return {};
}

bool sameOrMissing(const std::string& a, const std::string& b)
{
    return a.empty() || b.empty() || sameName(a, b);
}

struct TypeName
{
    CMPIType type;
    const char* name;
};

constexpr std::array typeNames{
    TypeName{CMPI_null, "null"},         TypeName{CMPI_boolean, "boolean"},
    TypeName{CMPI_char16, "char16"},     TypeName{CMPI_real32, "real32"},
    TypeName{CMPI_real64, "real64"},     TypeName{CMPI_uint8, "uint8"},
    TypeName{CMPI_uint16, "uint16"},     TypeName{CMPI_uint32, "uint32"},
    TypeName{CMPI_uint64, "uint64"},     TypeName{CMPI_sint8, "sint8"},
    TypeName{CMPI_sint16, "sint16"},     TypeName{CMPI_sint32, "sint32"},
    TypeName{CMPI_sint64, "sint64"},     TypeName{CMPI_string, "string"},
    TypeName{CMPI_dateTime, "datetime"}, TypeName{CMPI_instance, "instance"},
    TypeName{CMPI_ref, "ref"},
};

std::string unknownTypeName(CMPIType type)
{
    std::array<char, 16> text{};
    std::snprintf(text.data(), text.size(), "type 0x%04x", static_cast<unsigned int>(type));
    return text.data();
}

} // namespace

Value booleanValue(bool value)
{
    return scalarValue(CMPI_boolean, value);
}

Value unsignedValue(std::uint64_t value, CMPIType type)
{
    return scalarValue(type, value);
}

Value signedValue(std::int64_t value, CMPIType type)
{
    return scalarValue(type, value);
}

Value realValue(double value, CMPIType type)
{
    return scalarValue(type, value);
}

Value textValue(std::string value, CMPIType type)
{
    return scalarValue(type, std::move(value));
}

Value referenceValue(ObjectPath path)
{
    return scalarValue(CMPI_ref, std::make_shared<const ObjectPath>(std::move(path)));
}

Value instanceValue(Instance instance)
{
    return scalarValue(CMPI_instance, std::make_shared<const Instance>(std::move(instance)));
}

Value nullValue(CMPIType type)
{
    return {type, true, {}};
}

Value arrayValue(CMPIType elementType, std::vector<Value::Scalar> items)
{
    return {static_cast<CMPIType>(elementType | CMPI_ARRAY), false, std::move(items)};
}

bool operator==(const Value& a, const Value& b)
{
    return a.type == b.type && a.isNull == b.isNull && equalLists(a.items, b.items, equalScalars);
}

bool operator==(const ObjectPath& a, const ObjectPath& b)
{
    return a.host == b.host && a.nameSpace == b.nameSpace && a.className == b.className &&
           equalNamed(a.keys, b.keys);
}

bool operator==(const Instance& a, const Instance& b)
{
    return a.path == b.path && equalNamed(a.properties, b.properties);
}

bool operator!=(const Value& a, const Value& b)
{
    return !(a == b);
}

bool operator!=(const ObjectPath& a, const ObjectPath& b)
{
    return !(a == b);
}

bool operator!=(const Instance& a, const Instance& b)
{
    return !(a == b);
}

std::string lowerCase(std::string text)
{
    const auto lower = [](char byte) {
        return byte >= 'A' && byte <= 'Z' ? static_cast<char>(byte - 'A' + 'a') : byte;
    };
    std::transform(text.begin(), text.end(), text.begin(), lower);
    return text;
}

bool sameName(std::string_view a, std::string_view b)
{
    return a.size() == b.size() && strncasecmp(a.data(), b.data(), a.size()) == 0;
}

bool sameKeyValue(const Value& a, const Value& b)
{
    return a.isNull == b.isNull && isArray(a) == isArray(b) && equalLists(a.items, b.items, sameKeyScalar);
}

bool sameObject(const ObjectPath& a, const ObjectPath& b)
{
    return sameName(a.className, b.className) && sameOrMissing(a.nameSpace, b.nameSpace) &&
           a.keys.size() == b.keys.size() && std::all_of(a.keys.begin(), a.keys.end(), [&](const Key& key) {
               const Value* other = findKey(b, key.name);
               return other != nullptr && sameKeyValue(key.value, *other);
           });
}

std::string lookupText(const ObjectPath& path)
{
    std::vector<std::string> keys;
    keys.reserve(path.keys.size());
    for (const Key& key : path.keys)
        keys.push_back(lowerCase(key.name) + '=' + lookupText(key.value));
    std::sort(keys.begin(), keys.end());

    std::string text = lowerCase(path.className);
    for (const std::string& key : keys)
        text += '\n' + key;
    return text;
}

const Value* findKey(const ObjectPath& path, std::string_view name)
{
    return findNamed(path.keys, name);
}

const Value* findProperty(const Instance& instance, std::string_view name)
{
    return findNamed(instance.properties, name);
}

std::string typeName(CMPIType type)
{
    const bool array = (type & CMPI_ARRAY) != 0;
    const auto elementType = static_cast<CMPIType>(type & ~CMPI_ARRAY);
    const auto* found = std::find_if(typeNames.begin(), typeNames.end(),
                                     [&](const TypeName& entry) { return entry.type == elementType; });
    const std::string name = found == typeNames.end() ? unknownTypeName(elementType) : found->name;
    return array ? name + "[]" : name;
}

bool isArray(const Value& value)
{
    return (value.type & CMPI_ARRAY) != 0;
}

} // namespace cimhost::cim
