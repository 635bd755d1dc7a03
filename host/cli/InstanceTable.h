/// \file
/// Answers as tables, for people: values without quotes, numbers of well-known properties in words.
#ifndef CIMHOST_CLI_INSTANCETABLE_H
#define CIMHOST_CLI_INSTANCETABLE_H

#include "cim/Model.h"

#include <string>
#include <vector>

namespace cimhost::cli {

/// One row for each path, one column for each key; the class in front where there are several.
std::string nameTable(const std::vector<cim::ObjectPath>& paths);

/// One row for each instance: where properties are named, the keys that tell the instances apart and
/// those properties; for devices that all have a health and an alarm state, these; for anything else
/// a block for each instance, as instanceBlocks().
std::string instanceTable(const std::vector<cim::Instance>& instances, const cim::PropertyList& properties);

/// The path, and under it one line for each property.
std::string instanceBlocks(const std::vector<cim::Instance>& instances);

} // namespace cimhost::cli

#endif
