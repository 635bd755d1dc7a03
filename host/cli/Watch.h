/// \file
/// The command that shows a class's instances live.
#ifndef CIMHOST_CLI_WATCH_H
#define CIMHOST_CLI_WATCH_H

#include "broker/Broker.h"
#include "cli/Command.h"

#include <iosfwd>

namespace cimhost::cli {

/// Asks again and again until SIGINT, SIGTERM or SIGHUP comes, on a terminal also until q is pressed, and
/// shows what it sees on standard output: on a terminal as a screen that follows its size, else each change
/// as a line with its time.
/// \return exitError if the first answer has an error status, or nobody reads the output any more
/// \throws std::system_error  standard output cannot be written to
ExitStatus watchUntilSignal(const Watch& command, Broker& broker, bool isTerminal, std::ostream& err);

} // namespace cimhost::cli

#endif
