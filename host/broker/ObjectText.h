/// \file
/// The broker's objects as text, for a provider's messages.
#ifndef CIMHOST_BROKER_OBJECTTEXT_H
#define CIMHOST_BROKER_OBJECTTEXT_H

#include "broker/Handle.h"

#include <string>

namespace cimhost {

/// A path as clients write it, an instance in MOF, a string or datetime as it is; of other objects the
/// name of their type.
/// \param handle  of a live object
std::string objectText(const Handle& handle);

} // namespace cimhost

#endif
