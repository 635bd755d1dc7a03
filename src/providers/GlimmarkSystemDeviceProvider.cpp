// The provider of the association TAVRO_GlimmarkSystemDevice, between each computer system of the broker and
// each indicator: its instances and its traversal.

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

#include <strings.h>

#include <cstring>
#include <string>
#include <vector>

namespace Tavro::GlimmarkProvider {

const std::string loggerGlimmarkSystemDeviceProvider("Mavrel.GlimmarkSystemDeviceProvider");

static BrokerPointer broker{nullptr};

namespace {

const TraceModule traceModule{"GlimmarkSystemDeviceProvider.cpp", loggerGlimmarkSystemDeviceProvider};

/// Reports a failure of an operation of this module.
void fail(CMPIStatus& status, const char* message, const char* traceText)
{
    Cmpi::reportFailure(broker, GlimmarkSystemDeviceProvider, &status, message, traceText);
}

/// Whether the broker's enumeration of the computer systems failed. If so, says it in the function's trace.
bool enumerationFailed(const TracedFunction& flow, const CMPIStatus& status,
                       unsigned int line = __builtin_LINE())
{
    if (status.rc == CMPI_RC_OK)
        return false;
    flow.error("Call to CBEnumInstances of target Class Failed.", line);
    return true;
}

/// The path by which the broker is asked for the computer systems: no keys, no host.
CMPIObjectPath* newComputerSystemClassPath(const CMPIObjectPath* ref, CMPIStatus* rc)
{
    return Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, rc), ComputerSystemClass, rc);
}

/// The path of an association in the request's terms; null, or without a handle, when the broker could not
/// make it.
CMPIObjectPath* newAssociationPath(const CMPIObjectPath* ref, CMPIStatus* rc)
{
    return Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, rc), GlimmarkSystemDeviceClass, rc);
}

/// \param path  null: there is none, and no instance of it
/// \return null when the instance could not be made
CMPIInstance* newAssociation(const CMPIObjectPath* path, const CMPIObjectPath* system,
                             const CMPIObjectPath* device, const char** properties)
{
    CMPIInstance* const instance = path != nullptr ? Cmpi::newInstance(broker, path, nullptr) : nullptr;
    if (Cmpi::exists(instance)) {
        const char* keys[] = {"GroupComponent", "PartComponent", nullptr};
        Cmpi::setPropertyFilter(instance, properties, keys);
        Cmpi::setProperty(instance, "GroupComponent", system);
        Cmpi::setProperty(instance, "PartComponent", device);
    }
    return instance;
}

} // namespace

