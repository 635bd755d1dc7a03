/// \file
/// Answers as tables, for people: values without quotes, numbers of well-known properties in words.
#ifndef CIMHOST_CLI_INSTANCETABLE_H
#define CIMHOST_CLI_INSTANCETABLE_H

#include "cim/Model.h"

#include <string>
#include <string_view>
#include <vector>

namespace cimhost::cli {

/// One row for each path, one column for each key; the class in front where there are several.
std::string nameTable(const std::vector<cim::ObjectPath>& paths);

/// One row for each instance: where properties are named, the keys that tell the instances apart and
/// those properties; for devices that all have a health and an alarm state, these; for anything else
/// a block for each instance, as instanceBlocks().
std::string instanceTable(const std::vector<cim::Instance>& instances, const cim::PropertyList& properties);

/// One row for each instance, whatever its class: as instanceTable() for alarm devices, for anything else the
/// keys that tell the instances apart and the properties whose numbers have words. "No instances." for none.
std::string stateTable(const std::vector<cim::Instance>& instances);

/// What tells the instance from others of its class: the values of such keys.
std::string shortName(const cim::ObjectPath& path);

/// The value of a property, as in a table: numbers of well-known properties in words, nothing for a null.
std::string valueText(std::string_view property, const cim::Value& value);

/// The path, and under it one line for each property.
std::string instanceBlocks(const std::vector<cim::Instance>& instances);

} // namespace cimhost::cli

#endif
