// Associators and references of TAVRO_GlimmarkSystemDevice.

#include "SystemDevices.h"

#include "ComputerSystems.h"
#include "Factory.h"
#include "Indicators.h"
#include "Names.h"
#include "Results.h"
#include "Trace.h"

#include <string>

namespace described {

namespace {

/// What both reference operations walk over. \param handOn  takes each instance that could be made
/// \return whether the operation goes on to its EXITING line
template <class HandOn>
bool walkReferences(const Flow& flow, const CMPIContext* ctx, const Path* ref, const char* failure,
                    Status& status, HandOn handOn)
{
    const Indicators indicators = collectIndicators();
    const Path* const target = targetPath(ref, systemDeviceClass, status);
    if (missing(target)) {
        report(systemDeviceProvider, status, failure);
        return false;
    }
    const Path* const path = newPath(ref, systemDeviceClass, status);
    placeOnHost(path, ref, status);
    const auto refer = [&](const Path* group, const Path* part) {
        Instance* const instance = newInstance(path, &status);
        if (instance == nullptr)
            return;
        setReference(instance, "GroupComponent", group);
        setReference(instance, "PartComponent", part);
        handOn(instance);
    };
    const std::string farClass = className(target, status);
    if (farClass == glimmarkClass) {
        Paths devices;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return false;
        for (const Path* device : devices)
            refer(ref, device);
    } else if (farClass == computerSystemClass) {
        const CMPIEnumeration* const systems = computerSystemNames(flow, ctx, target, status);
        if (status.rc != CMPI_RC_OK)
            return false;
        while (hasNext(systems)) {
            nextPath(systems); // and not used: the group is the class
            refer(target, ref);
        }
    }
    return true;
}

} // namespace

Status systemDeviceAssociators(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                               const Path* ref, const char* assocClass, const char*, const char*, const char*,
                               const char**)
{
    const Flow flow(systemDeviceProvider, "GlimmarkSystemDevice_Associators");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const target = targetPath(ref, assocClass, status);
    if (missing(target))
        return ok;
    const std::string farClass = className(target, status);
    if (farClass == computerSystemClass) {
        const CMPIEnumeration* const systems = computerSystemInstances(ctx, target, status);
        while (hasNext(systems)) {
            if (const Instance* const system = nextInstance(systems))
                returnInstance(result, system);
        }
    } else if (farClass == glimmarkClass) {
        for (const Instance* instance : indicatorInstances(indicators, ref, status)) {
            if (instance != nullptr)
                returnInstance(result, instance);
        }
    }
    flow.exiting();
    return status;
}

Status systemDeviceAssociatorNames(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                                   const Path* ref, const char* assocClass, const char*, const char*,
                                   const char*)
{
    const Flow flow(systemDeviceProvider, "GlimmarkSystemDevice_AssociatorNames");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const target = targetPath(ref, assocClass, status);
    if (missing(target))
        return ok;
    const std::string farClass = className(target, status);
    if (farClass == computerSystemClass) {
        const CMPIEnumeration* const systems = computerSystemNames(flow, ctx, target, status);
        if (status.rc != CMPI_RC_OK)
            return status;
        while (hasNext(systems)) {
            if (const Path* const system = nextPath(systems))
                returnPath(result, system);
        }
    } else if (farClass == glimmarkClass) {
        Paths devices;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return status;
        returnPaths(result, devices, ref, status);
    }
    flow.exiting();
    return status;
}

Status systemDeviceReferences(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                              const Path* ref, const char*, const char*, const char**)
{
    const Flow flow(systemDeviceProvider, "GlimmarkSystemDevice_References");
    Status status = ok;
    if (walkReferences(flow, ctx, ref, "Object Path is NULL in References.", status,
                       [&](const Instance* instance) { returnInstance(result, instance); }))
        flow.exiting();
    return status;
}

Status systemDeviceReferenceNames(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                                  const Path* ref, const char*, const char*)
{
    const Flow flow(systemDeviceProvider, "GlimmarkSystemDevice_ReferenceNames");
    Status status = ok;
    if (walkReferences(flow, ctx, ref, "Object Path is NULL in ReferenceNames.", status,
                       [&](const Instance* instance) { returnPathOf(result, instance, ref, status); }))
        flow.exiting();
    return status;
}

} // namespace described
