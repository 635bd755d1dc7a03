#include "ElementCapabilities.h"

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
std::optional<Instances> elementInstances(const Path* ref)
{
    const Flow flow(elementProvider, "glimmarkElementCapabilitiesCMPIInstances");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    Paths devices;
    if (!addIndicatorPaths(indicators, ref, devices, status)) {
        tell(CMPI_LEV_WARNING, elementProvider,
             "***Can't get Glimmark ObjectPaths.             Exiting EnumerateInstanceNames***");
        return std::nullopt;
    }
    Instances instances;
    for (const Path* device : devices) {
        if (missing(device)) {
            report(elementProvider, status, "CMPIObjectPath is                 NULL for Glimmark",
                   "CMPIObjectPath is NULL for Glimmark");
            return std::nullopt;
        }
        place(device, ref, status);
        Paths shared;
        if (!addCapabilitiesPaths(ref, shared, status)) {
            tell(CMPI_LEV_WARNING, elementProvider,
                 "***Can't get ObjectPaths for                 Capabilities                 Exiting "
                 "EnumerateInstanceNames***");
            return std::nullopt;
        }
        for (const Path* capability : shared) {
            if (missing(device)) { // the device again
                report(elementProvider, status, "CMPIObjectPath is                     NULL for Capabilities",
                       "CMPIObjectPath is NULL for Capabilities");
                return std::nullopt;
            }
            place(capability, ref, status);
            const Path* const path = newPath(ref, elementClass, status);
            if (missing(path)) {
                report(elementProvider, status, "Create CMPIObjectPath failed for ElementCapabilities",
                       "Create CMPIObjectPath failed for ElementCapabilities.");
                return std::nullopt;
            }
            placeOnHost(path, ref, status);
            Instance* const instance = newInstance(path, nullptr);
            if (!missing(instance)) {
                setFilter(instance, {"Antecedent", "Dependent"});
                setReference(instance, "ManagedElement", device);
                setReference(instance, "Capabilities", capability);
            }
            instances.push_back(instance);
        }
    }
    flow.exiting();
    return instances;
}

} // namespace

Status elementNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_EnumInstanceNames");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    Paths devices;
    if (!addIndicatorPaths(indicators, ref, devices, status))
        return status;
    for (const Path* device : devices) {
        if (missing(device)) {
            report(elementProvider, status, "CMPIObjectPath is NULL for Glimmark class");
            return status;
        }
        place(device, ref, status);
        Paths shared;
        if (!addCapabilitiesPaths(ref, shared, status))
            return status;
        for (const Path* capability : shared) {
            if (missing(capability)) { // here the capabilities
                report(elementProvider, status,
                       "CMPIObjectPath is                     NULL for GlimmarkCapabilities",
                       "CMPIObjectPath is NULL for                     Capabilities");
                return status;
            }
            place(capability, ref, status);
            const Path* const path = newPath(ref, elementClass, status);
            if (missing(path)) {
                report(elementProvider, status,
                       "Create CMPIObjectPath failed                     for ElementCapabilities",
                       "Create CMPIObjectPath failed                     for ElementCapabilities.");
                return status;
            }
            placeOnHost(path, ref, status);
            addKey(path, "ManagedElement", device);
            addKey(path, "Capabilities", capability);
            returnPath(result, path);
        }
    }
    flow.exiting();
    returnDone(result);
    return status;
}

Status elements(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_EnumInstances");
    if (const auto instances = elementInstances(ref))
        returnInstances(result, *instances);
    flow.exiting();
    returnDone(result);
    return ok;
}

Status oneElement(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_GetInstance");
    Status status = ok;
    if (hasKeys(elementProvider, cop, status)) {
        if (const auto instances = elementInstances(cop))
            returnFirstEqual(result, *instances, cop, true, status);
    }
    flow.exiting();
    returnDone(result);
    return status;
}

} // namespace described
