/// \file
/// The status codes of the CMPI interface by their names.
#ifndef CIMHOST_CIM_STATUSCODE_H
#define CIMHOST_CIM_STATUSCODE_H

#include <cmpidt.h>

#include <string>

namespace cimhost::cim {

/// Such as "CMPI_RC_ERR_NOT_FOUND"; "unknown status code" for a number that the interface does not have.
std::string statusName(CMPIrc code);

} // namespace cimhost::cim

#endif
