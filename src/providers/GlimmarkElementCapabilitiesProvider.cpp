// The provider of the association TAVRO_GlimmarkElementCapabilities, between each indicator and the
// capabilities object: its instances and its traversal.

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

#include <cstring>
#include <string>
#include <vector>

namespace Tavro::GlimmarkProvider {

const std::string loggerGlimmarkElementCapabilitiesProvider("Mavrel.GlimmarkElementCapabilitiesProvider");

static BrokerPointer broker{nullptr};

namespace {

const TraceModule traceModule{"GlimmarkElementCapabilitiesProvider.cpp",
                              loggerGlimmarkElementCapabilitiesProvider};

/// The path of an association in the request's terms; null, or without a handle, when the broker could not
/// make it.
CMPIObjectPath* newAssociationPath(const CMPIObjectPath* ref, CMPIStatus* rc)
{
    return Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, rc), GlimmarkElementCapabilitiesClass, rc);
}

/// Reports a failure of an operation of this module.
void fail(CMPIStatus& status, const char* message, const char* traceText)
{
    Cmpi::reportFailure(broker, GlimmarkElementCapabilitiesProvider, &status, message, traceText);
}

/// Tells the broker of a failure that no caller sees.
void warn(const char* text)
{
    Cmpi::trace(broker, CMPI_LEV_WARNING, GlimmarkElementCapabilitiesProvider, text);
}

/// \return null when the instance could not be made
CMPIInstance* newAssociation(const CMPIObjectPath* path, const CMPIObjectPath* device,
                             const CMPIObjectPath* capabilities, const char** properties)
{
    CMPIInstance* const instance = Cmpi::newInstance(broker, path, nullptr);
    if (Cmpi::exists(instance)) {
        // Deliberate: the names that associations of dependency share, not those of the two properties;
        // brokers filter by them.
        // Test: ElementCapabilitiesInstances.ThePropertyListIsTheInstancesFilterAndNothingElse.
        const char* keys[] = {"Antecedent", "Dependent", nullptr};
        Cmpi::setPropertyFilter(instance, properties, keys);
        Cmpi::setProperty(instance, "ManagedElement", device);
        Cmpi::setProperty(instance, "Capabilities", capabilities);
    }
    return instance;
}

} // namespace

