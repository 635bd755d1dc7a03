#include "Rules.h"

#include <algorithm>
#include <array>
#include <regex>
#include <set>

namespace cimhost::schema {
namespace {

/// Of the DMTF schema's qualifier declarations, what the project's classes use.
struct QualifierDeclaration
{
    const char* name;
    Parameter kind;
    bool ofClasses;
    bool ofProperties;
};

constexpr std::array qualifierDeclarations = {
    QualifierDeclaration{"Association", Parameter::None, true, false},
    QualifierDeclaration{"Description", Parameter::Text, true, true},
    QualifierDeclaration{"Key", Parameter::None, false, true},
    QualifierDeclaration{"Override", Parameter::Text, false, true},
    QualifierDeclaration{"ValueMap", Parameter::Texts, false, true},
    QualifierDeclaration{"Values", Parameter::Texts, false, true},
    QualifierDeclaration{"Version", Parameter::Text, true, false},
};

const QualifierDeclaration* findDeclaration(const std::string& name)
{
    // Exactly as DMTF writes them.
    const auto* const found =
        std::find_if(qualifierDeclarations.begin(), qualifierDeclarations.end(),
                     [&](const QualifierDeclaration& declaration) { return declaration.name == name; });
    return found != qualifierDeclarations.end() ? found : nullptr;
}

bool isUint16(const std::string& text)
{
    static const std::regex digits("0|[1-9][0-9]{0,4}");
    return std::regex_match(text, digits) && std::stoul(text) <= 65535;
}

/// Gathers what is wrong with one class.
class Inspection
{
public:
    Inspection(const Class& declaration, const Classes& classes) : class_(declaration), classes_(classes) {}

    std::vector<std::string> inspect()
    {
        inspectClass();
        for (const Property& property : class_.properties)
            inspectProperty(property);
        inspectKeys();
        return std::move(breaches_);
    }

private:
    void complain(const std::string& what) { breaches_.push_back(class_.name + ": " + what); }
    void complain(const Property& property, const std::string& what)
    {
        breaches_.push_back(class_.name + "." + property.name + ": " + what);
    }

    void inspectClass()
    {
        const Class* const superclass = classes_.find(class_.superclass);
        if (superclass == nullptr)
            complain("there is no superclass " + class_.superclass);
        else if (isAssociation(class_) != isAssociation(*superclass))
            complain("Association does not agree with " + superclass->name);
        if (isAssociation(class_) && class_.qualifiers.front().name != "Association")
            complain("Association does not come first");

        for (const Qualifier& qualifier : class_.qualifiers) {
            const QualifierDeclaration* const declared = findDeclaration(qualifier.name);
            if (declared == nullptr || !declared->ofClasses || declared->kind != qualifier.kind)
                complain("DMTF declares no such qualifier " + qualifier.name);
        }
        inspectVersion();
        if (findQualifier(class_.qualifiers, "Description") == nullptr)
            complain("has no Description");
    }

    void inspectVersion()
    {
        static const std::regex numbers("[0-9]+\\.[0-9]+\\.[0-9]+");
        const Qualifier* const version = findQualifier(class_.qualifiers, "Version");
        if (version == nullptr || version->kind != Parameter::Text ||
            !std::regex_match(version->values.front(), numbers))
            complain("has no Version of the form M.N.U");
    }

    void inspectProperty(const Property& property)
    {
        for (const Qualifier& qualifier : property.qualifiers) {
            const QualifierDeclaration* const declared = findDeclaration(qualifier.name);
            if (declared == nullptr || !declared->ofProperties || declared->kind != qualifier.kind)
                complain(property, "DMTF declares no such qualifier " + qualifier.name);
        }
        if (findQualifier(property.qualifiers, "Description") == nullptr)
            complain(property, "has no Description");
        inspectOverride(property);
        inspectValues(property);
    }

    void inspectOverride(const Property& property)
    {
        const Qualifier* const override = findQualifier(property.qualifiers, "Override");
        if (override == nullptr || override->values != std::vector{property.name})
            complain(property, "has no Override with its own name");

        const Property* const inherited = classes_.findInherited(class_, property.name);
        if (inherited == nullptr || inherited->name != property.name)
            complain(property, "overrides nothing");
        else if (!refines(property, *inherited))
            complain(property, "is a " + typeText(property) + " and overrides a " + typeText(*inherited));
    }

    [[nodiscard]] bool refines(const Property& property, const Property& inherited) const
    {
        if (property.isReference && inherited.isReference)
            return classes_.isA(property.type, inherited.type);
        return typeText(property) == typeText(inherited);
    }

    void inspectKeys()
    {
        for (const Class* const superclass : classes_.superclassesOf(class_))
            for (const Property& inherited : superclass->properties)
                if (isKey(inherited))
                    inspectKey(inherited);
        for (const Property& property : class_.properties)
            if (isKey(property) && !isInheritedKey(property))
                complain(property, "is no key of a superclass");
    }

    void inspectKey(const Property& inherited)
    {
        const Property* const property = findProperty(class_, inherited.name);
        if (property == nullptr || !isKey(*property))
            complain("the key " + inherited.name + " is not declared");
    }

    [[nodiscard]] bool isInheritedKey(const Property& property) const
    {
        const Property* const inherited = classes_.findInherited(class_, property.name);
        return inherited != nullptr && isKey(*inherited);
    }

    void inspectValues(const Property& property)
    {
        const Qualifier* const map = findQualifier(property.qualifiers, "ValueMap");
        const Qualifier* const values = findQualifier(property.qualifiers, "Values");
        if (map == nullptr && values == nullptr)
            return;
        if (map == nullptr || values == nullptr || map->values.size() != values->values.size()) {
            complain(property, "ValueMap and Values are not of equal number");
            return;
        }
        if (std::set<std::string>(map->values.begin(), map->values.end()).size() != map->values.size())
            complain(property, "ValueMap has a number twice");
        for (const std::string& number : map->values)
            if (property.type != "uint16" || !isUint16(number))
                complain(property, "ValueMap has " + number + ", which is no uint16");
    }

    const Class& class_;
    const Classes& classes_;
    std::vector<std::string> breaches_;
};

} // namespace

std::vector<std::string> breaches(const Class& declaration, const Classes& classes)
{
    return Inspection(declaration, classes).inspect();
}

} // namespace cimhost::schema
