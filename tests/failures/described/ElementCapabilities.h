/// \file
/// The operations of TAVRO_GlimmarkElementCapabilities, for the function tables.
#ifndef TESTS_FAILURES_DESCRIBED_ELEMENTCAPABILITIES_H
#define TESTS_FAILURES_DESCRIBED_ELEMENTCAPABILITIES_H

#include "Services.h"

namespace described {

/// EnumInstanceNames
Status elementNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref);

/// EnumInstances
Status elements(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**);

/// GetInstance
Status oneElement(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop, const char**);

/// Associators
Status elementAssociators(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                          const char* assocClass, const char*, const char*, const char*, const char**);

/// AssociatorNames
Status elementAssociatorNames(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                              const char* assocClass, const char*, const char*, const char*);

/// References
Status elementReferences(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                         const char*, const char*, const char**);

/// ReferenceNames
Status elementReferenceNames(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                             const char*, const char*);

} // namespace described

#endif
