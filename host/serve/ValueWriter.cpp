#include "serve/ValueWriter.h"

#include "cim/Literal.h"
#include "cim/Utf8.h"
#include "cim/Values.h"

#include <cmath>
#include <string_view>

namespace cimhost::serve {

namespace {

void writeReference(XmlWriter& xml, const cim::ObjectPath& path);

CMPIType elementTypeOf(const cim::Value& value)
{
    return static_cast<CMPIType>(value.type & ~CMPI_ARRAY);
}

/// An embedded instance is a document of its own, written as text.
std::string documentOf(const cim::Instance& instance)
{
    XmlWriter xml;
    writeInstance(xml, instance);
    return xml.document();
}

/// The text of one item, by what it is.
struct TextOf
{
    CMPIType type;

    std::string operator()(std::monostate /*null*/) const { return {}; }
    std::string operator()(bool flag) const { return flag ? "TRUE" : "FALSE"; }
    std::string operator()(std::uint64_t number) const
    {
        if (type != CMPI_char16)
            return std::to_string(number);
        std::string character;
        cim::appendCharacter(character, static_cast<char32_t>(number));
        return character;
    }
    std::string operator()(std::int64_t number) const { return std::to_string(number); }
    std::string operator()(double number) const
    {
        if (std::isnan(number))
            return "NaN";
        if (std::isinf(number))
            return number < 0 ? "-INF" : "INF";
        return cim::realText(number);
    }
    std::string operator()(const std::string& text) const { return text; }
    std::string operator()(const std::shared_ptr<const cim::ObjectPath>& /*path*/) const
    {
        throw UnwritableError("an array of references, for which CIM-XML has no form");
    }
    std::string operator()(const std::shared_ptr<const cim::Instance>& instance) const
    {
        return instance ? documentOf(*instance) : std::string();
    }
};

std::string textOf(const cim::Value::Scalar& item, CMPIType type)
{
    return std::visit(TextOf{type}, item);
}

const cim::ObjectPath& referenceOf(const cim::Value& value)
{
    const auto& path = std::get<std::shared_ptr<const cim::ObjectPath>>(value.items.front());
    if (!path)
        throw UnwritableError("a null reference, for which CIM-XML has no form");
    return *path;
}

std::string_view valueTypeOf(CMPIType type)
{
    switch (type) {
    case CMPI_boolean:
        return "boolean";
    case CMPI_string:
    case CMPI_char16:
    case CMPI_dateTime:
        return "string";
    default:
        return "numeric";
    }
}

void writeKeyValue(XmlWriter& xml, const cim::Key& key)
{
    const cim::Value& value = key.value;
    if (value.isNull || cim::isArray(value) || value.type == CMPI_instance)
        throw UnwritableError("the key " + key.name + " of the type " + cim::typeName(value.type) +
                              (value.isNull ? ", null" : "") + ", for which CIM-XML has no form");
    if (value.type == CMPI_ref) {
        writeReference(xml, referenceOf(value));
        return;
    }
    xml.element("KEYVALUE", [&] {
        xml.attribute("VALUETYPE", valueTypeOf(value.type));
        if (value.type != CMPI_string && value.type != CMPI_boolean)
            xml.attribute("TYPE", cim::typeName(value.type));
        xml.text(textOf(value.items.front(), value.type));
    });
}

void writeNameSpace(XmlWriter& xml, std::string_view nameSpace)
{
    xml.element("LOCALNAMESPACEPATH", [&] {
        while (!nameSpace.empty()) {
            const std::string_view part = nameSpace.substr(0, nameSpace.find('/'));
            xml.element("NAMESPACE", [&] { xml.attribute("NAME", part); });
            nameSpace.remove_prefix(std::min(part.size() + 1, nameSpace.size()));
        }
    });
}

/// VALUE.REFERENCE, with as much of the path as it has.
void writeReference(XmlWriter& xml, const cim::ObjectPath& path)
{
    xml.element("VALUE.REFERENCE", [&] {
        if (path.nameSpace.empty())
            writeInstanceName(xml, path);
        else if (path.host.empty())
            xml.element("LOCALINSTANCEPATH", [&] {
                writeNameSpace(xml, path.nameSpace);
                writeInstanceName(xml, path);
            });
        else
            writeInstancePath(xml, path);
    });
}

void writeOrigin(XmlWriter& xml, std::string_view origin)
{
    if (!origin.empty())
        xml.attribute("CLASSORIGIN", origin);
}

/// The attributes that all kinds of properties with a type have.
void writeHead(XmlWriter& xml, const cim::Property& property, std::string_view origin)
{
    xml.attribute("NAME", property.name);
    writeOrigin(xml, origin);
    const CMPIType type = elementTypeOf(property.value);
    const bool isInstance = type == CMPI_instance;
    // A null without a type has to have one.
    xml.attribute("TYPE", isInstance || type == CMPI_null ? "string" : cim::typeName(type));
    if (isInstance)
        xml.attribute("EmbeddedObject", "instance");
}

void writeArray(XmlWriter& xml, const cim::Property& property, std::string_view origin)
{
    const CMPIType type = elementTypeOf(property.value);
    xml.element("PROPERTY.ARRAY", [&] {
        writeHead(xml, property, origin);
        if (property.value.isNull)
            return;
        xml.element("VALUE.ARRAY", [&] {
            for (const cim::Value::Scalar& item : property.value.items)
                if (std::holds_alternative<std::monostate>(item))
                    xml.element("VALUE.NULL", [] {});
                else
                    xml.element("VALUE", [&] { xml.text(textOf(item, type)); });
        });
    });
}

/// \param origin  empty: it is not told
void writeProperty(XmlWriter& xml, const cim::Property& property, std::string_view origin)
{
    const cim::Value& value = property.value;
    if (value.type == CMPI_ref)
        xml.element("PROPERTY.REFERENCE", [&] {
            xml.attribute("NAME", property.name);
            writeOrigin(xml, origin);
            if (!value.isNull)
                writeReference(xml, referenceOf(value));
        });
    else if (cim::isArray(value))
        writeArray(xml, property, origin);
    else
        xml.element("PROPERTY", [&] {
            writeHead(xml, property, origin);
            if (!value.isNull)
                xml.element("VALUE", [&] { xml.text(textOf(value.items.front(), value.type)); });
        });
}

} // namespace

void writeInstanceName(XmlWriter& xml, const cim::ObjectPath& path)
{
    xml.element("INSTANCENAME", [&] {
        xml.attribute("CLASSNAME", path.className);
        for (const cim::Key& key : path.keys)
            xml.element("KEYBINDING", [&] {
                xml.attribute("NAME", key.name);
                writeKeyValue(xml, key);
            });
    });
}

void writeInstancePath(XmlWriter& xml, const cim::ObjectPath& path)
{
    xml.element("INSTANCEPATH", [&] {
        xml.element("NAMESPACEPATH", [&] {
            xml.element("HOST", [&] { xml.text(path.host); });
            writeNameSpace(xml, path.nameSpace);
        });
        writeInstanceName(xml, path);
    });
}

void writeInstance(XmlWriter& xml, const cim::Instance& instance, const schema::Classes* origins)
{
    xml.element("INSTANCE", [&] {
        xml.attribute("CLASSNAME", instance.path.className);
        for (const cim::Property& property : instance.properties)
            writeProperty(xml, property,
                          origins == nullptr ? std::string_view()
                                             : origins->originOf(instance.path.className, property.name));
    });
}

} // namespace cimhost::serve