/// Appends the association of each indicator with each capabilities object, in the order of the indicators;
/// a null pointer for each one that could not be made. Its failures are known to the trace alone.
/// \return 0, or 1 when the walk had to end early
int glimmarkElementCapabilitiesCMPIInstances(const CMPIObjectPath* ref, const char** properties,
                                             std::vector<CMPIInstance*>& instances)
{
    const FunctionTrace flow(traceModule, "glimmarkElementCapabilitiesCMPIInstances", [&] {
        return parameterList(" ref=", ref, " properties=", properties, " instances=", &instances);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, true);
    reserveFor(factory, instances);
    std::vector<CMPIObjectPath*> devices;
    if (factory.getAllGlimmarkCMPIObjPaths(broker, ref, devices, &status) != 0) {
        warn("***Can't get Glimmark ObjectPaths.             Exiting EnumerateInstanceNames***");
        return 1;
    }
    for (const CMPIObjectPath* device : Counted(devices)) {
        if (!Cmpi::exists(device)) {
            fail(status, "CMPIObjectPath is                 NULL for Glimmark",
                 "CMPIObjectPath is NULL for Glimmark");
            return 1;
        }
        setNameSpaceOf(device, ref, &status);
        std::vector<CMPIObjectPath*> capabilitiesPaths;
        if (factory.getAllGlimmarkCapabilitiesCMPIObjPaths(broker, ref, capabilitiesPaths, &status) != 0) {
            warn("***Can't get ObjectPaths for                 Capabilities                 Exiting "
                 "EnumerateInstanceNames***");
            return 1;
        }
        for (const CMPIObjectPath* capabilities : Counted(capabilitiesPaths)) {
            // Deliberate: the alarm device again, not the capabilities; a client gets the association all the
            // same.
            // Test: ElementCapabilitiesInstances.ACapabilitiesPathWithoutAnObjectBehindItIsNotDetected.
            if (!Cmpi::exists(device)) {
                fail(status, "CMPIObjectPath is                     NULL for Capabilities",
                     "CMPIObjectPath is NULL for Capabilities");
                return 1;
            }
            setNameSpaceOf(capabilities, ref, &status);
            const CMPIObjectPath* const path = newAssociationPath(ref, &status);
            if (!Cmpi::exists(path)) {
                fail(status, "Create CMPIObjectPath failed for ElementCapabilities",
                     "Create CMPIObjectPath failed for ElementCapabilities.");
                return 1;
            }
            setOrigin(path, ref, &status);
            instances.push_back(newAssociation(path, device, capabilities, properties));
        }
    }
    flow.exiting();
    return 0;
}

CMPIStatus GlimmarkElementCapabilities_EnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                                         const CMPIResult* rslt, const CMPIObjectPath* ref)
{
    const FunctionTrace flow(traceModule, "GlimmarkElementCapabilities_EnumInstanceNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref);
    });
    CMPIStatus status = okStatus();

    // The builder's walk, with texts of its own and the capabilities path checked instead of the alarm
    // device path again.
    // Deliberate: every early return goes without an EXITING line and returnDone; brokers go by the status.
    // Test: ElementCapabilitiesNameFailures.AreReportedAndEndTheOperationWithoutDoneAndExit.
    const GlimmarkFactory factory(true, true);
    std::vector<CMPIObjectPath*> devices;
    reserveFor(factory, devices);
    if (factory.getAllGlimmarkCMPIObjPaths(broker, ref, devices, &status) != 0)
        return status;
    for (const CMPIObjectPath* device : Counted(devices)) {
        if (!Cmpi::exists(device)) {
            fail(status, "CMPIObjectPath is NULL for Glimmark class",
                 "CMPIObjectPath is NULL for Glimmark class");
            return status;
        }
        setNameSpaceOf(device, ref, &status);
        std::vector<CMPIObjectPath*> capabilitiesPaths;
        if (factory.getAllGlimmarkCapabilitiesCMPIObjPaths(broker, ref, capabilitiesPaths, &status) != 0)
            return status;
        for (const CMPIObjectPath* capabilities : Counted(capabilitiesPaths)) {
            if (!Cmpi::exists(capabilities)) {
                fail(status, "CMPIObjectPath is                     NULL for GlimmarkCapabilities",
                     "CMPIObjectPath is NULL for                     Capabilities");
                return status;
            }
            setNameSpaceOf(capabilities, ref, &status);
            const CMPIObjectPath* const path = newAssociationPath(ref, &status);
            if (!Cmpi::exists(path)) {
                fail(status, "Create CMPIObjectPath failed                     for ElementCapabilities",
                     "Create CMPIObjectPath failed                     for ElementCapabilities.");
                return status;
            }
            setOrigin(path, ref, &status);
            Cmpi::addKey(path, "ManagedElement", device);
            Cmpi::addKey(path, "Capabilities", capabilities);
            Cmpi::returnObjectPath(rslt, path);
        }
    }

    flow.exiting();
    Cmpi::returnDone(rslt);
    return status;
}

CMPIStatus GlimmarkElementCapabilities_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                                     const CMPIResult* rslt, const CMPIObjectPath* ref,
                                                     const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkElementCapabilities_EnumInstances", [&] {
        // Deliberate: the first and the last label go without an equals sign; log filters know them so.
        // Test: ElementCapabilitiesInstances.InstancesAreTracedWithTwoLabelsThatLackTheEqualsSign.
        return parameterList(" mi", mi, " ctx=", ctx, " result=", rslt, " ref=", ref, " properties",
                             properties);
    });
    const CMPIStatus status = okStatus();

    // Deliberate: a failed build is answered as an empty, successful enumeration; clients see no error of one
    // class in an enumeration of many.
    // Test: ElementCapabilitiesBuilderFailures.AreReportedAndAnsweredAsAnEmptySuccess.
    std::vector<CMPIInstance*> instances;
    if (glimmarkElementCapabilitiesCMPIInstances(ref, properties, instances) == 0)
        returnInstances(rslt, instances);

    flow.exiting();
    Cmpi::returnDone(rslt);
    return status;
}

