/// \file
/// What the path of a request for one instance says.
#ifndef TESTS_FAILURES_DESCRIBED_KEYS_H
#define TESTS_FAILURES_DESCRIBED_KEYS_H

#include "Services.h"

namespace described {

/// Whether the path has any key; that it has none is reported.
bool hasKeys(const char* provider, const Path* cop, Status& status);

/// The text of a key; null when its value is no string with content.
CMPIString* textKey(const Path* cop, const char* name, Status& status);

} // namespace described

#endif
