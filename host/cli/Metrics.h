/// \file
/// The command that shows the alarm devices to Prometheus.
#ifndef CIMHOST_CLI_METRICS_H
#define CIMHOST_CLI_METRICS_H

#include "broker/Broker.h"
#include "cli/Command.h"

#include <functional>
#include <iosfwd>
#include <memory>
#include <string>

namespace cimhost::cli {

using StartBroker = std::function<std::unique_ptr<Broker>()>;

/// The whole picture of a broker that serves others too: asked in this process, on this thread. What the provider
/// fails at is a picture without a device.
std::string expositionOf(const cim::ObjectPath& target, Broker& broker);

/// Asks in a process of its own, and writes what it found to `out` or the command's file. Whatever fails on the way
/// there - starting the broker, a provider that answers an error, crashes or takes too long - is a line on `err` and
/// a picture that says so and has no device, so that nobody takes an older one for today's.
/// \return exitAnswered; exitError, where it failed or its file could not be written
ExitStatus writeMetrics(const Metrics& command, const StartBroker& start, std::ostream& out,
                        std::ostream& err);

} // namespace cimhost::cli

#endif
