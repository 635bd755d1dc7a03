/// \file
/// The instance operations of TAVRO_GlimmarkCapabilities, for the function table.
#ifndef TESTS_FAILURES_DESCRIBED_CAPABILITIES_H
#define TESTS_FAILURES_DESCRIBED_CAPABILITIES_H

#include "Services.h"

namespace described {

/// EnumInstanceNames
Status capabilitiesNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref);

/// EnumInstances
Status capabilities(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**);

/// GetInstance
Status oneCapabilities(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop,
                       const char**);

} // namespace described

#endif
