/// \file
#ifndef CIMHOST_SERVE_LISTENINGSOCKET_H
#define CIMHOST_SERVE_LISTENINGSOCKET_H

#include <cstdint>
#include <stdexcept>
#include <string>

namespace cimhost::serve {

/// Where a server is to be found.
struct Endpoint
{
    std::string address;    ///< IPv4 or IPv6, in numbers; to be listened on also `*`: all that there are
    std::uint16_t port = 0; ///< 0: any that is free
};

/// It cannot be listened there; what() says where and why.
class ListenError : public std::runtime_error
{
public:
    explicit ListenError(const std::string& what, bool isPortTaken = false)
        : std::runtime_error(what),
          isPortTaken_(isPortTaken)
    {}

    /// Whether somebody else listens there, so that another port would do.
    [[nodiscard]] bool isPortTaken() const { return isPortTaken_; }

private:
    bool isPortTaken_;
};

/// A socket that waits for connections, and where it does.
struct ListeningSocket
{
    int descriptor;    ///< the caller's to close
    Endpoint endpoint; ///< with the address in numbers
};

/// \throws ListenError
ListeningSocket listenAt(const Endpoint& endpoint);

/// Whether only this machine can connect to it.
bool isLoopback(const Endpoint& endpoint);

/// Whether it is on all addresses that this machine has, as `0.0.0.0` and `::` are.
bool isEverywhere(const Endpoint& endpoint);

/// As in a URL: `127.0.0.1:5988`, `[::1]:5988`.
std::string textOf(const Endpoint& endpoint);

} // namespace cimhost::serve

#endif
