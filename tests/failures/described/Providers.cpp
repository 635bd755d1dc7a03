#include "Providers.h"

#include "Capabilities.h"
#include "ElementCapabilities.h"
#include "Glimmarks.h"
#include "Services.h"
#include "SystemDevices.h"

namespace described {

namespace {

template <auto Names, auto All, auto One>
CMPIInstanceMI* instanceProvider(const CMPIBroker* of, const CMPIContext*, Status*)
{
    static CMPIInstanceMIFT table{200, 200,     "described", nullptr, Names,  All,
                                  One, nullptr, nullptr,     nullptr, nullptr};
    static CMPIInstanceMI mi{nullptr, &table};
    setBroker(of);
    return &mi;
}

template <auto Associators, auto AssociatorNames, auto References, auto ReferenceNames>
CMPIAssociationMI* associationProvider(const CMPIBroker* of, const CMPIContext*, Status*)
{
    static CMPIAssociationMIFT table{
        200, 200, "described", nullptr, Associators, AssociatorNames, References, ReferenceNames};
    static CMPIAssociationMI mi{nullptr, &table};
    setBroker(of);
    return &mi;
}

} // namespace

EntryPoints entryPoints()
{
    return {&instanceProvider<&glimmarkNames, &glimmarks, &oneGlimmark>,
            &instanceProvider<&capabilitiesNames, &capabilities, &oneCapabilities>,
            &instanceProvider<&elementNames, &elements, &oneElement>,
            &associationProvider<&elementAssociators, &elementAssociatorNames, &elementReferences,
                                 &elementReferenceNames>,
            &instanceProvider<&systemDeviceNames, &systemDevices, &oneSystemDevice>,
            &associationProvider<&systemDeviceAssociators, &systemDeviceAssociatorNames,
                                 &systemDeviceReferences, &systemDeviceReferenceNames>};
}

} // namespace described
