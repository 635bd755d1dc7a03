#include "Glimmarks.h"

#include "Factory.h"
#include "Indicators.h"
#include "Keys.h"
#include "Names.h"
#include "Results.h"
#include "Trace.h"

namespace described {

namespace {

constexpr auto module = "GlimmarkProvider";

/// \return whether there is one with the key
bool returnGlimmark(const Result* result, const Path* cop, const CMPIString* key, Status& status)
{
    const Indicators indicators = collectIndicators();
    const Flow flow(factory, "getOneGlimmarkCMPIInstance");
    const char* const text = characters(key, status);
    const auto found = text != nullptr ? indicators.find(text) : indicators.end();
    if (found == indicators.end())
        return false;
    const Instance* const instance = indicatorInstance(found->first, found->second, cop, status);
    flow.exiting();
    returnInstance(result, instance);
    return true;
}

} // namespace

Status glimmarkNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref)
{
    const Flow flow(module, "Glimmark_EnumInstanceNames");
    Status status = ok;
    Paths paths;
    if (!addIndicatorPaths(collectIndicators(), ref, paths, status))
        return status;
    returnPaths(result, paths, ref, status);
    returnDone(result);
    flow.exiting();
    return status;
}

Status glimmarks(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**)
{
    const Flow flow(module, "Glimmark_EnumInstances");
    Status status = ok;
    returnInstances(result, indicatorInstances(collectIndicators(), ref, status));
    returnDone(result);
    flow.exiting();
    return status;
}

Status oneGlimmark(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop, const char**)
{
    const Flow flow(module, "Glimmark_GetInstance");
    Status status = ok;
    if (hasKeys(glimmarkProvider, cop, status)) {
        if (const CMPIString* const key = textKey(cop, "DeviceID", status)) {
            if (!returnGlimmark(result, cop, key, status))
                return status;
        } else {
            const Instances instances = indicatorInstances(collectIndicators(), cop, status);
            returnFirstEqual(result, instances, cop, false, status);
        }
    }
    returnDone(result);
    flow.exiting();
    return status;
}

} // namespace described
