/// \file
/// Carries requests of HTTP to a CimBinding.
#ifndef CIMHOST_SERVE_HTTPSERVER_H
#define CIMHOST_SERVE_HTTPSERVER_H

#include "serve/CimBinding.h"
#include "serve/ListeningSocket.h"

#include <chrono>
#include <memory>

namespace cimhost::serve {

struct ServerLimits
{
    /// Connections at once, each on a thread of its own. More are closed, or wait until one of them ends.
    unsigned int connections = 64;
    /// How long a connection may be idle.
    std::chrono::seconds idle{30};
    /// How long it may take to send a request, and to receive a response.
    std::chrono::milliseconds transfer{60000};
    /// How long the end of the server waits for requests that are being answered.
    std::chrono::seconds farewell{10};
};

/// A server that runs from its making to its end on threads of its own.
class HttpServer
{
public:
    /// \param binding  outlives this object
    /// \throws ListenError
    HttpServer(const Endpoint& endpoint, const CimBinding& binding, const ServerLimits& limits = {});
    /// Finishes and ends. A provider that is still being asked is waited for, however long it takes.
    ~HttpServer();
    HttpServer(const HttpServer&) = delete;
    HttpServer& operator=(const HttpServer&) = delete;

    /// Takes no more connections, and lets the requests that are there be answered within the time of the limits.
    /// \return whether no provider is being asked any more
    bool finish();

    /// Where it listens, with the port that was found free if any was asked for.
    [[nodiscard]] const Endpoint& endpoint() const;

private:
    class Implementation;
    std::unique_ptr<Implementation> implementation_;
};

} // namespace cimhost::serve

#endif
