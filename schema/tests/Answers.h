/// \file
/// Whether what a provider answers is what its class declares.
#ifndef SCHEMA_ANSWERS_H
#define SCHEMA_ANSWERS_H

#include "schema/Classes.h"

#include "cim/Model.h"

#include <set>
#include <string>
#include <vector>

namespace cimhost::schema {

/// How a path departs from the class, one line each; empty: not at all. Its keys are those declared, each of
/// the declared type; a reference is to the declared class or one that derives from it, and has that class'
/// keys.
std::vector<std::string> departures(const cimhost::cim::ObjectPath& path, const Class& declaration,
                                    const Classes& classes);

/// The same for an instance, whose path and properties both are looked at. Its properties are those declared,
/// each of the declared type and with a value; numbers are in the ValueMap where there is one.
std::vector<std::string> departures(const cimhost::cim::Instance& instance, const Class& declaration,
                                    const Classes& classes);

/// The numbers of ValueMaps that no instance has, one line for each property and number.
std::vector<std::string> unusedValues(const cimhost::cim::Instances& instances, const Class& declaration);

} // namespace cimhost::schema

#endif
