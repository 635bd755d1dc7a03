/// \file
/// Class declarations as a whole: who derives from whom, what a class inherits.
#ifndef CIMHOST_SCHEMA_CLASSES_H
#define CIMHOST_SCHEMA_CLASSES_H

#include "schema/MofReader.h"

#include <cstddef>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace cimhost::schema {

/// Null where there is none of that name, ignoring letter case.
const Qualifier* findQualifier(const std::vector<Qualifier>& qualifiers, std::string_view name);
const Property* findProperty(const Class& declaration, std::string_view name);

/// Whether it is for the class or property alone that has it: DMTF DSP0004 declares it so.
bool isRestricted(const Qualifier& qualifier);
bool isKey(const Property& property);
bool isAssociation(const Class& declaration);

/// The type as MOF writes it: "uint16", "uint16[]", "CIM_System REF".
std::string typeText(const Property& property);

/// Classes that know each other by name.
class Classes
{
public:
    Classes() = default;
    /// \throws MofError  where two classes have one name, or a class derives from itself or from more than
    /// 64 others
    explicit Classes(std::vector<Class> classes);

    /// Null where there is none of that name.
    [[nodiscard]] const Class* find(std::string_view name) const;

    /// Whether both names mean the same class, or `superclass` is among the superclasses of `name`.
    [[nodiscard]] bool isA(std::string_view name, std::string_view superclass) const;

    /// The superclasses that are known, nearest first.
    [[nodiscard]] std::vector<const Class*> superclassesOf(const Class& declaration) const;

    /// Those that derive from a class, in the order of the declarations: directly, or at all. With an empty
    /// name the classes whose superclass is not known, or all.
    [[nodiscard]] std::vector<const Class*> subclassesOf(std::string_view name, bool deep) const;

    /// A class with what it inherits: properties, those of superclasses first, and qualifiers, but those that
    /// say something of one class alone, such as Version.
    [[nodiscard]] Class completed(const Class& declaration) const;

    /// The class that declared a property first that a class has; empty: it has none of that name.
    [[nodiscard]] std::string_view originOf(std::string_view className, std::string_view property) const;

    /// The names of the keys of a class, its own and inherited; none of a class that is not known.
    [[nodiscard]] const std::vector<std::string>& keysOf(std::string_view name) const;

    /// The declaration that holds for a property of a class: its own or the nearest superclass'; null: none.
    [[nodiscard]] const Property* findDeclared(const Class& declaration, std::string_view name) const;

    /// What a property overrides: the nearest superclass' property of that name; null: none.
    [[nodiscard]] const Property* findInherited(const Class& declaration, std::string_view name) const;

private:
    std::vector<Class> classes_;
    std::map<std::string, std::size_t> places_;  ///< by the name in lower case
    std::vector<std::vector<std::string>> keys_; ///< of each class
};

} // namespace cimhost::schema

#endif
