#include "cli/Serve.h"

#include "cli/Metrics.h"
#include "cli/Signals.h"
#include "cli/metrics/Exposition.h"
#include "serve/CimBinding.h"
#include "serve/HttpServer.h"

#include <array>
#include <csignal>
#include <cstdlib>
#include <optional>
#include <ostream>
#include <string>

#include <unistd.h>

namespace cimhost::cli {

namespace {

std::string hostName()
{
    std::array<char, 256> name{};
    return gethostname(name.data(), name.size() - 1) == 0 && name[0] != '\0' ? name.data() : "localhost";
}

/// The page that Prometheus asks for, where it is wanted.
serve::Page pageOf(const Serve& command, Broker& broker)
{
    if (!command.metrics)
        return {};
    return {"/metrics", expositionType, [&] { return expositionOf(*command.metrics, broker); }};
}

} // namespace

ExitStatus serveUntilSignal(const Serve& command, Broker& broker, std::ostream& err)
{
    const HeldSignals signals{SIGINT, SIGTERM};
    const serve::CimBinding binding(broker, hostName(), {}, pageOf(command, broker));
    std::optional<serve::HttpServer> server;
    try {
        server.emplace(serve::Endpoint{command.address, command.port}, binding);
    } catch (const serve::ListenError& error) {
        if (!error.isPortTaken())
            throw;
        err << "cimhost: " << error.what() << "; --port chooses another port\n";
        return exitError;
    }
    err << "cimhost: listening on http://" << textOf(server->endpoint())
        << (isEverywhere(server->endpoint()) ? ", on all addresses of this machine" : "")
        << ", for development only: no authentication, no encryption" << std::endl;
    signals.wait();
    err << "cimhost: ending" << std::endl;
    if (!server->finish()) {
        err << "cimhost: a provider has not answered in time" << std::endl;
        std::_Exit(exitError); // ending in order would wait for it
    }
    return exitAnswered;
}

} // namespace cimhost::cli
