#include "serve/ListeningSocket.h"

#include "cim/Descriptor.h"
#include "cim/Utf8.h"
#include "serve/HeadRules.h"

#include <array>
#include <cerrno>
#include <memory>
#include <system_error>

#include <netdb.h>
#include <netinet/in.h>
#include <sys/socket.h>

namespace cimhost::serve {

namespace {

[[noreturn]] void fail(const Endpoint& endpoint, const std::string& reason, bool isPortTaken = false)
{
    throw ListenError("cannot listen on " + cim::printable(textOf(endpoint)) + ": " + reason, isPortTaken);
}

[[noreturn]] void failWithErrno(const Endpoint& endpoint)
{
    const int error = errno;
    fail(endpoint, std::generic_category().message(error), error == EADDRINUSE);
}

std::uint16_t portOf(const sockaddr_storage& address)
{
    return ntohs(address.ss_family == AF_INET6 ? reinterpret_cast<const sockaddr_in6&>(address).sin6_port
                                               : reinterpret_cast<const sockaddr_in&>(address).sin_port);
}

std::string numbersOf(const sockaddr_storage& address, socklen_t length)
{
    std::array<char, NI_MAXHOST> numbers{};
    return getnameinfo(reinterpret_cast<const sockaddr*>(&address), length, numbers.data(), numbers.size(),
                       nullptr, 0, NI_NUMERICHOST) == 0
               ? numbers.data()
               : "";
}

std::string hostOf(const Endpoint& endpoint)
{
    const bool isIpv6 = endpoint.address.find(':') != std::string::npos;
    return isIpv6 ? '[' + endpoint.address + ']' : endpoint.address;
}

} // namespace

ListeningSocket listenAt(const Endpoint& endpoint)
{
    addrinfo hints{};
    hints.ai_flags = AI_NUMERICHOST | AI_NUMERICSERV | AI_PASSIVE;
    hints.ai_socktype = SOCK_STREAM;
    addrinfo* found = nullptr;
    const int error =
        getaddrinfo(endpoint.address.c_str(), std::to_string(endpoint.port).c_str(), &hints, &found);
    if (error != 0)
        fail(endpoint, "expected an IPv4 or IPv6 address");
    const std::unique_ptr<addrinfo, decltype(&freeaddrinfo)> address(found, &freeaddrinfo);

    cim::Descriptor socket(::socket(address->ai_family, SOCK_STREAM | SOCK_CLOEXEC, 0));
    // A server that was started again need not wait until the connections of the last one are forgotten.
    const int on = 1;
    sockaddr_storage bound{};
    socklen_t length = sizeof bound;
    if (!socket.isOpen() || setsockopt(socket.number(), SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) != 0 ||
        bind(socket.number(), address->ai_addr, address->ai_addrlen) != 0 ||
        listen(socket.number(), SOMAXCONN) != 0 ||
        getsockname(socket.number(), reinterpret_cast<sockaddr*>(&bound), &length) != 0)
        failWithErrno(endpoint);
    return {socket.release(), {numbersOf(bound, length), portOf(bound)}};
}

bool isLoopback(const Endpoint& endpoint)
{
    return isLoopbackHost(hostOf(endpoint));
}

bool isEverywhere(const Endpoint& endpoint)
{
    return endpoint.address == "0.0.0.0" || endpoint.address == "::";
}

std::string textOf(const Endpoint& endpoint)
{
    return hostOf(endpoint) + ':' + std::to_string(endpoint.port);
}

} // namespace cimhost::serve
