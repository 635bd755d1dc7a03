#include "serve/ValueReader.h"

#include "broker/DateTime.h"
#include "cim/Number.h"
#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/Dtd.h"
#include "serve/Fault.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <limits>
#include <optional>
#include <set>

namespace cimhost::serve {

namespace {

struct NumberType
{
    CMPIType type;
    std::int64_t least;
    std::uint64_t most;
};

template <class Integer>
constexpr NumberType numberType(CMPIType type)
{
    return {type, std::numeric_limits<Integer>::min(), std::numeric_limits<Integer>::max()};
}

constexpr NumberType unsignedType(CMPIType type, std::uint64_t most)
{
    return {type, 0, most};
}

constexpr std::array integerTypes{
    unsignedType(CMPI_uint8, UINT8_MAX),   unsignedType(CMPI_uint16, UINT16_MAX),
    unsignedType(CMPI_uint32, UINT32_MAX), unsignedType(CMPI_uint64, UINT64_MAX),
    numberType<std::int8_t>(CMPI_sint8),   numberType<std::int16_t>(CMPI_sint16),
    numberType<std::int32_t>(CMPI_sint32), numberType<std::int64_t>(CMPI_sint64),
};

constexpr std::array otherTypes{CMPI_boolean,  CMPI_string, CMPI_char16,
                                CMPI_dateTime, CMPI_real32, CMPI_real64};

/// Nothing: no type of CIM that stands in a TYPE attribute.
std::optional<CMPIType> findType(const std::string& name)
{
    for (const NumberType& integer : integerTypes)
        if (cim::typeName(integer.type) == name)
            return integer.type;
    for (const int other : otherTypes)
        if (cim::typeName(static_cast<CMPIType>(other)) == name)
            return static_cast<CMPIType>(other);
    return std::nullopt;
}

CMPIType typeOf(const Element& element)
{
    const std::string& name = attribute(element, "TYPE");
    const std::optional<CMPIType> type = findType(name);
    if (!type)
        failAt(element, "the type \"" + cim::excerpt(name) + '"', "one of CIM's types");
    return *type;
}

std::string_view trimmed(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(" \t\r\n");
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(" \t\r\n") - first + 1);
}

std::optional<bool> parseBoolean(std::string_view text)
{
    const bool isTrue = cim::sameName(trimmed(text), "TRUE");
    const bool isFalse = cim::sameName(trimmed(text), "FALSE");
    return isTrue || isFalse ? std::optional(isTrue) : std::nullopt;
}

/// Numbers as DMTF DSP0201 has them: decimal, and whole ones in hexadecimal too.
std::optional<cim::Value> parseAnyNumber(std::string_view text)
{
    text = trimmed(text);
    const bool isNegative = text.substr(0, 1) == "-";
    std::string_view digits = text;
    if (isNegative || text.substr(0, 1) == "+")
        digits.remove_prefix(1);
    if (!cim::sameName(digits.substr(0, 2), "0x"))
        return cim::parseNumber(text);
    digits.remove_prefix(2);
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number, 16);
    if (digits.empty() || error != std::errc() || end != digits.data() + digits.size())
        return std::nullopt;
    return cim::parseNumber((isNegative ? "-" : "") + std::to_string(number));
}

/// The number as one of a narrower type; nothing: it does not fit.
std::optional<cim::Value::Scalar> narrowed(const cim::Value::Scalar& number, CMPIType type)
{
    const auto* const limits = std::find_if(integerTypes.begin(), integerTypes.end(),
                                            [&](const NumberType& entry) { return entry.type == type; });
    if (limits == integerTypes.end()) { // a real number, which any number is
        if (const auto* natural = std::get_if<std::uint64_t>(&number))
            return static_cast<double>(*natural);
        if (const auto* integer = std::get_if<std::int64_t>(&number))
            return static_cast<double>(*integer);
        return number;
    }
    const bool isSigned = limits->least < 0;
    if (const auto* natural = std::get_if<std::uint64_t>(&number)) {
        if (*natural > limits->most)
            return std::nullopt;
        return isSigned ? cim::Value::Scalar(static_cast<std::int64_t>(*natural)) : number;
    }
    if (const auto* integer = std::get_if<std::int64_t>(&number);
        integer != nullptr && *integer >= limits->least)
        return number;
    return std::nullopt;
}