/// Appends the association of each of the broker's computer systems with each indicator, in this order; a
/// null pointer for each one that could not be made. Its failures are known to the traces alone.
/// \return 0, or 1 when the walk had to end early
int glimmarkSystemDeviceCMPIInstances(const CMPIObjectPath* ref, const char** properties,
                                      const CMPIContext* ctx, std::vector<CMPIInstance*>& instances)
{
    const FunctionTrace flow(traceModule, "glimmarkSystemDeviceCMPIInstances", [&] {
        return parameterList(" ref=", ref, " properties=", properties, " ctx=", ctx,
                             " instances=", &instances);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, false);
    const CMPIObjectPath* const systemClass = newComputerSystemClassPath(ref, &status);
    if (!Cmpi::exists(systemClass)) {
        fail(status, "Create CMPIObjectPath            failed.",
             "Create CMPIObjectPath failed for             ComputerSystemClass.");
        return 1;
    }
    const CMPIEnumeration* const systems = Cmpi::enumerateInstanceNames(broker, ctx, systemClass, &status);
    if (enumerationFailed(flow, status))
        return 1;
    while (Cmpi::hasNext(systems)) {
        const CMPIObjectPath* const system = Cmpi::nextPath(systems);
        if (system == nullptr)
            continue;
        std::vector<CMPIObjectPath*> devices;
        reserveFor(factory, devices);
        if (factory.getAllGlimmarkCMPIObjPaths(broker, ref, devices, &status) != 0)
            return 1;
        for (const CMPIObjectPath* device : Counted(devices)) {
            if (!Cmpi::exists(device)) {
                fail(status, "CMPIObjectPath is NULL for Glimmark Provider",
                     "CMPIObjectPath is NULL for Glimmark Provider");
                return 1;
            }
            setNameSpaceOf(device, ref, &status);
            const CMPIObjectPath* const path = newAssociationPath(ref, &status);
            // Deliberate: the texts name a class that is not this one, and the failure ends nothing; log
            // filters match them.
            // Test: SystemDeviceInstances.AnAssociationPathThatCannotBeMadeIsReportedAndLeavesANullInstance.
            if (!Cmpi::exists(path))
                fail(status, "Create CMPIObjectPath failed for HostedAccessPoint",
                     "Create CMPIObjectPath failed for                     HostedAccessPoint.");
            setOrigin(path, ref, &status);
            instances.push_back(newAssociation(path, system, device, properties));
        }
    }
    flow.exiting();
    return 0;
}

CMPIStatus GlimmarkSystemDevice_EnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                                  const CMPIResult* rslt, const CMPIObjectPath* ref)
{
    const FunctionTrace flow(traceModule, "GlimmarkSystemDevice_EnumInstanceNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref);
    });
    CMPIStatus status = okStatus();

    // The builder's walk with texts of its own.
    // Deliberate: every early return goes without an EXITING line and returnDone; brokers go by the status.
    // Test: SystemDeviceInstances.NamesWithoutDevicesEndAtTheFirstSystemWithoutDoneAndExit.
    const GlimmarkFactory factory(true, false);
    const CMPIObjectPath* const systemClass = newComputerSystemClassPath(ref, &status);
    if (!Cmpi::exists(systemClass)) {
        fail(status, "Create CMPIObjectPath failed.",
             "Create CMPIObjectPath failed for ComputerSystemClass.");
        return status;
    }
    const CMPIEnumeration* const systems = Cmpi::enumerateInstanceNames(broker, ctx, systemClass, &status);
    if (enumerationFailed(flow, status))
        return status;
    // Deliberate: one list for all computer systems, not emptied in between, and walked from its start for
    // each. The second of two systems is so paired with each indicator twice; clients with two systems count
    // on the order.
    // Test: Pairings.NamesPairEachSystemWithTheDevicesOfAllSystemsSoFar.
    std::vector<CMPIObjectPath*> devices;
    reserveFor(factory, devices);
    while (Cmpi::hasNext(systems)) {
        const CMPIObjectPath* const system = Cmpi::nextPath(systems);
        if (system == nullptr)
            continue;
        if (factory.getAllGlimmarkCMPIObjPaths(broker, ref, devices, &status) != 0)
            return status;
        for (const CMPIObjectPath* device : Counted(devices)) {
            if (!Cmpi::exists(device)) {
                fail(status, "CMPIObjectPath is NULL for Glimmark",
                     "CMPIObjectPath is NULL for Glimmark Class");
                return status;
            }
            setNameSpaceOf(device, ref, &status);
            const CMPIObjectPath* const path = newAssociationPath(ref, &status);
            if (!Cmpi::exists(path)) {
                fail(status,
                     "Create CMPIObjectPath failed                     for GlimmarkSystemDeviceProvider.",
                     "Create CMPIObjectPath failed for                     GlimmarkSystemDeviceClass.");
                return status;
            }
            setOrigin(path, ref, &status);
            Cmpi::addKey(path, "GroupComponent", system);
            Cmpi::addKey(path, "PartComponent", device);
            Cmpi::returnObjectPath(rslt, path);
        }
    }

    flow.exiting();
    Cmpi::returnDone(rslt);
    return status;
}

CMPIStatus GlimmarkSystemDevice_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                              const CMPIResult* rslt, const CMPIObjectPath* ref,
                                              const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkSystemDevice_EnumInstances", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " properties=", properties);
    });
    const CMPIStatus status = okStatus();

    // Deliberate: a failed build is answered as an empty, successful enumeration; clients see no error of one
    // class in an enumeration of many.
    // Test: SystemDeviceInstances.InstancesOfAFailedEnumerationAreNone.
    std::vector<CMPIInstance*> instances;
    if (glimmarkSystemDeviceCMPIInstances(ref, properties, ctx, instances) == 0)
        returnInstances(rslt, instances);

    flow.exiting();
    Cmpi::returnDone(rslt);
    return status;
}

