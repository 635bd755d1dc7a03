#include "cli/Serve.h"

#include "serve/CimBinding.h"
#include "serve/HttpServer.h"

#include <array>
#include <csignal>
#include <ostream>
#include <string>

#include <unistd.h>

namespace cimhost::cli {

namespace {

/// Keeps the signals that end the server from this thread and those that it starts, to be waited for.
class EndSignals
{
public:
    EndSignals()
    {
        sigemptyset(&signals_);
        sigaddset(&signals_, SIGINT);
        sigaddset(&signals_, SIGTERM);
        pthread_sigmask(SIG_BLOCK, &signals_, &before_);
    }
    ~EndSignals() { pthread_sigmask(SIG_SETMASK, &before_, nullptr); }
    EndSignals(const EndSignals&) = delete;
    EndSignals& operator=(const EndSignals&) = delete;

    void wait() const
    {
        int signal = 0;
        sigwait(&signals_, &signal);
    }

private:
    sigset_t signals_{};
    sigset_t before_{};
};

std::string hostName()
{
    std::array<char, 256> name{};
    return gethostname(name.data(), name.size() - 1) == 0 && name[0] != '\0' ? name.data() : "localhost";
}

} // namespace

ExitStatus serveUntilSignal(const Serve& command, Broker& broker, std::ostream& err)
{
    const EndSignals signals;
    const serve::CimBinding binding(broker, hostName());
    const serve::HttpServer server({command.address, command.port}, binding);
    err << "cimhost: listening on http://" << textOf(server.endpoint())
        << ", for development only: no authentication, no encryption" << std::endl;
    signals.wait();
    err << "cimhost: ending" << std::endl;
    return exitAnswered;
}

} // namespace cimhost::cli