/// The one character of a text, of the 16 bits that CIM's characters have.
std::optional<std::uint64_t> parseCharacter(std::string_view text)
{
    if (text.empty())
        return std::nullopt;
    const std::optional<char32_t> character = cim::takeCharacter(text);
    return character && *character <= 0xFFFF && text.empty() ? std::optional<std::uint64_t>(*character)
                                                             : std::nullopt;
}

std::optional<cim::Value::Scalar> parseScalar(const std::string& text, CMPIType type)
{
    switch (type) {
    case CMPI_string:
        return text;
    case CMPI_dateTime:
        return isDateTime(text) ? std::optional<cim::Value::Scalar>(text) : std::nullopt;
    case CMPI_boolean: {
        const std::optional<bool> flag = parseBoolean(text);
        return flag ? std::optional<cim::Value::Scalar>(*flag) : std::nullopt;
    }
    case CMPI_char16: {
        const std::optional<std::uint64_t> character = parseCharacter(text);
        return character ? std::optional<cim::Value::Scalar>(*character) : std::nullopt;
    }
    default: {
        const std::optional<cim::Value> number = parseAnyNumber(text);
        return number ? narrowed(number->items.front(), type) : std::nullopt;
    }
    }
}

/// \param element  one that has text only
cim::Value::Scalar readScalar(const Element& element, CMPIType type)
{
    const std::string& text = textOf(element);
    std::optional<cim::Value::Scalar> value = parseScalar(text, type);
    if (!value)
        throw ValueError(element, '"' + cim::excerpt(text) + '"',
                         "a value of the type " + cim::typeName(type));
    return std::move(*value);
}

cim::Value scalarValue(CMPIType type, cim::Value::Scalar item)
{
    return {type, false, {std::move(item)}};
}

cim::ObjectPath readReference(const Element& element);

cim::Value readKeyValue(const Element& element)
{
    if (findAttribute(element, "TYPE") != nullptr) {
        const CMPIType type = typeOf(element);
        return scalarValue(type, readScalar(element, type));
    }
    const std::string* const kind = findAttribute(element, "VALUETYPE");
    if (kind == nullptr || *kind == "string")
        return cim::textValue(textOf(element));
    if (*kind == "boolean")
        return scalarValue(CMPI_boolean, readScalar(element, CMPI_boolean));
    if (*kind != "numeric")
        failAt(element, "the value type \"" + cim::excerpt(*kind) + '"', "string, boolean or numeric");
    const std::string& text = textOf(element);
    std::optional<cim::Value> number = parseAnyNumber(text);
    if (!number)
        throw ValueError(element, '"' + cim::excerpt(text) + '"', "a number of 64 bits");
    return std::move(*number);
}

/// \param element  KEYVALUE or VALUE.REFERENCE
cim::Value readAnyKeyValue(const Element& element)
{
    return element.name == "KEYVALUE" ? readKeyValue(element) : cim::referenceValue(readReference(element));
}

/// Names that were given so far. Of thousands each is found in some steps, whatever they are: a client that knows
/// how a hash is made would choose those that collide.
using GivenNames = std::set<std::string>;

/// Whether it was not there, in any letter case.
bool add(GivenNames& given, const std::string& name)
{
    return given.insert(cim::lowerCase(name)).second;
}

void readKey(const Element& element, GivenNames& given, cim::ObjectPath& path)
{
    const std::string& name = attribute(element, "NAME");
    if (name.empty())
        failAt(element, "an empty NAME", "the name of a key");
    if (!add(given, name))
        throw ValueError(element, "the key " + cim::excerpt(name) + " again", "each key once");
    path.keys.push_back({name, readAnyKeyValue(onlyChild(element, {"KEYVALUE", "VALUE.REFERENCE"}))});
}

/// The key's value as one of the declared type, which CIM-XML need not tell; nothing: it is none of it.
std::optional<cim::Value::Scalar> typedAs(CMPIType declared, const cim::Value& given)
{
    const bool isText = declared == CMPI_string || declared == CMPI_dateTime || declared == CMPI_char16;
    const cim::Value::Scalar& item = given.items.front();
    if (const auto* const text = std::get_if<std::string>(&item))
        return isText ? parseScalar(*text, declared) : std::nullopt;
    const bool isNumber = given.type != CMPI_boolean && given.type != CMPI_ref && given.type != CMPI_char16;
    return isNumber && !isText && declared != CMPI_boolean ? narrowed(item, declared) : std::nullopt;
}

