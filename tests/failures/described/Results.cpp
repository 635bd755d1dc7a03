#include "Results.h"

#include <Tavro/Common.h>

namespace described {

void returnPath(const Result* result, const Path* path)
{
    result->ft->returnObjectPath(result, path);
}

void returnPaths(const Result* result, const Paths& paths, const Path* ref, Status& status)
{
    for (const Path* path : paths) {
        place(path, ref, status);
        returnPath(result, path);
    }
}

void returnInstance(const Result* result, const Instance* instance)
{
    result->ft->returnInstance(result, instance);
}

void returnInstances(const Result* result, const Instances& instances)
{
    for (const Instance* instance : instances)
        returnInstance(result, instance);
}

void returnFirstEqual(const Result* result, const Instances& instances, const Path* cop, bool deep,
                      Status& status)
{
    for (const Instance* instance : instances) {
        if (missing(instance) || !Tavro::isObjPathsEqual(cop, pathOf(instance, status), deep))
            continue;
        returnInstance(result, instance);
        return;
    }
}

void returnPathOf(const Result* result, const Instance* instance, const Path* ref, Status& status)
{
    if (Path* const path = pathOf(instance, status))
        returnPaths(result, {path}, ref, status);
}

void returnDone(const Result* result)
{
    result->ft->returnDone(result);
}

} // namespace described
