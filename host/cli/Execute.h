/// \file
/// Carries a command out.
#ifndef CIMHOST_CLI_EXECUTE_H
#define CIMHOST_CLI_EXECUTE_H

#include "broker/Broker.h"
#include "cli/Command.h"

#include <cstddef>
#include <iosfwd>
#include <optional>

namespace cimhost::cli {

/// Asks, draws, serves or watches.
/// \param columns  of the terminal that `out` is; nothing: it is none
/// \return exitAnswered, or exitError after an answer with an error status, which goes to `err`;
/// what such an answer brought is not shown, as brokers do not send it
ExitStatus execute(const Command& command, Broker& broker, std::optional<std::size_t> columns,
                   std::ostream& out, std::ostream& err);

} // namespace cimhost::cli

#endif