CMPIStatus GlimmarkSystemDevice_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                            const CMPIResult* rslt, const CMPIObjectPath* cop,
                                            const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkSystemDevice_GetInstance", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " cop=", cop,
                             " properties=", properties);
    });
    CMPIStatus status = okStatus();

    if (requireKeys(broker, GlimmarkSystemDeviceProvider, cop, status)) {
        std::vector<CMPIInstance*> instances;
        if (glimmarkSystemDeviceCMPIInstances(cop, properties, ctx, instances) == 0)
            returnFirstAt(rslt, instances, cop, true, status);
    }

    // Deliberate: returnDone before the EXITING line here, after it in the two operations above; log filters
    // know the order.
    // Test: SystemDeviceInstances.GetBuildsAllInstancesAndStopsAtTheFirstMatch.
    Cmpi::returnDone(rslt);
    flow.exiting();
    return status;
}

namespace {

/// The far end of a traversal, by the class of its target path.
enum class FarEnd
{
    computerSystems, ///< the request names an alarm device
    glimmarks,       ///< the request names a computer system
    neither
};

FarEnd farEndOf(const CMPIObjectPath* target, CMPIStatus* rc)
{
    const char* const className = Cmpi::classNameOf(target, rc);
    if (className != nullptr && std::strcmp(className, ComputerSystemClass) == 0)
        return FarEnd::computerSystems;
    if (className != nullptr && std::strcmp(className, GlimmarkClass) == 0)
        return FarEnd::glimmarks;
    return FarEnd::neither;
}

/// Whether a client that asks for objects of `resultClass` gets those of the far end: it named no class, the
/// far end's own or that one's base in the CIM schema, in any letter case. A base further up does not count.
bool isWanted(FarEnd farEnd, const char* resultClass)
{
    const auto is = [&](const char* name) { return strcasecmp(resultClass, name) == 0; };
    if (resultClass == nullptr)
        return true;
    if (farEnd == FarEnd::computerSystems)
        return is(ComputerSystemClass) || is("CIM_ComputerSystem");
    if (farEnd == FarEnd::glimmarks)
        return is(GlimmarkClass) || is("CIM_AlarmDevice");
    return true;
}

/// The association of the request's path with a far end's.
/// \param far  the path of an alarm device, or the target path: a client is told the class of the computer
///     systems and not which one it is
/// \return null when the path or the instance could not be made
CMPIInstance* newReference(const CMPIObjectPath* path, FarEnd farEnd, const CMPIObjectPath* ref,
                           const CMPIObjectPath* far, CMPIStatus* rc)
{
    CMPIInstance* const instance = path != nullptr ? Cmpi::newInstance(broker, path, rc) : nullptr;
    const bool farIsDevice = farEnd == FarEnd::glimmarks;
    Cmpi::setProperty(instance, "GroupComponent", farIsDevice ? ref : far);
    Cmpi::setProperty(instance, "PartComponent", farIsDevice ? far : ref);
    return instance;
}

/// What a reference operation goes through the far end with.
struct Traversal
{
    const TracedFunction& flow;
    const GlimmarkFactory& factory;
    const CMPIContext* ctx;
    const CMPIObjectPath* ref;
    const CMPIObjectPath* target;
};

/// Makes the association instance of the request's path with each object of the far end, and hands on those
/// that could be made.
/// \return whether the walk was completed; if not, the status says why, if the broker said so
template <class HandOn>
bool forEachReference(const Traversal& traversal, std::vector<CMPIObjectPath*>& devices, CMPIStatus& status,
                      HandOn handOn)
{
    const CMPIObjectPath* const ref = traversal.ref;
    const CMPIObjectPath* const path = newAssociationPath(ref, &status);
    setOrigin(path, ref, &status);
    const FarEnd farEnd = farEndOf(traversal.target, &status);
    const auto refer = [&](const CMPIObjectPath* far) {
        if (const CMPIInstance* instance = newReference(path, farEnd, ref, far, &status))
            handOn(instance);
    };
    if (farEnd == FarEnd::glimmarks) {
        if (traversal.factory.getAllGlimmarkCMPIObjPaths(broker, ref, devices, &status) != 0)
            return false;
        for (const CMPIObjectPath* device : Counted(devices)) {
            if (device != nullptr)
                refer(device);
        }
    } else if (farEnd == FarEnd::computerSystems) {
        const CMPIEnumeration* const systems =
            Cmpi::enumerateInstanceNames(broker, traversal.ctx, traversal.target, &status);
        if (enumerationFailed(traversal.flow, status))
            return false;
        while (Cmpi::hasNext(systems)) {
            // Deliberate: the system's own path is read and not used, each reference names the class; clients
            // go by the class.
            // Test: SystemCounts.ReferencesOfADeviceNameTheSystemsClassOnceForEachSystem.
            Cmpi::nextPath(systems);
            refer(traversal.target);
        }
    }
    return true;
}

} // namespace