cim::ObjectPath readClassName(const Element& element)
{
    return {"", "", attribute(element, "NAME"), {}};
}

/// \param element  what stands in a VALUE.REFERENCE
cim::ObjectPath readAnyPath(const Element& element)
{
    if (element.name == "INSTANCENAME")
        return readInstanceName(element);
    if (element.name == "CLASSNAME")
        return readClassName(element);
    const bool isClass = isOneOf(element, {"CLASSPATH", "LOCALCLASSPATH"});
    const bool isLocal = isOneOf(element, {"LOCALCLASSPATH", "LOCALINSTANCEPATH"});
    const std::vector<Element>& parts = childrenInOrder(
        element, {isLocal ? "LOCALNAMESPACEPATH" : "NAMESPACEPATH", isClass ? "CLASSNAME" : "INSTANCENAME"});
    cim::ObjectPath path = isClass ? readClassName(parts[1]) : readInstanceName(parts[1]);
    if (isLocal) {
        path.nameSpace = readNameSpace(parts[0]);
        return path;
    }
    const std::vector<Element>& place = childrenInOrder(parts[0], {"HOST", "LOCALNAMESPACEPATH"});
    path.host = textOf(place[0]);
    path.nameSpace = readNameSpace(place[1]);
    return path;
}

/// \param element  VALUE.REFERENCE
cim::ObjectPath readReference(const Element& element)
{
    cim::ObjectPath path =
        readAnyPath(onlyChild(element, {"CLASSPATH", "LOCALCLASSPATH", "CLASSNAME", "INSTANCEPATH",
                                        "LOCALINSTANCEPATH", "INSTANCENAME"}));
    if (!path.keys.empty() && path.keys.front().name.empty())
        throw ValueError(element, "a key without its name in a reference", "KEYBINDING");
    return path;
}

/// Reads the properties of one instance.
class PropertyReader
{
public:
    explicit PropertyReader(const XmlLimits& limits) : limits_(limits) {}

    cim::Value read(const Element& property)
    {
        childrenAmong(property, {"QUALIFIER", "VALUE", "VALUE.ARRAY", "VALUE.REFERENCE"});
        if (property.name == "PROPERTY.REFERENCE")
            return readOne(property, CMPI_ref, "VALUE.REFERENCE");
        if (isEmbedded(property))
            return readOne(property, CMPI_instance, property.name == "PROPERTY" ? "VALUE" : "VALUE.ARRAY");
        return readOne(property, typeOf(property), property.name == "PROPERTY" ? "VALUE" : "VALUE.ARRAY");
    }

private:
    static bool isEmbedded(const Element& property)
    {
        return findAttribute(property, "EmbeddedObject") != nullptr ||
               findAttribute(property, "EMBEDDEDOBJECT") != nullptr;
    }

    cim::Value readOne(const Element& property, CMPIType type, std::string_view expected)
    {
        const bool isArray = expected == "VALUE.ARRAY";
        const Element* value = nullptr;
        for (const Element& child : property.children) {
            if (child.name == "QUALIFIER")
                continue;
            if (value != nullptr || child.name != expected)
                failAt(child, "this element in " + property.name, "one " + std::string(expected));
            value = &child;
        }
        if (value == nullptr)
            return cim::nullValue(isArray ? static_cast<CMPIType>(type | CMPI_ARRAY) : type);
        return isArray ? readArray(*value, type) : scalarValue(type, readItem(*value, type));
    }

    cim::Value readArray(const Element& array, CMPIType type)
    {
        std::vector<cim::Value::Scalar> items;
        for (const Element& item : childrenAmong(array, {"VALUE", "VALUE.NULL"}))
            items.push_back(item.name == "VALUE.NULL" ? cim::Value::Scalar() : readItem(item, type));
        return cim::arrayValue(type, std::move(items));
    }

    cim::Value::Scalar readItem(const Element& item, CMPIType type)
    {
        if (type == CMPI_ref)
            return std::make_shared<const cim::ObjectPath>(readReference(item));
        if (type == CMPI_instance)
            return std::make_shared<const cim::Instance>(readEmbedded(item));
        return readScalar(item, type);
    }

