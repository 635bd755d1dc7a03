/// \file
/// Lists of what was made for a request, on their way into its result.
#ifndef TAVRO_GLIMMARK_RESULTLISTS_H
#define TAVRO_GLIMMARK_RESULTLISTS_H

#include "Cmpi.h"
#include "Counted.h"
#include "GlimmarkFactory.h"
#include "RequestPaths.h"

#include <cstdint>
#include <vector>

namespace Tavro::GlimmarkProvider {

/// Reserves a place for each indicator of the factory, as far as 16 bits count them.
template <class Item>
void reserveFor(const GlimmarkFactory& factory, std::vector<Item*>& list)
{
    list.reserve(static_cast<std::uint16_t>(factory.getNumberOfInstances()));
}

/// Returns each instance as it is, null ones too.
inline void returnInstances(const CMPIResult* result, const std::vector<CMPIInstance*>& instances)
{
    for (const CMPIInstance* instance : Counted(instances))
        Cmpi::returnInstance(result, instance);
}

/// Puts a path into the namespace of the request's path and returns it.
inline void returnObjectPathOf(const CMPIResult* result, const CMPIObjectPath* path,
                               const CMPIObjectPath* ref, CMPIStatus* rc)
{
    setNameSpaceOf(path, ref, rc);
    Cmpi::returnObjectPath(result, path);
}

/// Whether an instance has the path that was asked for. \param deep  compares references among the keys as
/// paths. An instance without an object behind it equals nothing.
inline bool isAt(const CMPIInstance* instance, const CMPIObjectPath* cop, bool deep, CMPIStatus& status)
{
    return Cmpi::exists(instance) && isObjPathsEqual(cop, Cmpi::objectPathOf(instance, &status), deep);
}

/// Returns the first of the instances that has the path asked for, if there is one.
inline void returnFirstAt(const CMPIResult* result, const std::vector<CMPIInstance*>& instances,
                          const CMPIObjectPath* cop, bool deep, CMPIStatus& status)
{
    for (const CMPIInstance* instance : Counted(instances)) {
        if (isAt(instance, cop, deep, status)) {
            Cmpi::returnInstance(result, instance);
            return;
        }
    }
}

} // namespace Tavro::GlimmarkProvider

#endif