CMPIStatus GlimmarkElementCapabilities_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                                   const CMPIResult* rslt, const CMPIObjectPath* cop,
                                                   const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkElementCapabilities_GetInstance", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " cop=", cop,
                             " properties=", properties);
    });
    CMPIStatus status = okStatus();

    if (requireKeys(broker, GlimmarkElementCapabilitiesProvider, cop, status)) {
        std::vector<CMPIInstance*> instances;
        if (glimmarkElementCapabilitiesCMPIInstances(cop, properties, instances) == 0)
            returnFirstAt(rslt, instances, cop, true, status);
    }

    flow.exiting();
    Cmpi::returnDone(rslt);
    return status;
}

namespace {

/// The far end of a traversal: the class of a target path, and how to get its objects.
enum class FarEnd
{
    glimmarks,
    capabilities,
    neither
};

FarEnd farEndOf(const CMPIObjectPath* target, CMPIStatus* rc)
{
    const char* const className = Cmpi::classNameOf(target, rc);
    if (className != nullptr && std::strcmp(className, GlimmarkClass) == 0)
        return FarEnd::glimmarks;
    if (className != nullptr && std::strcmp(className, GlimmarkCapabilitiesClass) == 0)
        return FarEnd::capabilities;
    return FarEnd::neither;
}

/// Appends the far end's paths. \return the factory's result; 0 for neither class
int getFarPaths(const GlimmarkFactory& factory, FarEnd farEnd, const CMPIObjectPath* ref,
                std::vector<CMPIObjectPath*>& paths, CMPIStatus* rc)
{
    if (farEnd == FarEnd::glimmarks)
        return factory.getAllGlimmarkCMPIObjPaths(broker, ref, paths, rc);
    if (farEnd == FarEnd::capabilities)
        return factory.getAllGlimmarkCapabilitiesCMPIObjPaths(broker, ref, paths, rc);
    return 0;
}

/// Appends the far end's instances. \return the factory's result; 0 for neither class
int getFarInstances(const GlimmarkFactory& factory, FarEnd farEnd, const CMPIObjectPath* ref,
                    const char** properties, std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    if (farEnd == FarEnd::glimmarks)
        return factory.getAllGlimmarkCMPIInstances(broker, ref, properties, false, instances, rc);
    if (farEnd == FarEnd::capabilities)
        return factory.getAllGlimmarkCapabilitiesCMPIInstances(broker, ref, properties, false, instances, rc);
    return 0;
}

/// The association of the request's path with one far path. No key is compared: each far object belongs to
/// the request's.
/// \return null when the path or the instance could not be made
CMPIInstance* newReference(const CMPIObjectPath* path, FarEnd farEnd, const CMPIObjectPath* ref,
                           const CMPIObjectPath* far, CMPIStatus* rc)
{
    CMPIInstance* const instance = path != nullptr ? Cmpi::newInstance(broker, path, rc) : nullptr;
    const bool farIsDevice = farEnd == FarEnd::glimmarks;
    Cmpi::setProperty(instance, "ManagedElement", farIsDevice ? far : ref);
    Cmpi::setProperty(instance, "Capabilities", farIsDevice ? ref : far);
    return instance;
}

/// Makes the association instance of the request's path with each object of the far end and hands it on, null
/// where it could not be made.
/// \param farPaths  filled with the paths of the far end
/// \return whether the far end could be had; if not, the status is as the factory set it
template <class HandOn>
bool forEachReference(const GlimmarkFactory& factory, const CMPIObjectPath* target, const CMPIObjectPath* ref,
                      std::vector<CMPIObjectPath*>& farPaths, CMPIStatus& status, HandOn handOn)
{
    const FarEnd farEnd = farEndOf(target, &status);
    const CMPIObjectPath* const path = newAssociationPath(ref, &status);
    setOrigin(path, ref, &status);
    if (getFarPaths(factory, farEnd, ref, farPaths, &status) != 0)
        return false;
    for (const CMPIObjectPath* far : Counted(farPaths))
        handOn(newReference(path, farEnd, ref, far, &status));
    return true;
}

} // namespace