    /// An embedded instance is a document in the text, all of which is read once more: it counts as several
    /// levels of depth.
    cim::Instance readEmbedded(const Element& item)
    {
        try {
            XmlLimits limits = limits_;
            limits.depth -= std::min(limits.depth, levelsOfEmbedded);
            const Element document = parseXml(textOf(item), limits, &isKnownElement);
            if (document.name != "INSTANCE")
                throw ValueError(item, document.name, "an embedded INSTANCE");
            return readInstance(document, limits);
        } catch (const RequestError& error) {
            throw ValueError(item, "text that is no embedded instance", error.what());
        }
    }

    static constexpr std::size_t levelsOfEmbedded = 8;

    const XmlLimits& limits_;
};

} // namespace

ValueError::ValueError(const Element& element, const std::string& found, const std::string& expected)
    : ValueError(CMPI_RC_ERR_INVALID_PARAMETER,
                 placeOf(element) + ": found " + found + ", expected " + expected)
{}

ValueError::ValueError(CMPIrc code, const std::string& message) : std::runtime_error(message), code_(code) {}

std::string readNameSpace(const Element& element)
{
    std::string nameSpace;
    for (const Element& part : childrenAmong(element, {"NAMESPACE"})) {
        const std::string& name = attribute(part, "NAME");
        if (('/' + name + '/').find("//") != std::string::npos)
            failAt(part, "the name \"" + cim::excerpt(name) + '"', "names between slashes");
        nameSpace += (nameSpace.empty() ? "" : "/") + name;
    }
    if (element.children.empty())
        failAt(element, "nothing", "NAMESPACE");
    return nameSpace;
}

cim::ObjectPath readInstanceName(const Element& element)
{
    cim::ObjectPath path{"", "", attribute(element, "CLASSNAME"), {}};
    GivenNames given;
    for (const Element& key : childrenAmong(element, {"KEYBINDING", "KEYVALUE", "VALUE.REFERENCE"})) {
        if (key.name == "KEYBINDING")
            readKey(key, given, path);
        else if (element.children.size() == 1)
            path.keys.push_back({"", readAnyKeyValue(key)});
        else
            throw ValueError(key, "a key without its name among others", "KEYBINDING");
    }
    return path;
}

void typeKeys(cim::ObjectPath& path, const schema::Classes& classes)
{
    const schema::Class* const declaration = classes.find(path.className);
    for (cim::Key& key : path.keys) {
        if (key.name.empty()) {
            const std::vector<std::string>& names = classes.keysOf(path.className);
            if (names.size() != 1)
                throw ValueError(CMPI_RC_ERR_INVALID_PARAMETER,
                                 "found a key without its name, expected KEYBINDING: the class " +
                                     cim::excerpt(path.className) + " is not known to have one key");
            key.name = names.front();
        }
        const schema::Property* const declared =
            declaration == nullptr ? nullptr : classes.findDeclared(*declaration, key.name);
        const std::optional<CMPIType> type = declared == nullptr ? std::nullopt : findType(declared->type);
        if (!type)
            continue;
        if (std::optional<cim::Value::Scalar> value = typedAs(*type, key.value))
            key.value = scalarValue(*type, std::move(*value));
    }
}

cim::Instance readInstance(const Element& element, const XmlLimits& limits)
{
    cim::Instance instance;
    instance.path.className = attribute(element, "CLASSNAME");
    PropertyReader reader(limits);
    GivenNames given;
    for (const Element& child :
         childrenAmong(element, {"QUALIFIER", "PROPERTY", "PROPERTY.ARRAY", "PROPERTY.REFERENCE"})) {
        if (child.name == "QUALIFIER")
            continue;
        const std::string& name = attribute(child, "NAME");
        if (!add(given, name))
            throw ValueError(child, "the property " + cim::excerpt(name) + " again", "each property once");
        instance.properties.push_back({name, reader.read(child)});
    }
    return instance;
}

std::uint32_t readUnsigned(const Element& element)
{
    return static_cast<std::uint32_t>(std::get<std::uint64_t>(readScalar(element, CMPI_uint32)));
}

bool readBoolean(const Element& element)
{
    return std::get<bool>(readScalar(element, CMPI_boolean));
}

} // namespace cimhost::serve
