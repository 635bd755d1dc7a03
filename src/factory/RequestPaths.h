/// \file
/// Object paths in the terms of a request: everything made for it carries the namespace of the request's
/// path `ref` and this system's name as host. The namespace is read from `ref` afresh at each use.
#ifndef TAVRO_GLIMMARK_REQUESTPATHS_H
#define TAVRO_GLIMMARK_REQUESTPATHS_H

#include "Cmpi.h"

#include <Tavro/Common.h>

namespace Tavro::GlimmarkProvider {

/// Sets the namespace of `ref` on a path. \param rc  handed to the calls that read it
inline void setNameSpaceOf(const CMPIObjectPath* path, const CMPIObjectPath* ref, CMPIStatus* rc)
{
    if (path != nullptr)
        Cmpi::setNameSpace(path, Cmpi::nameSpaceOf(ref, rc));
}

/// Sets the namespace of `ref` and this system's name on a path. A null path is left alone.
inline void setOrigin(const CMPIObjectPath* path, const CMPIObjectPath* ref, CMPIStatus* rc)
{
    setNameSpaceOf(path, ref, rc);
    Cmpi::setHostname(path, getSystemName());
}

} // namespace Tavro::GlimmarkProvider

#endif
