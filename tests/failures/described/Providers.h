/// \file
/// What the four providers are described to do, written down a second time: providers that answer every read
/// operation call by call and line by line as the library should, whatever the broker's calls return. Tests
/// run an operation with the library and with these and compare all that the broker and the log have seen.
///
/// They share nothing with the library and are built the other way round: one straight walk for each
/// operation, for one thread, for requests without a property list and a result class, for inventories of
/// fewer than 65,536 indicators, without the parameter lists of the trace lines.
#ifndef TESTS_FAILURES_DESCRIBED_PROVIDERS_H
#define TESTS_FAILURES_DESCRIBED_PROVIDERS_H

#include "testing/Operations.h"

namespace described {

/// The providers' factory functions. Operations other than those of allOperations() are null pointers.
EntryPoints entryPoints();

} // namespace described

#endif
