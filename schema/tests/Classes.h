/// \file
/// Class declarations as a whole: who derives from whom, what a class inherits.
#ifndef SCHEMA_CLASSES_H
#define SCHEMA_CLASSES_H

#include "MofReader.h"

#include <string>
#include <string_view>
#include <vector>

namespace schema {

/// Null where there is none of that name, ignoring letter case.
const Qualifier* findQualifier(const std::vector<Qualifier>& qualifiers, std::string_view name);
const Property* findProperty(const Class& declaration, std::string_view name);

bool isKey(const Property& property);
bool isAssociation(const Class& declaration);

/// The type as MOF writes it: "uint16", "uint16[]", "CIM_System REF".
std::string typeText(const Property& property);

/// Classes that know each other by name.
class Classes
{
public:
    /// \throws MofError  where two classes have one name or a class derives from itself
    explicit Classes(std::vector<Class> classes);

    /// Null where there is none of that name.
    [[nodiscard]] const Class* find(std::string_view name) const;

    /// Whether both names mean the same class, or `superclass` is among the superclasses of `name`.
    [[nodiscard]] bool isA(std::string_view name, std::string_view superclass) const;

    /// The superclasses that are known, nearest first.
    [[nodiscard]] std::vector<const Class*> superclassesOf(const Class& declaration) const;

    /// What a property overrides: the nearest superclass' property of that name; null: none.
    [[nodiscard]] const Property* findInherited(const Class& declaration, std::string_view name) const;

private:
    std::vector<Class> classes_;
};

} // namespace schema

#endif
