#include "serve/Dtd.h"

#include "cim/Utf8.h"
#include "serve/Fault.h"

#include <algorithm>
#include <array>

namespace cimhost::serve {

namespace {

/// In the order of their bytes.
constexpr std::array<std::string_view, 66> knownElements{
    "CIM",
    "CLASS",
    "CLASSNAME",
    "CLASSPATH",
    "CORRELATOR",
    "DECLARATION",
    "DECLGROUP",
    "DECLGROUP.WITHNAME",
    "DECLGROUP.WITHPATH",
    "ENUMERATIONCONTEXT",
    "ERROR",
    "EXPMETHODCALL",
    "EXPMETHODRESPONSE",
    "EXPPARAMVALUE",
    "HOST",
    "IMETHODCALL",
    "IMETHODRESPONSE",
    "INSTANCE",
    "INSTANCENAME",
    "INSTANCEPATH",
    "IPARAMVALUE",
    "IRETURNVALUE",
    "KEYBINDING",
    "KEYVALUE",
    "LOCALCLASSPATH",
    "LOCALINSTANCEPATH",
    "LOCALNAMESPACEPATH",
    "MESSAGE",
    "METHOD",
    "METHODCALL",
    "METHODRESPONSE",
    "MULTIEXPREQ",
    "MULTIEXPRSP",
    "MULTIREQ",
    "MULTIRSP",
    "NAMESPACE",
    "NAMESPACEPATH",
    "OBJECTPATH",
    "PARAMETER",
    "PARAMETER.ARRAY",
    "PARAMETER.REFARRAY",
    "PARAMETER.REFERENCE",
    "PARAMVALUE",
    "PROPERTY",
    "PROPERTY.ARRAY",
    "PROPERTY.REFERENCE",
    "QUALIFIER",
    "QUALIFIER.DECLARATION",
    "RETURNVALUE",
    "SCOPE",
    "SIMPLEEXPREQ",
    "SIMPLEEXPRSP",
    "SIMPLEREQ",
    "SIMPLEREQACK",
    "SIMPLERSP",
    "VALUE",
    "VALUE.ARRAY",
    "VALUE.INSTANCEWITHPATH",
    "VALUE.NAMEDINSTANCE",
    "VALUE.NAMEDOBJECT",
    "VALUE.NULL",
    "VALUE.OBJECT",
    "VALUE.OBJECTWITHLOCALPATH",
    "VALUE.OBJECTWITHPATH",
    "VALUE.REFARRAY",
    "VALUE.REFERENCE",
};

std::string joined(Names names)
{
    std::string text;
    std::size_t left = names.size();
    for (const std::string_view name : names) {
        text += name;
        if (--left > 0)
            text += left == 1 ? " or " : ", ";
    }
    return text;
}

void requireNoText(const Element& element)
{
    if (element.text.find_first_not_of(" \t\r\n") != std::string::npos)
        failAt(element, "the text \"" + cim::excerpt(element.text) + '"', "elements only");
}

} // namespace

bool isKnownElement(std::string_view name)
{
    return std::binary_search(knownElements.begin(), knownElements.end(), name);
}

std::string placeOf(const Element& element)
{
    return "line " + std::to_string(element.line) + ", " + element.name;
}

const std::string* findAttribute(const Element& element, std::string_view name)
{
    const auto found = std::find_if(element.attributes.begin(), element.attributes.end(),
                                    [&](const Attribute& candidate) { return candidate.name == name; });
    return found == element.attributes.end() ? nullptr : &found->value;
}

const std::string& attribute(const Element& element, std::string_view name)
{
    const std::string* const value = findAttribute(element, name);
    if (value == nullptr)
        failAt(element, "no attribute " + std::string(name), "one");
    return *value;
}

bool isOneOf(const Element& element, Names names)
{
    return std::find(names.begin(), names.end(), element.name) != names.end();
}

const Element& onlyChild(const Element& element, Names names)
{
    const Element* const child = optionalChild(element, names);
    if (child == nullptr)
        failAt(element, "nothing", joined(names));
    return *child;
}

const Element* optionalChild(const Element& element, Names names)
{
    const std::vector<Element>& children = childrenAmong(element, names);
    if (children.size() > 1)
        failAt(children[1], "a second element in " + element.name, "one");
    return children.empty() ? nullptr : &children.front();
}

const std::vector<Element>& childrenAmong(const Element& element, Names names)
{
    requireNoText(element);
    for (const Element& child : element.children)
        if (!isOneOf(child, names))
            failAt(child, "this element in " + element.name, joined(names));
    return element.children;
}

const std::vector<Element>& childrenInOrder(const Element& element, Names names)
{
    requireNoText(element);
    auto child = element.children.begin();
    for (const std::string_view name : names) {
        if (child == element.children.end())
            failAt(element, "its end", std::string(name));
        if (child->name != name)
            failAt(*child, "this element in " + element.name, std::string(name));
        ++child;
    }
    if (child != element.children.end())
        failAt(*child, "this element in " + element.name, "its end");
    return element.children;
}

const std::string& textOf(const Element& element)
{
    if (!element.children.empty())
        failAt(element.children.front(), "this element in " + element.name, "text only");
    return element.text;
}

void failAt(const Element& element, const std::string& found, const std::string& expected)
{
    throw RequestError(Fault::notLooselyValid,
                       placeOf(element) + ": found " + found + ", expected " + expected);
}

} // namespace cimhost::serve