// The traversals.
// Deliberate: none of them calls returnDone, and an early return goes without an EXITING line; brokers go by
// the status.
// Test: ElementCapabilitiesTraversals.LeadFromAnIndicatorToTheCapabilities.
// Deliberate: role,
// result role and result class filter nothing; clients that name a base of the far end's class rely on it.
// Test: ElementCapabilitiesTraversals.DoNotFilterByResultClassOrRoles.

CMPIStatus GlimmarkElementCapabilities_References(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                                  const CMPIResult* rslt, const CMPIObjectPath* ref,
                                                  const char* resultClass, const char* role,
                                                  const char** properties)
{
    const auto parameters = [&](const char* propertiesLabel) {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " resultClass=", resultClass, " role=", role, propertiesLabel, properties);
    };
    const FunctionTrace flow(traceModule, "GlimmarkElementCapabilities_References",
                             [&] { return parameters(" properties="); });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, true);
    std::vector<CMPIObjectPath*> farPaths;
    reserveFor(factory, farPaths);
    const CMPIObjectPath* const target = factory.get_assoc_targetClass_ObjectPath(
        broker, ref, GlimmarkElementCapabilitiesClass, nullptr, &status);
    if (!Cmpi::exists(target)) {
        fail(status, "Object Path is NULL in References.", "Object Path is NULL in References.");
        return status;
    }
    // An instance that could not be made is handed on as it is.
    if (!forEachReference(factory, target, ref, farPaths, status,
                          [&](const CMPIInstance* instance) { Cmpi::returnInstance(rslt, instance); }))
        return status;

    // Deliberate: the last label differs from the ENTERING line's; log filters know it so.
    // Test: ElementCapabilitiesTraversal.ReferencesAreTracedWithAFlawedLabelAtTheExit.
    flow.exiting(parameters(" p     roperties="));
    return status;
}

CMPIStatus GlimmarkElementCapabilities_ReferenceNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                                      const CMPIResult* rslt, const CMPIObjectPath* ref,
                                                      const char* resultClass, const char* role)
{
    const FunctionTrace flow(traceModule, "GlimmarkElementCapabilities_ReferenceNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " resultClass=", resultClass, " role=", role);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, true);
    std::vector<CMPIObjectPath*> farPaths;
    reserveFor(factory, farPaths);
    const CMPIObjectPath* const target = factory.get_assoc_targetClass_ObjectPath(
        broker, ref, GlimmarkElementCapabilitiesClass, nullptr, &status);
    if (!Cmpi::exists(target)) {
        fail(status, "Object Path is NULL in ReferenceNames.", "Object Path is NULL in ReferenceNames.");
        return status;
    }
    if (!forEachReference(factory, target, ref, farPaths, status, [&](const CMPIInstance* instance) {
            if (const CMPIObjectPath* name = Cmpi::objectPathOf(instance, &status))
                returnObjectPathOf(rslt, name, ref, &status);
        }))
        return status;

    flow.exiting();
    return status;
}

CMPIStatus GlimmarkElementCapabilities_AssociatorNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                                       const CMPIResult* rslt, const CMPIObjectPath* ref,
                                                       const char* assocClass, const char* resultClass,
                                                       const char* role, const char* resultRole)
{
    const FunctionTrace flow(traceModule, "GlimmarkElementCapabilities_AssociatorNames", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " _RefLeftClass=", assocClass, " _RefRightClass=", resultClass, " role=", role,
                             " resultRole=", resultRole);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, true);
    std::vector<CMPIObjectPath*> farPaths;
    reserveFor(factory, farPaths);
    const CMPIObjectPath* const target =
        factory.get_assoc_targetClass_ObjectPath(broker, ref, assocClass, resultClass, &status);
    if (!Cmpi::exists(target)) {
        // Deliberate: "AssociatorsNames", with an s too many; log filters match it.
        // Test: ElementCapabilitiesTraversals.FailWhereNoAssociationStarts.
        fail(status, "Object Path is NULL in AssociatorsNames.", "Object Path is NULL in AssociatorsNames.");
        return status;
    }
    if (getFarPaths(factory, farEndOf(target, &status), ref, farPaths, &status) != 0)
        return status;
    for (const CMPIObjectPath* far : Counted(farPaths))
        returnObjectPathOf(rslt, far, ref, &status);

    flow.exiting();
    return status;
}

