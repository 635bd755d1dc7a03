#include "Capabilities.h"

#include "Factory.h"
#include "Indicators.h"
#include "Keys.h"
#include "Names.h"
#include "Results.h"
#include "Trace.h"

#include <string>

namespace described {

namespace {

constexpr auto module = "GlimmarkCapabilitiesProvider";

/// \return whether the key is that of the capabilities
bool returnCapabilities(const Result* result, const Path* cop, const CMPIString* key, Status& status)
{
    collectCapabilities();
    const Flow flow(factory, "getOneGlimmarkCapabilitiesCMPIInstance");
    const char* const text = characters(key, status);
    if (text == nullptr || std::string(text) != capabilitiesIdentifier)
        return false;
    const Instance* const instance = capabilitiesInstance(cop, status);
    flow.exiting();
    returnInstance(result, instance);
    return true;
}

} // namespace

Status capabilitiesNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref)
{
    const Flow flow(module, "GlimmarkCapabilities_EnumInstanceNames");
    Status status = ok;
    collectCapabilities();
    Paths paths;
    if (!addCapabilitiesPaths(ref, paths, status))
        return status;
    for (const Path* path : paths) {
        if (missing(path))
            continue;
        place(path, ref, status);
        returnPath(result, path);
    }
    returnDone(result);
    flow.exiting();
    return status;
}

Status capabilities(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**)
{
    const Flow flow(module, "GlimmarkCapabilities_EnumInstances");
    Status status = ok;
    collectCapabilities();
    returnInstances(result, capabilitiesInstances(ref, status));
    returnDone(result);
    flow.exiting();
    return status;
}

Status oneCapabilities(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop,
                       const char**)
{
    const Flow flow(module, "GlimmarkCapabilities_GetInstance");
    Status status = ok;
    if (hasKeys(capabilitiesProvider, cop, status)) {
        if (const CMPIString* const key = textKey(cop, "InstanceID", status)) {
            if (!returnCapabilities(result, cop, key, status))
                return status;
        } else {
            collectIndicators(); // and not the capabilities: the search finds nothing
            capabilitiesInstances(cop, status, false);
        }
    }
    returnDone(result);
    flow.exiting();
    return status;
}

} // namespace described
