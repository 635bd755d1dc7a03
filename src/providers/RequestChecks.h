/// \file
/// What an operation wants of a request.
#ifndef TAVRO_GLIMMARK_REQUESTCHECKS_H
#define TAVRO_GLIMMARK_REQUESTCHECKS_H

#include "Cmpi.h"

namespace Tavro::GlimmarkProvider {

/// Whether the request's path has a key. If not, reports the failure.
inline bool requireKeys(const CMPIBroker* broker, const char* provider, const CMPIObjectPath* cop,
                        CMPIStatus& status)
{
    if (Cmpi::keyCountOf(cop, &status) != 0)
        return true;
    const char* const text = "At least one key should be passed";
    Cmpi::reportFailure(broker, provider, &status, text, text);
    return false;
}

} // namespace Tavro::GlimmarkProvider

#endif
