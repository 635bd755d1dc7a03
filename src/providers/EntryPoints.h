/// \file
/// What a broker finds by name in the library: the factory functions of its providers. Registered as
/// provider NAME, a provider is asked for with NAME_Create_InstanceMI and NAME_Create_AssociationMI.
///
/// All of them: remember `broker`, which may be null and replaces the one of an earlier call, and return
/// a record with static storage. They never fail, and leave `ctx` and `rc` alone.
#ifndef TAVRO_GLIMMARK_ENTRYPOINTS_H
#define TAVRO_GLIMMARK_ENTRYPOINTS_H

#include <cmpidt.h>
#include <cmpift.h>

extern "C" {

/// Instances of TAVRO_Glimmark.
CMPIInstanceMI* GlimmarkProfileProvider_Create_InstanceMI(const CMPIBroker* broker, const CMPIContext* ctx,
                                                          CMPIStatus* rc);

/// Instances of TAVRO_GlimmarkCapabilities.
CMPIInstanceMI* GlimmarkCapabilitiesProvider_Create_InstanceMI(const CMPIBroker* broker,
                                                               const CMPIContext* ctx, CMPIStatus* rc);

/// Instances of the association TAVRO_GlimmarkElementCapabilities.
CMPIInstanceMI* GlimmarkElementCapabilitiesProvider_Create_InstanceMI(const CMPIBroker* broker,
                                                                      const CMPIContext* ctx, CMPIStatus* rc);

/// Traversal of the association TAVRO_GlimmarkElementCapabilities.
CMPIAssociationMI* GlimmarkElementCapabilitiesProvider_Create_AssociationMI(const CMPIBroker* broker,
                                                                            const CMPIContext* ctx,
                                                                            CMPIStatus* rc);

/// Instances of the association TAVRO_GlimmarkSystemDevice.
CMPIInstanceMI* GlimmarkSystemDeviceProvider_Create_InstanceMI(const CMPIBroker* broker,
                                                               const CMPIContext* ctx, CMPIStatus* rc);

/// Traversal of the association TAVRO_GlimmarkSystemDevice.
CMPIAssociationMI* GlimmarkSystemDeviceProvider_Create_AssociationMI(const CMPIBroker* broker,
                                                                     const CMPIContext* ctx, CMPIStatus* rc);
}

#endif
