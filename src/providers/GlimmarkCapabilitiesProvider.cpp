// The provider of TAVRO_GlimmarkCapabilities.

#include "BrokerPointer.h"
#include "Cmpi.h"
#include "Counted.h"
#include "EntryPoints.h"
#include "FixedOperations.h"
#include "FunctionTables.h"
#include "GlimmarkFactory.h"
#include "Names.h"
#include "RequestChecks.h"
#include "ResultLists.h"
#include "Trace.h"

#include <string>
#include <vector>

namespace Tavro::GlimmarkProvider {

const std::string loggerGlimmarkCapabilitiesProvider("Mavrel.GlimmarkCapabilitiesProvider");

static BrokerPointer broker{nullptr};

namespace {

const TraceModule traceModule{"GlimmarkCapabilitiesProvider.cpp", loggerGlimmarkCapabilitiesProvider};

} // namespace

CMPIStatus GlimmarkCapabilities_EnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                                  const CMPIResult* rslt, const CMPIObjectPath* ref)
{
    const FunctionTrace flow(traceModule, "GlimmarkCapabilities_EnumInstanceNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(false, true);
    std::vector<CMPIObjectPath*> paths;
    reserveFor(factory, paths);
    // Deliberate: neither returnDone nor an EXITING line, here as in every early return below; brokers go by
    // the status.
    // Test: GlimmarkCapabilitiesProviderTest.NamesWithoutAPathEndWithoutDoneAndExit.
    if (factory.getAllGlimmarkCapabilitiesCMPIObjPaths(broker, ref, paths, &status) != 0)
        return status;
    for (const CMPIObjectPath* path : Counted(paths)) {
        if (Cmpi::exists(path))
            returnObjectPathOf(rslt, path, ref, &status);
    }

    Cmpi::returnDone(rslt);
    flow.exiting();
    return status;
}

CMPIStatus GlimmarkCapabilities_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                              const CMPIResult* rslt, const CMPIObjectPath* ref,
                                              const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkCapabilities_EnumInstances", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " properties=", properties);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(false, true);
    std::vector<CMPIInstance*> instances;
    reserveFor(factory, instances);
    if (factory.getAllGlimmarkCapabilitiesCMPIInstances(broker, ref, properties, false, instances, &status) !=
        0)
        return status;
    returnInstances(rslt, instances);

    Cmpi::returnDone(rslt);
    flow.exiting();
    return status;
}

namespace {

/// Returns the instance with the InstanceID asked for. \return the factory's result
int returnByInstanceID(const CMPIResult* rslt, const CMPIObjectPath* cop, CMPIString* instanceID,
                       const char** properties, CMPIStatus& status)
{
    const GlimmarkFactory factory(false, true);
    std::vector<CMPIInstance*> instances;
    reserveFor(factory, instances);
    const int result = factory.getOneGlimmarkCapabilitiesCMPIInstance(broker, cop, instanceID, properties,
                                                                      instances, &status);
    if (result == 0)
        returnInstances(rslt, instances);
    return result;
}

/// Returns every instance whose whole path is the one asked for. \return the factory's result
int returnByPath(const CMPIResult* rslt, const CMPIObjectPath* cop, const char** properties,
                 CMPIStatus& status)
{
    // Deliberate: collected are the alarm devices and not the capabilities, so that this way finds nothing; a
    // client without the InstanceID is told "not found" by its broker.
    // Test: GlimmarkCapabilitiesProviderTest.GetFindsNothingEvenAtTheCapabilitiesOwnPath.
    const GlimmarkFactory factory(true, false);
    std::vector<CMPIInstance*> instances;
    reserveFor(factory, instances);
    const int result =
        factory.getAllGlimmarkCapabilitiesCMPIInstances(broker, cop, properties, false, instances, &status);
    if (result == 0) {
        // Deliberate: unlike the alarm device provider's, the walk goes on after a match; a client gets them
        // all.
        // Test: CapabilitiesOfAnotherFactory.AreReturnedForEachMatchOfTheWholePath.
        for (const CMPIInstance* instance : Counted(instances)) {
            if (isAt(instance, cop, false, status))
                Cmpi::returnInstance(rslt, instance);
        }
    }
    return result;
}

} // namespace

CMPIStatus GlimmarkCapabilities_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                            const CMPIResult* rslt, const CMPIObjectPath* cop,
                                            const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkCapabilities_GetInstance", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " cop=", cop,
                             " properties=", properties);
    });
    CMPIStatus status = okStatus();

    if (requireKeys(broker, GlimmarkCapabilitiesProvider, cop, status)) {
        CMPIString* const instanceID = Cmpi::stringKeyOf(cop, "InstanceID", &status);
        const int result = instanceID != nullptr
                               ? returnByInstanceID(rslt, cop, instanceID, properties, status)
                               : returnByPath(rslt, cop, properties, status);
        if (result != 0)
            return status;
    }

    Cmpi::returnDone(rslt);
    flow.exiting();
    return status;
}

GLIMMARK_FIXED_INSTANCE_OPERATIONS(GlimmarkCapabilities)

static FunctionTable<CMPIInstanceMI> instMIFT__ = {
    interfaceVersion,
    interfaceVersion,
    miName("instanceGlimmarkCapabilitiesProvider"),
    Entry(GlimmarkCapabilities_Cleanup),
    Entry(GlimmarkCapabilities_EnumInstanceNames),
    Entry(GlimmarkCapabilities_EnumInstances),
    Entry(GlimmarkCapabilities_GetInstance),
    Entry(GlimmarkCapabilities_CreateInstance),
    Entry(GlimmarkCapabilities_ModifyInstance),
    Entry(GlimmarkCapabilities_DeleteInstance),
    Entry(GlimmarkCapabilities_ExecQuery),
};

} // namespace Tavro::GlimmarkProvider

CMPIInstanceMI* GlimmarkCapabilitiesProvider_Create_InstanceMI(const CMPIBroker* broker,
                                                               const CMPIContext* /*ctx*/, CMPIStatus* /*rc*/)
{
    static CMPIInstanceMI mi = {nullptr, &Tavro::GlimmarkProvider::instMIFT__};
    Tavro::GlimmarkProvider::broker = broker;
    return &mi;
}
