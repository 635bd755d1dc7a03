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
    std::string address;    ///< IPv4 or IPv6, in numbers
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
    int descriptor; ///< the caller's to close
    Endpoint endpoint;
};

/// \throws ListenError
ListeningSocket listenAt(const Endpoint& endpoint);

/// As in a URL: `127.0.0.1:5988`, `[::1]:5988`.
std::string textOf(const Endpoint& endpoint);

} // namespace cimhost::serve

#endif
