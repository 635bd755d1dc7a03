/// \file
/// What the broker sees while it works, as lines for people.
#ifndef CIMHOST_CLI_REPORTS_H
#define CIMHOST_CLI_REPORTS_H

#include "broker/Broker.h"

#include <iosfwd>

namespace cimhost::cli {

/// Listeners that write to `err`, which must outlive the broker: misuse always, traces and log
/// messages if asked for. Each is one line; the same misuse is said once.
Listeners reportTo(std::ostream& err, bool trace);

} // namespace cimhost::cli

#endif
