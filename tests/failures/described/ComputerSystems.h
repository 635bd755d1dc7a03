/// \file
/// The computer systems, which the broker is asked for by an up-call, and the walk over its answer.
#ifndef TESTS_FAILURES_DESCRIBED_COMPUTERSYSTEMS_H
#define TESTS_FAILURES_DESCRIBED_COMPUTERSYSTEMS_H

#include "Services.h"
#include "Trace.h"

namespace described {

/// Their names. Where the status that is left is not good, the operation's error line was written.
CMPIEnumeration* computerSystemNames(const Flow& operation, const CMPIContext* ctx, const Path* classPath,
                                     Status& rc);

CMPIEnumeration* computerSystemInstances(const CMPIContext* ctx, const Path* classPath, Status& rc);

/// A null enumeration has none.
bool hasNext(const CMPIEnumeration* items);

/// Takes the next item. \return null where it is none of the kind
Path* nextPath(const CMPIEnumeration* items);
Instance* nextInstance(const CMPIEnumeration* items);

} // namespace described

#endif
