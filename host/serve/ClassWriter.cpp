#include "serve/ClassWriter.h"

#include "cim/Values.h"
#include "schema/Classes.h"

#include <algorithm>
#include <string>

namespace cimhost::serve {

namespace {

void writeFlag(XmlWriter& xml, const char* name, bool value)
{
    xml.attribute(name, value ? "true" : "false");
}

/// TRUE and FALSE are written in capital letters, which the MOF need not have.
std::string textOf(const std::string& value, bool isFlag)
{
    return isFlag ? (value == "true" ? "TRUE" : "FALSE") : value;
}

void writeValue(XmlWriter& xml, const std::vector<std::string>& values, bool isArray, bool isFlag)
{
    const auto writeItems = [&] {
        for (const std::string& value : values)
            xml.element("VALUE", [&] { xml.text(textOf(value, isFlag)); });
    };
    if (isArray)
        xml.element("VALUE.ARRAY", writeItems);
    else
        writeItems();
}

/// Without the declarations of qualifiers, the type is the one of such a value. Of numbers those that limit
/// others have 64 bits.
const char* typeOf(const schema::Qualifier& qualifier)
{
    switch (qualifier.kind) {
    case schema::Parameter::Text:
    case schema::Parameter::Texts:
        return "string";
    case schema::Parameter::Number:
        return cim::sameName(qualifier.name, "MinValue") || cim::sameName(qualifier.name, "MaxValue")
                   ? "sint64"
                   : "uint32";
    default:
        return "boolean";
    }
}

void writeQualifiers(XmlWriter& xml, const std::vector<schema::Qualifier>& qualifiers)
{
    for (const schema::Qualifier& qualifier : qualifiers)
        xml.element("QUALIFIER", [&] {
            xml.attribute("NAME", qualifier.name);
            xml.attribute("TYPE", typeOf(qualifier));
            if (qualifier.isInherited)
                writeFlag(xml, "PROPAGATED", true);
            writeFlag(xml, "TOSUBCLASS", !isRestricted(qualifier));
            if (qualifier.kind == schema::Parameter::None)
                writeValue(xml, {"true"}, false, true);
            else
                writeValue(xml, qualifier.values, qualifier.kind == schema::Parameter::Texts,
                           qualifier.kind == schema::Parameter::Flag);
        });
}

void writeProperty(XmlWriter& xml, const schema::Property& property)
{
    const char* const element = property.isReference ? "PROPERTY.REFERENCE"
                                : property.isArray   ? "PROPERTY.ARRAY"
                                                     : "PROPERTY";
    xml.element(element, [&] {
        xml.attribute("NAME", property.name);
        xml.attribute(property.isReference ? "REFERENCECLASS" : "TYPE", property.type);
        if (!property.origin.empty())
            xml.attribute("CLASSORIGIN", property.origin);
        writeFlag(xml, "PROPAGATED", property.isInherited);
        writeQualifiers(xml, property.qualifiers);
        const schema::WrittenValue& value = property.defaultValue;
        if (value.kind != schema::WrittenValue::Null)
            writeValue(xml, value.elements, property.isArray, value.kind == schema::WrittenValue::Flag);
    });
}

} // namespace

void writeClass(XmlWriter& xml, const schema::Class& declaration)
{
    xml.element("CLASS", [&] {
        xml.attribute("NAME", declaration.name);
        if (!declaration.superclass.empty())
            xml.attribute("SUPERCLASS", declaration.superclass);
        writeQualifiers(xml, declaration.qualifiers);
        for (const schema::Property& property : declaration.properties)
            writeProperty(xml, property);
    });
}

} // namespace cimhost::serve
