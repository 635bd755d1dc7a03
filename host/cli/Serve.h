/// \file
/// The command that answers the clients of a network address.
#ifndef CIMHOST_CLI_SERVE_H
#define CIMHOST_CLI_SERVE_H

#include "broker/Broker.h"
#include "cli/Command.h"

#include <iosfwd>

namespace cimhost::cli {

/// Serves until SIGINT or SIGTERM comes. The first line on `err` says where it listens; from then on
/// clients are answered.
/// \throws serve::ListenError
ExitStatus serveUntilSignal(const Serve& command, Broker& broker, std::ostream& err);

} // namespace cimhost::cli

#endif
