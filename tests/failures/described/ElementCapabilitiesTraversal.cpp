// Associators and references of TAVRO_GlimmarkElementCapabilities.

#include "ElementCapabilities.h"

#include "Factory.h"
#include "Indicators.h"
#include "Names.h"
#include "Results.h"
#include "Trace.h"

#include <string>

namespace described {

namespace {

/// \return whether the far end's paths could be had; those of neither class can, there are none
bool addFarPaths(const std::string& farClass, const Indicators& indicators, const Path* ref, Paths& paths,
                 Status& status)
{
    if (farClass == glimmarkClass)
        return addIndicatorPaths(indicators, ref, paths, status);
    if (farClass == capabilitiesClass)
        return addCapabilitiesPaths(ref, paths, status);
    return true;
}

/// The path of the far end's class; null: there is none, which is reported.
const Path* targetOrReport(const Path* ref, const char* assocClass, const char* failure, Status& status)
{
    const Path* const target = targetPath(ref, assocClass, status);
    if (!missing(target))
        return target;
    report(elementProvider, status, failure);
    return nullptr;
}

/// What both reference operations walk over. \param handOn  takes each instance, null ones too
/// \return whether the operation goes on to its EXITING line
template <class HandOn>
bool walkReferences(const Path* ref, const char* failure, Status& status, HandOn handOn)
{
    const Indicators indicators = collectIndicatorsAndCapabilities();
    const Path* const target = targetOrReport(ref, elementClass, failure, status);
    if (target == nullptr)
        return false;
    const std::string farClass = className(target, status);
    const Path* const path = newPath(ref, elementClass, status);
    placeOnHost(path, ref, status);
    Paths farPaths;
    if (!addFarPaths(farClass, indicators, ref, farPaths, status))
        return false;
    const bool farIsDevice = farClass == glimmarkClass;
    for (const Path* far : farPaths) {
        Instance* const instance = newInstance(path, &status);
        if (instance != nullptr) {
            setReference(instance, "ManagedElement", farIsDevice ? far : ref);
            setReference(instance, "Capabilities", farIsDevice ? ref : far);
        }
        handOn(instance);
    }
    return true;
}

} // namespace

Status elementAssociators(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                          const char* assocClass, const char*, const char*, const char*, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_Associators");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    const Path* const target = targetOrReport(ref, assocClass, "Object Path is NULL in Associators.", status);
    if (target == nullptr)
        return status;
    const std::string farClass = className(target, status);
    if (farClass == glimmarkClass)
        returnInstances(result, indicatorInstances(indicators, ref, status));
    else if (farClass == capabilitiesClass)
        returnInstances(result, capabilitiesInstances(ref, status));
    flow.exiting();
    return status;
}

Status elementAssociatorNames(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                              const char* assocClass, const char*, const char*, const char*)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_AssociatorNames");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    const Path* const target =
        targetOrReport(ref, assocClass, "Object Path is NULL in AssociatorsNames.", status);
    if (target == nullptr)
        return status;
    Paths farPaths;
    if (!addFarPaths(className(target, status), indicators, ref, farPaths, status))
        return status;
    returnPaths(result, farPaths, ref, status);
    flow.exiting();
    return status;
}

Status elementReferences(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                         const char*, const char*, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_References");
    Status status = ok;
    if (walkReferences(ref, "Object Path is NULL in References.", status,
                       [&](const Instance* instance) { returnInstance(result, instance); }))
        flow.exiting();
    return status;
}

Status elementReferenceNames(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                             const char*, const char*)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_ReferenceNames");
    Status status = ok;
    if (walkReferences(ref, "Object Path is NULL in ReferenceNames.", status,
                       [&](const Instance* instance) { returnPathOf(result, instance, ref, status); }))
        flow.exiting();
    return status;
}

} // namespace described
