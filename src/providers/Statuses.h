/// \file
/// What an operation answers before anything went wrong, and what those answer that this library does not
/// have.
#ifndef TAVRO_GLIMMARK_STATUSES_H
#define TAVRO_GLIMMARK_STATUSES_H

#include <cmpidt.h>

namespace Tavro::GlimmarkProvider {

inline CMPIStatus okStatus()
{
    return {CMPI_RC_OK, nullptr};
}

/// The answer to all that would change something: the library only reads.
inline CMPIStatus notSupportedStatus()
{
    return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
}

} // namespace Tavro::GlimmarkProvider

#endif
