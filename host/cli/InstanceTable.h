/// \file
/// Answers as tables, for people: values without quotes, numbers of well-known properties in words.
#ifndef CIMHOST_CLI_INSTANCETABLE_H
#define CIMHOST_CLI_INSTANCETABLE_H

#include "cim/Model.h"
#include "cli/FittedTable.h"

#include <string>
#include <string_view>
#include <vector>

namespace cimhost::cli {

/// One row for each path, one column for each key; the class in front where there are several.
/// \param width  of the terminal; no line is wider
std::string nameTable(const cim::ObjectPaths& paths, std::size_t width = anyWidth);

/// One row for each instance. Where properties are named: the keys that tell the instances apart and those
/// properties. For what has a health, an operational status and an alarm state: the name, these, and the
/// keys. For anything else a block for each instance, as instanceBlocks(). "No instances." for none.
/// \param width  of the terminal; no row is wider: keys are shortened or left out first, then lists
std::string instanceTable(const cim::Instances& instances, const cim::PropertyList& properties,
                          std::size_t width = anyWidth);

/// One row for each instance, whatever its class: as instanceTable() where it has such a row for them, for
/// anything else with all properties whose numbers have words.
std::string stateTable(const cim::Instances& instances, std::size_t width = anyWidth);

/// What tells the instance from others of its class: the values of such keys.
std::string shortName(const cim::ObjectPath& path);

/// The value of a property, as in a table: numbers of well-known properties in words, nothing for a null.
std::string valueText(std::string_view property, const cim::Value& value);

/// The path, and under it one line for each property.
std::string instanceBlocks(const cim::Instances& instances);

} // namespace cimhost::cli

#endif