// The traversals.
// Deliberate: none of them calls returnDone, and an early return goes without an EXITING line; brokers go by
// the status.
// Test: AllTraversals.AreNeverDone.
// Deliberate: role and result role filter nothing; clients that
// name other roles rely on it.
// Test: ReferenceOperations.AnswerWhateverTheResultClassAndTheRole.

CMPIStatus GlimmarkSystemDevice_Associators(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                            const CMPIResult* rslt, const CMPIObjectPath* ref,
                                            const char* assocClass, const char* resultClass, const char* role,
                                            const char* resultRole, const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkSystemDevice_Associators", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " _RefLeftClass=", assocClass, " _RefRightClass=", resultClass, " role=", role,
                             " resultRole=", resultRole, " properties=", properties);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, false);
    const CMPIObjectPath* const target =
        factory.get_assoc_targetClass_ObjectPath(broker, ref, assocClass, resultClass, &status);
    // Deliberate: nothing at the far end is an empty, successful traversal, whatever the broker's calls said;
    // clients that ask every association rely on it.
    // Test: AssociatorOperations.AnswerNothingWhereNothingIsAssociated.
    if (!Cmpi::exists(target))
        return okStatus();
    const FarEnd farEnd = farEndOf(target, &status);
    if (!isWanted(farEnd, resultClass))
        return okStatus();
    if (farEnd == FarEnd::computerSystems) {
        // Deliberate: without the property list, and whatever the status; the systems' provider decides what
        // it answers.
        // Test: SystemDeviceTraversal.AssociatorsOfADeviceDoNotCheckTheStatus.
        const CMPIEnumeration* const systems =
            Cmpi::enumerateInstances(broker, ctx, target, nullptr, &status);
        while (Cmpi::hasNext(systems)) {
            if (const CMPIInstance* system = Cmpi::nextInstance(systems))
                Cmpi::returnInstance(rslt, system);
        }
    } else if (farEnd == FarEnd::glimmarks) {
        std::vector<CMPIInstance*> devices;
        reserveFor(factory, devices);
        if (factory.getAllGlimmarkCMPIInstances(broker, ref, properties, false, devices, &status) != 0)
            return status;
        for (const CMPIInstance* device : Counted(devices)) {
            if (device != nullptr)
                Cmpi::returnInstance(rslt, device);
        }
    }

    flow.exiting();
    return status;
}

CMPIStatus GlimmarkSystemDevice_AssociatorNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                                const CMPIResult* rslt, const CMPIObjectPath* ref,
                                                const char* assocClass, const char* resultClass,
                                                const char* role, const char* resultRole)
{
    const FunctionTrace flow(traceModule, "GlimmarkSystemDevice_AssociatorNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " _RefLeftClass=", assocClass, " _RefRightClass=", resultClass, " role=", role,
                             " resultRole=", resultRole);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, false);
    const CMPIObjectPath* const target =
        factory.get_assoc_targetClass_ObjectPath(broker, ref, assocClass, resultClass, &status);
    // Deliberate: nothing at the far end is an empty, successful traversal, whatever the broker's calls said;
    // clients that ask every association rely on it.
    // Test: AssociatorOperations.AnswerNothingWhereNothingIsAssociated.
    if (!Cmpi::exists(target))
        return okStatus();
    const FarEnd farEnd = farEndOf(target, &status);
    if (!isWanted(farEnd, resultClass))
        return okStatus();
    if (farEnd == FarEnd::computerSystems) {
        const CMPIEnumeration* const systems = Cmpi::enumerateInstanceNames(broker, ctx, target, &status);
        if (enumerationFailed(flow, status))
            return status;
        while (Cmpi::hasNext(systems)) {
            if (const CMPIObjectPath* system = Cmpi::nextPath(systems))
                Cmpi::returnObjectPath(rslt, system);
        }
    } else if (farEnd == FarEnd::glimmarks) {
        std::vector<CMPIObjectPath*> devices;
        reserveFor(factory, devices);
        if (factory.getAllGlimmarkCMPIObjPaths(broker, ref, devices, &status) != 0)
            return status;
        for (const CMPIObjectPath* device : Counted(devices)) {
            if (device != nullptr)
                returnObjectPathOf(rslt, device, ref, &status);
        }
    }

    flow.exiting();
    return status;
}

