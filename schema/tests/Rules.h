/// \file
/// What the compilers of real brokers and the clients ask of a class that extends the DMTF schema.
#ifndef SCHEMA_RULES_H
#define SCHEMA_RULES_H

#include "schema/Classes.h"

#include <string>
#include <vector>

namespace cimhost::schema {

/// What is wrong with a class, one line each, with the place; empty: nothing.
/// - The superclass is known; a class is an association if and only if its superclass is.
/// - Qualifiers are those that the DMTF schema declares, where and with the kind of value that it says;
///   Association comes first. Classes carry Version (numbers M.N.U) and Description, properties Description.
/// - Every property overrides one of a superclass, of the same type; a reference one to the same class or to
///   a superclass of it. Override names the property itself.
/// - Every key of the superclasses is declared again, and there is no other.
/// - ValueMap and Values come together, in equal number; the mapped numbers differ and fit a uint16.
std::vector<std::string> breaches(const Class& declaration, const Classes& classes);

} // namespace cimhost::schema

#endif
