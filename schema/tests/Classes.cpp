#include "Classes.h"

#include "cim/Values.h"

#include <algorithm>
#include <utility>

namespace schema {

using cimhost::cim::sameName;

namespace {

template <class Named>
const Named* findNamed(const std::vector<Named>& list, std::string_view name)
{
    const auto found =
        std::find_if(list.begin(), list.end(), [&](const Named& item) { return sameName(item.name, name); });
    return found != list.end() ? &*found : nullptr;
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
    for (const Class& declaration : classes_) {
        if (find(declaration.name) != &declaration)
            throw MofError("there are two classes " + declaration.name);
        // A circle of superclasses would be walked for ever; no chain is longer than there are classes.
        const Class* ancestor = &declaration;
        for (std::size_t steps = 0; ancestor != nullptr; ++steps) {
            if (steps > classes_.size())
                throw MofError("the class " + declaration.name + " derives from itself");
            ancestor = find(ancestor->superclass);
        }
    }
}

const Class* Classes::find(std::string_view name) const
{
    return findNamed(classes_, name);
}

bool Classes::isA(std::string_view name, std::string_view superclass) const
{
    if (sameName(name, superclass))
        return true;
    const Class* const declaration = find(name);
    return declaration != nullptr && !declaration->superclass.empty() &&
           isA(declaration->superclass, superclass);
}

std::vector<const Class*> Classes::superclassesOf(const Class& declaration) const
{
    std::vector<const Class*> result;
    for (const Class* next = find(declaration.superclass); next != nullptr; next = find(next->superclass))
        result.push_back(next);
    return result;
}

const Property* Classes::findInherited(const Class& declaration, std::string_view name) const
{
    for (const Class* const superclass : superclassesOf(declaration))
        if (const Property* const property = findProperty(*superclass, name))
            return property;
    return nullptr;
}

} // namespace schema