CMPIStatus GlimmarkElementCapabilities_Associators(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                                   const CMPIResult* rslt, const CMPIObjectPath* ref,
                                                   const char* assocClass, const char* resultClass,
                                                   const char* role, const char* resultRole,
                                                   const char** properties)
{
    const FunctionTrace flow(traceModule, "GlimmarkElementCapabilities_Associators", [&] {
        return parameterList(" mi=", mi, " ctx=", ctx, " result=", rslt, " ref=", ref,
                             " _RefLeftClass=", assocClass, " _RefRightClass=", resultClass, " role=", role,
                             " resultRole=", resultRole, " properties=", properties);
    });
    CMPIStatus status = okStatus();

    const GlimmarkFactory factory(true, true);
    std::vector<CMPIInstance*> farInstances;
    reserveFor(factory, farInstances);
    const CMPIObjectPath* const target =
        factory.get_assoc_targetClass_ObjectPath(broker, ref, assocClass, resultClass, &status);
    if (!Cmpi::exists(target)) {
        fail(status, "Object Path is NULL in Associators.", "Object Path is NULL in Associators.");
        return status;
    }
    if (getFarInstances(factory, farEndOf(target, &status), ref, properties, farInstances, &status) != 0)
        return status;
    returnInstances(rslt, farInstances);

    flow.exiting();
    return status;
}

GLIMMARK_FIXED_INSTANCE_OPERATIONS(GlimmarkElementCapabilities)
GLIMMARK_FIXED_ASSOCIATION_OPERATIONS(GlimmarkElementCapabilities)

static FunctionTable<CMPIInstanceMI> instMIFT__ = {
    interfaceVersion,
    interfaceVersion,
    miName("instanceGlimmarkElementCapabilitiesProvider"),
    Entry(GlimmarkElementCapabilities_Cleanup),
    Entry(GlimmarkElementCapabilities_EnumInstanceNames),
    Entry(GlimmarkElementCapabilities_EnumInstances),
    Entry(GlimmarkElementCapabilities_GetInstance),
    Entry(GlimmarkElementCapabilities_CreateInstance),
    Entry(GlimmarkElementCapabilities_ModifyInstance),
    Entry(GlimmarkElementCapabilities_DeleteInstance),
    Entry(GlimmarkElementCapabilities_ExecQuery),
};

static FunctionTable<CMPIAssociationMI> assocMIFT__ = {
    interfaceVersion,
    interfaceVersion,
    miName("associationGlimmarkElementCapabilitiesProvider"),
    Entry(GlimmarkElementCapabilities_AssociationCleanup),
    Entry(GlimmarkElementCapabilities_Associators),
    Entry(GlimmarkElementCapabilities_AssociatorNames),
    Entry(GlimmarkElementCapabilities_References),
    Entry(GlimmarkElementCapabilities_ReferenceNames),
};

} // namespace Tavro::GlimmarkProvider

CMPIInstanceMI* GlimmarkElementCapabilitiesProvider_Create_InstanceMI(const CMPIBroker* broker,
                                                                      const CMPIContext* /*ctx*/,
                                                                      CMPIStatus* /*rc*/)
{
    static CMPIInstanceMI mi = {nullptr, &Tavro::GlimmarkProvider::instMIFT__};
    Tavro::GlimmarkProvider::broker = broker;
    return &mi;
}

CMPIAssociationMI* GlimmarkElementCapabilitiesProvider_Create_AssociationMI(const CMPIBroker* broker,
                                                                            const CMPIContext* /*ctx*/,
                                                                            CMPIStatus* /*rc*/)
{
    static CMPIAssociationMI mi = {nullptr, &Tavro::GlimmarkProvider::assocMIFT__};
    Tavro::GlimmarkProvider::broker = broker;
    return &mi;
}
