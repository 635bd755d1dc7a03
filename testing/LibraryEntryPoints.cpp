// Apart from the operations: a program that loads the library as a broker does is not linked with it.

#include "testing/Operations.h"

#include "EntryPoints.h"

EntryPoints libraryEntryPoints()
{
    return {&GlimmarkProfileProvider_Create_InstanceMI,
            &GlimmarkCapabilitiesProvider_Create_InstanceMI,
            &GlimmarkElementCapabilitiesProvider_Create_InstanceMI,
            &GlimmarkElementCapabilitiesProvider_Create_AssociationMI,
            &GlimmarkSystemDeviceProvider_Create_InstanceMI,
            &GlimmarkSystemDeviceProvider_Create_AssociationMI};
}
