/// \file
/// The operations of TAVRO_GlimmarkSystemDevice, for the function tables.
#ifndef TESTS_FAILURES_DESCRIBED_SYSTEMDEVICES_H
#define TESTS_FAILURES_DESCRIBED_SYSTEMDEVICES_H

#include "Services.h"

namespace described {

/// EnumInstanceNames
Status systemDeviceNames(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* ref);

/// EnumInstances
Status systemDevices(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* ref,
                     const char**);

/// GetInstance
Status oneSystemDevice(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* cop,
                       const char**);

/// Associators
Status systemDeviceAssociators(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                               const Path* ref, const char* assocClass, const char*, const char*, const char*,
                               const char**);

/// AssociatorNames
Status systemDeviceAssociatorNames(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                                   const Path* ref, const char* assocClass, const char*, const char*,
                                   const char*);

/// References
Status systemDeviceReferences(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                              const Path* ref, const char*, const char*, const char**);

/// ReferenceNames
Status systemDeviceReferenceNames(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                                  const Path* ref, const char*, const char*);

} // namespace described

#endif