CMPIStatus GlimmarkSystemDevice_References(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                           const CMPIResult* rslt, const CMPIObjectPath* ref,
                                           const char* resultClass, const char* role, const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkSystemDevice_References", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " resultClass=", resultClass, " role=", role, " properties=", properties);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, false);
    std::vector<CMPIObjectPath*> devices;
    reserveFor(factory, devices);
    const CMPIObjectPath* const target =
        factory.get_assoc_targetClass_ObjectPath(broker, ref, GlimmarkSystemDeviceClass, nullptr, &status);
    if (!Cmpi::exists(target)) {
        fail(status, "Object Path is NULL in References.", "Object Path is NULL in References.");
        return status;
    }
    const Traversal traversal{flow, factory, ctx, ref, target};
    if (!forEachReference(traversal, devices, status,
                          [&](const CMPIInstance* instance) { Cmpi::returnInstance(rslt, instance); }))
        return status;

    flow.exiting();
    return status;
}

CMPIStatus GlimmarkSystemDevice_ReferenceNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                               const CMPIResult* rslt, const CMPIObjectPath* ref,
                                               const char* resultClass, const char* role)
{
    const FunctionTrace flow(traceModule, "GlimmarkSystemDevice_ReferenceNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " resultClass=", resultClass, " role=", role);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, false);
    std::vector<CMPIObjectPath*> devices;
    reserveFor(factory, devices);
    const CMPIObjectPath* const target =
        factory.get_assoc_targetClass_ObjectPath(broker, ref, GlimmarkSystemDeviceClass, nullptr, &status);
    if (!Cmpi::exists(target)) {
        fail(status, "Object Path is NULL in ReferenceNames.", "Object Path is NULL in ReferenceNames.");
        return status;
    }
    const Traversal traversal{flow, factory, ctx, ref, target};
    if (!forEachReference(traversal, devices, status, [&](const CMPIInstance* instance) {
            if (const CMPIObjectPath* name = Cmpi::objectPathOf(instance, &status))
                returnObjectPathOf(rslt, name, ref, &status);
        }))
        return status;

    flow.exiting();
    return status;
}

GLIMMARK_FIXED_INSTANCE_OPERATIONS(GlimmarkSystemDevice)
GLIMMARK_FIXED_ASSOCIATION_OPERATIONS(GlimmarkSystemDevice)

static FunctionTable<CMPIInstanceMI> instMIFT__ = {
    interfaceVersion,
    interfaceVersion,
    miName("instanceGlimmarkSystemDeviceProvider"),
    Entry(GlimmarkSystemDevice_Cleanup),
    Entry(GlimmarkSystemDevice_EnumInstanceNames),
    Entry(GlimmarkSystemDevice_EnumInstances),
    Entry(GlimmarkSystemDevice_GetInstance),
    Entry(GlimmarkSystemDevice_CreateInstance),
    Entry(GlimmarkSystemDevice_ModifyInstance),
    Entry(GlimmarkSystemDevice_DeleteInstance),
    Entry(GlimmarkSystemDevice_ExecQuery),
};

static FunctionTable<CMPIAssociationMI> assocMIFT__ = {
    interfaceVersion,
    interfaceVersion,
    miName("associationGlimmarkSystemDeviceProvider"),
    Entry(GlimmarkSystemDevice_AssociationCleanup),
    Entry(GlimmarkSystemDevice_Associators),
    Entry(GlimmarkSystemDevice_AssociatorNames),
    Entry(GlimmarkSystemDevice_References),
    Entry(GlimmarkSystemDevice_ReferenceNames),
};

} // namespace Tavro::GlimmarkProvider

CMPIInstanceMI* GlimmarkSystemDeviceProvider_Create_InstanceMI(const CMPIBroker* broker,
                                                               const CMPIContext* /*ctx*/, CMPIStatus* /*rc*/)
{
    static CMPIInstanceMI mi = {nullptr, &Tavro::GlimmarkProvider::instMIFT__};
    Tavro::GlimmarkProvider::broker = broker;
    return &mi;
}

CMPIAssociationMI* GlimmarkSystemDeviceProvider_Create_AssociationMI(const CMPIBroker* broker,
                                                                     const CMPIContext* /*ctx*/,
                                                                     CMPIStatus* /*rc*/)
{
    static CMPIAssociationMI mi = {nullptr, &Tavro::GlimmarkProvider::assocMIFT__};
    Tavro::GlimmarkProvider::broker = broker;
    return &mi;
}
