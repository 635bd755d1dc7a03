/// \file
/// The instance operations of TAVRO_Glimmark, for the function table.
#ifndef TESTS_FAILURES_DESCRIBED_GLIMMARKS_H
#define TESTS_FAILURES_DESCRIBED_GLIMMARKS_H

#include "Services.h"

namespace described {

/// EnumInstanceNames
Status glimmarkNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref);

/// EnumInstances
Status glimmarks(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**);

/// GetInstance
Status oneGlimmark(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop, const char**);

} // namespace described

#endif
