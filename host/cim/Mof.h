/// \file
/// Instances and paths in MOF, the text format of CIM's schemas.
#ifndef CIMHOST_CIM_MOF_H
#define CIMHOST_CIM_MOF_H

#include "cim/Model.h"

namespace cimhost::cim {

/// `instance of CLASS { ... };` over several lines, after a comment with the instance's path.
std::string mof(const Instance& instance);

/// The object that the path names, as an instance that has its keys only.
std::string mof(const ObjectPath& path);

} // namespace cimhost::cim

#endif
