// The provider of TAVRO_Glimmark.

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

const std::string loggerGlimmarkProvider("Mavrel.GlimmarkProvider");

static BrokerPointer broker{nullptr};

namespace {

const TraceModule traceModule{"GlimmarkProvider.cpp", loggerGlimmarkProvider};

} // namespace

CMPIStatus Glimmark_EnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                      const CMPIObjectPath* ref)
{
    const FunctionTrace flow(traceModule, "Glimmark_EnumInstanceNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, false);
    std::vector<CMPIObjectPath*> paths;
    reserveFor(factory, paths);
    // Deliberate: neither returnDone nor an EXITING line, here as in every early return below; brokers go by
    // the status.
    // Test: GlimmarkProviderTest.NamesOfAnEmptyInventoryEndWithoutDoneAndExit.
    if (factory.getAllGlimmarkCMPIObjPaths(broker, ref, paths, &status) != 0)
        return status;
    for (const CMPIObjectPath* path : Counted(paths))
        returnObjectPathOf(rslt, path, ref, &status);

    Cmpi::returnDone(rslt);
    flow.exiting();
    return status;
}

CMPIStatus Glimmark_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                  const CMPIObjectPath* ref, const char** properties)
{
    const FunctionTrace flow(traceModule, "Glimmark_EnumInstances", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " properties=", properties);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, false);
    std::vector<CMPIInstance*> instances;
    reserveFor(factory, instances);
    if (factory.getAllGlimmarkCMPIInstances(broker, ref, properties, false, instances, &status) != 0)
        return status;
    returnInstances(rslt, instances);

    Cmpi::returnDone(rslt);
    flow.exiting();
    return status;
}

namespace {

/// Returns the instance with the DeviceID asked for. \return the factory's result
int returnByDeviceID(const CMPIResult* rslt, const CMPIObjectPath* cop, CMPIString* deviceID,
                     const char** properties, CMPIStatus& status)
{
    const GlimmarkFactory factory(true, false);
    std::vector<CMPIInstance*> instances;
    reserveFor(factory, instances);
    const int result =
        factory.getOneGlimmarkCMPIInstance(broker, cop, deviceID, properties, instances, &status);
    if (result == 0)
        returnInstances(rslt, instances);
    return result;
}

/// Returns the first instance whose whole path is the one asked for. \return the factory's result
int returnByPath(const CMPIResult* rslt, const CMPIObjectPath* cop, const char** properties,
                 CMPIStatus& status)
{
    const GlimmarkFactory factory(true, false);
    std::vector<CMPIInstance*> instances;
    reserveFor(factory, instances);
    const int result =
        factory.getAllGlimmarkCMPIInstances(broker, cop, properties, false, instances, &status);
    if (result == 0)
        returnFirstAt(rslt, instances, cop, false, status);
    return result;
}

} // namespace

CMPIStatus Glimmark_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt,
                                const CMPIObjectPath* cop, const char** properties)
{
    const FunctionTrace flow(traceModule, "Glimmark_GetInstance", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " cop=", cop,
                             " properties=", properties);
    });
    CMPIStatus status = okStatus();

    if (requireKeys(broker, GlimmarkProfileProvider, cop, status)) {
        CMPIString* const deviceID = Cmpi::stringKeyOf(cop, "DeviceID", &status);
        const int result = deviceID != nullptr ? returnByDeviceID(rslt, cop, deviceID, properties, status)
                                               : returnByPath(rslt, cop, properties, status);
        if (result != 0)
            return status;
    }

    Cmpi::returnDone(rslt);
    flow.exiting();
    return status;
}

GLIMMARK_FIXED_INSTANCE_OPERATIONS(Glimmark)

static FunctionTable<CMPIInstanceMI> instMIFT__ = {
    interfaceVersion,
    interfaceVersion,
    miName("instanceGlimmarkProfileProvider"),
    Entry(Glimmark_Cleanup),
    Entry(Glimmark_EnumInstanceNames),
    Entry(Glimmark_EnumInstances),
    Entry(Glimmark_GetInstance),
    Entry(Glimmark_CreateInstance),
    Entry(Glimmark_ModifyInstance),
    Entry(Glimmark_DeleteInstance),
    Entry(Glimmark_ExecQuery),
};

} // namespace Tavro::GlimmarkProvider

CMPIInstanceMI* GlimmarkProfileProvider_Create_InstanceMI(const CMPIBroker* broker,
                                                          const CMPIContext* /*ctx*/, CMPIStatus* /*rc*/)
{
    static CMPIInstanceMI mi = {nullptr, &Tavro::GlimmarkProvider::instMIFT__};
    Tavro::GlimmarkProvider::broker = broker;
    return &mi;
}
