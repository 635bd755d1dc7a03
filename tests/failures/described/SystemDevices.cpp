#include "SystemDevices.h"

#include "ComputerSystems.h"
#include "Factory.h"
#include "Indicators.h"
#include "Keys.h"
#include "Names.h"
#include "Results.h"
#include "Trace.h"

#include <optional>

namespace described {

namespace {

/// The instance builder. \return nothing: it failed
std::optional<Instances> systemDeviceInstances(const Path* ref, const CMPIContext* ctx)
{
    const Flow flow(systemDeviceProvider, "glimmarkSystemDeviceCMPIInstances");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const classPath = newPath(ref, computerSystemClass, status);
    if (missing(classPath)) {
        report(systemDeviceProvider, status, "Create CMPIObjectPath            failed.",
               "Create CMPIObjectPath failed for             ComputerSystemClass.");
        return std::nullopt;
    }
    const CMPIEnumeration* const systems = computerSystemNames(flow, ctx, classPath, status);
    if (status.rc != CMPI_RC_OK)
        return std::nullopt;
    Instances instances;
    while (hasNext(systems)) {
        const Path* const system = nextPath(systems);
        if (system == nullptr)
            continue;
        Paths devices;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return std::nullopt;
        for (const Path* device : devices) {
            if (missing(device)) {
                report(systemDeviceProvider, status, "CMPIObjectPath is NULL for Glimmark Provider");
                return std::nullopt;
            }
            place(device, ref, status);
            const Path* const path = newPath(ref, systemDeviceClass, status);
            if (missing(path)) // reported, and carried on
                report(systemDeviceProvider, status, "Create CMPIObjectPath failed for HostedAccessPoint",
                       "Create CMPIObjectPath failed for                     HostedAccessPoint.");
            placeOnHost(path, ref, status);
            Instance* const instance = newInstance(path, nullptr);
            if (!missing(instance)) {
                setFilter(instance, {"GroupComponent", "PartComponent"});
                setReference(instance, "GroupComponent", system);
                setReference(instance, "PartComponent", device);
            }
            instances.push_back(instance);
        }
    }
    flow.exiting();
    return instances;
}

} // namespace

Status systemDeviceNames(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* ref)
{
    const Flow flow(systemDeviceProvider, "GlimmarkSystemDevice_EnumInstanceNames");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const classPath = newPath(ref, computerSystemClass, status);
    if (missing(classPath)) {
        report(systemDeviceProvider, status, "Create CMPIObjectPath failed.",
               "Create CMPIObjectPath failed for ComputerSystemClass.");
        return status;
    }
    const CMPIEnumeration* const systems = computerSystemNames(flow, ctx, classPath, status);
    if (status.rc != CMPI_RC_OK)
        return status;
    Paths devices; // one list for all systems
    while (hasNext(systems)) {
        const Path* const system = nextPath(systems);
        if (system == nullptr)
            continue;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return status;
        for (const Path* device : devices) {
            if (missing(device)) {
                report(systemDeviceProvider, status, "CMPIObjectPath is NULL for Glimmark",
                       "CMPIObjectPath is NULL for Glimmark Class");
                return status;
            }
            place(device, ref, status);
            const Path* const path = newPath(ref, systemDeviceClass, status);
            if (missing(path)) {
                report(systemDeviceProvider, status,
                       "Create CMPIObjectPath failed                     for GlimmarkSystemDeviceProvider.",
                       "Create CMPIObjectPath failed for                     GlimmarkSystemDeviceClass.");
                return status;
            }
            placeOnHost(path, ref, status);
            addKey(path, "GroupComponent", system);
            addKey(path, "PartComponent", device);
            returnPath(result, path);
        }
    }
    flow.exiting();
    returnDone(result);
    return status;
}

Status systemDevices(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* ref,
                     const char**)
{
    const Flow flow(systemDeviceProvider, "GlimmarkSystemDevice_EnumInstances");
    if (const auto instances = systemDeviceInstances(ref, ctx))
        returnInstances(result, *instances);
    flow.exiting();
    returnDone(result);
    return ok;
}

Status oneSystemDevice(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* cop,
                       const char**)
{
    const Flow flow(systemDeviceProvider, "GlimmarkSystemDevice_GetInstance");
    Status status = ok;
    if (hasKeys(systemDeviceProvider, cop, status)) {
        if (const auto instances = systemDeviceInstances(cop, ctx))
            returnFirstEqual(result, *instances, cop, true, status);
    }
    returnDone(result); // before the line here
    flow.exiting();
    return status;
}

} // namespace described
