#include "schema/Classes.h"

#include "cim/Values.h"

#include <algorithm>
#include <array>
#include <utility>

namespace cimhost::schema {

using cim::sameName;

namespace {

template <class Named>
const Named* findNamed(const std::vector<Named>& list, std::string_view name)
{
    const auto found =
        std::find_if(list.begin(), list.end(), [&](const Named& item) { return sameName(item.name, name); });
    return found != list.end() ? &*found : nullptr;
}

constexpr std::size_t deepestInheritance = 64;

/// The qualifiers that DMTF DSP0004 declares as restricted to the class or property that has them.
constexpr std::array<std::string_view, 6> restrictedQualifiers{"Abstract", "Deprecated", "Experimental",
                                                               "Override", "Terminal",   "Version"};

void inherit(std::vector<Qualifier>& qualifiers, const std::vector<Qualifier>& inherited)
{
    for (const Qualifier& qualifier : inherited)
        if (!isRestricted(qualifier) && findNamed(qualifiers, qualifier.name) == nullptr) {
            qualifiers.push_back(qualifier);
            qualifiers.back().isInherited = true;
        }
}

/// The properties with those of the superclass, where they come in the place of what they override.
std::vector<Property> inherited(std::vector<Property> all, const std::vector<Property>& own)
{
    for (Property& property : all) {
        property.isInherited = true;
        for (Qualifier& qualifier : property.qualifiers)
            qualifier.isInherited = true;
    }
    for (const Property& property : own) {
        const auto overridden = std::find_if(all.begin(), all.end(), [&](const Property& other) {
            return sameName(other.name, property.name);
        });
        if (overridden == all.end()) {
            all.push_back(property);
            continue;
        }
        const Property before = std::exchange(*overridden, property);
        overridden->origin = before.origin;
        inherit(overridden->qualifiers, before.qualifiers);
    }
    return all;
}

} // namespace

const Qualifier* findQualifier(const std::vector<Qualifier>& qualifiers, std::string_view name)
{
    return findNamed(qualifiers, name);
}

const Property* findProperty(const Class& declaration, std::string_view name)
{
    return findNamed(declaration.properties, name);
}

bool isRestricted(const Qualifier& qualifier)
{
    return std::any_of(restrictedQualifiers.begin(), restrictedQualifiers.end(),
                       [&](std::string_view name) { return sameName(name, qualifier.name); });
}

bool isKey(const Property& property)
{
    return findQualifier(property.qualifiers, "Key") != nullptr;
}

bool isAssociation(const Class& declaration)
{
    return findQualifier(declaration.qualifiers, "Association") != nullptr;
}

std::string typeText(const Property& property)
{
    if (property.isReference)
        return property.type + " REF";
    return property.type + (property.isArray ? "[]" : "");
}

Classes::Classes(std::vector<Class> classes) : classes_(std::move(classes))
{
    for (std::size_t place = 0; place < classes_.size(); ++place)
        if (!places_.emplace(cim::lowerCase(classes_[place].name), place).second)
            throw MofError("there are two classes " + classes_[place].name);
    for (const Class& declaration : classes_) {
        // A circle of superclasses would be walked for ever.
        std::size_t steps = 0;
        for (const Class* next = &declaration; next != nullptr; next = find(next->superclass))
            if (steps++ > deepestInheritance)
                throw MofError("the class " + declaration.name + " derives from itself, or from more than " +
                               std::to_string(deepestInheritance) + " others");
    }
    for (const Class& declaration : classes_) {
        std::vector<std::string>& keys = keys_.emplace_back();
        for (const Property& property : completed(declaration).properties)
            if (isKey(property))
                keys.push_back(property.name);
    }
}

std::string_view Classes::originOf(std::string_view className, std::string_view property) const
{
    std::string_view origin;
    for (const Class* next = find(className); next != nullptr; next = find(next->superclass))
        if (findProperty(*next, property) != nullptr)
            origin = next->name;
    return origin;
}

const std::vector<std::string>& Classes::keysOf(std::string_view name) const
{
    static const std::vector<std::string> none;
    const Class* const declaration = find(name);
    return declaration == nullptr ? none : keys_[static_cast<std::size_t>(declaration - classes_.data())];
}

const Class* Classes::find(std::string_view name) const
{
    const auto found = places_.find(cim::lowerCase(std::string(name)));
    return found == places_.end() ? nullptr : &classes_[found->second];
}

bool Classes::isA(std::string_view name, std::string_view superclass) const
{
    while (!sameName(name, superclass)) {
        const Class* const declaration = find(name);
        if (declaration == nullptr || declaration->superclass.empty())
            return false;
        name = declaration->superclass;
    }
    return true;
}

std::vector<const Class*> Classes::subclassesOf(std::string_view name, bool deep) const
{
    const auto derives = [&](const Class& declaration) {
        if (name.empty())
            return deep || find(declaration.superclass) == nullptr;
        return deep ? !sameName(declaration.name, name) && isA(declaration.name, name)
                    : sameName(declaration.superclass, name);
    };
    std::vector<const Class*> result;
    for (const Class& declaration : classes_)
        if (derives(declaration))
            result.push_back(&declaration);
    return result;
}

Class Classes::completed(const Class& declaration) const
{
    Class result = declaration;
    for (Property& property : result.properties)
        property.origin = declaration.name;
    if (const Class* const superclass = find(declaration.superclass)) {
        const Class base = completed(*superclass);
        inherit(result.qualifiers, base.qualifiers);
        result.properties = inherited(base.properties, result.properties);
    }
    return result;
}

std::vector<const Class*> Classes::superclassesOf(const Class& declaration) const
{
    std::vector<const Class*> result;
    for (const Class* next = find(declaration.superclass); next != nullptr; next = find(next->superclass))
        result.push_back(next);
    return result;
}

const Property* Classes::findDeclared(const Class& declaration, std::string_view name) const
{
    const Property* const own = findProperty(declaration, name);
    return own != nullptr ? own : findInherited(declaration, name);
}

const Property* Classes::findInherited(const Class& declaration, std::string_view name) const
{
    for (const Class* const superclass : superclassesOf(declaration))
        if (const Property* const property = findProperty(*superclass, name))
            return property;
    return nullptr;
}

} // namespace cimhost::schema
