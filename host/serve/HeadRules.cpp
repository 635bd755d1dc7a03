#include "serve/HeadRules.h"

#include "cim/Utf8.h"
#include "cim/Values.h"

#include <algorithm>
#include <string>
#include <vector>

#include <arpa/inet.h>
#include <netinet/in.h>

namespace cimhost::serve {

namespace {

[[noreturn]] void fail(unsigned int status, const std::string& message)
{
    throw HttpError{status, message, {}};
}

/// The values of all fields of that name.
std::vector<std::string_view> valuesOf(const HttpRequest& request, std::string_view name)
{
    std::vector<std::string_view> values;
    for (const HeaderField& field : request.headers)
        if (cim::sameName(field.name, name))
            values.push_back(field.value);
    return values;
}

bool isNumber(std::string_view text)
{
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

bool isHttp10(const HttpRequest& request)
{
    return request.version == "HTTP/1.0";
}

/// A blank before the colon belongs to the name for some and not for others (RFC 9112, 5.1).
void checkNames(const HttpRequest& request)
{
    for (const HeaderField& field : request.headers)
        if (field.name.find_first_of(" \t") != std::string::npos)
            fail(400, "found the header \"" + cim::excerpt(field.name) + "\", expected no blank in its name");
}

/// Where the body ends is told once (RFC 9112, 6.3).
void checkLength(const HttpRequest& request)
{
    const std::vector<std::string_view> lengths = valuesOf(request, "Content-Length");
    const std::vector<std::string_view> encodings = valuesOf(request, "Transfer-Encoding");
    if (lengths.size() > 1)
        fail(400, "found the header Content-Length several times, expected it once");
    if (!lengths.empty() && !isNumber(lengths.front()))
        fail(400, "Content-Length: expected a decimal number");
    if (encodings.empty())
        return;
    if (!lengths.empty())
        fail(400, "found Content-Length and Transfer-Encoding, expected one of them");
    if (isHttp10(request))
        fail(400, "found Transfer-Encoding in a request of HTTP/1.0, expected Content-Length");
    if (encodings.size() > 1 || !cim::sameName(encodings.front(), "chunked"))
        fail(501, "Transfer-Encoding: found \"" + cim::excerpt(encodings.front()) + "\", expected chunked");
}

/// "a" of "a:1", "[::1]" of "[::1]:1"; empty where it is neither with a port nor without.
std::string_view hostOf(std::string_view authority)
{
    const std::size_t end = authority.find(authority.substr(0, 1) == "[" ? ']' : ':');
    if (end == std::string_view::npos)
        return authority;
    const std::string_view host = authority.substr(0, authority[end] == ']' ? end + 1 : end);
    const std::string_view port = authority.substr(host.size());
    return port.empty() || port == ":" || (port.front() == ':' && isNumber(port.substr(1)))
               ? host
               : std::string_view();
}

/// The authority of a target such as http://a:1/cimom, which goes before that of Host; nothing: the target has none.
std::optional<std::string_view> authorityOf(std::string_view target)
{
    const std::size_t scheme = target.find("://");
    if (scheme == std::string_view::npos || target.find('/') != scheme + 1)
        return std::nullopt;
    target.remove_prefix(scheme + 3);
    return target.substr(0, target.find_first_of("/?#"));
}

void checkAuthority(std::string_view authority, bool isLocal)
{
    constexpr std::string_view others = "-._~!$&'()*+,;=%:[]"; // RFC 3986, 3.2.2
    const bool isValid = std::all_of(authority.begin(), authority.end(), [&](char byte) {
        return (byte >= '0' && byte <= '9') || (byte >= 'a' && byte <= 'z') || (byte >= 'A' && byte <= 'Z') ||
               others.find(byte) != std::string_view::npos;
    });
    if (!isValid)
        fail(400, "Host: found \"" + cim::excerpt(authority) + "\", expected the name or address of a host");
    if (isLocal && !isLoopbackHost(hostOf(authority)))
        fail(421, "Host: found \"" + cim::excerpt(authority) +
                      "\", expected localhost or a loopback address, which is all that is listened on");
}

/// Which machine is meant (RFC 9112, 3.2); clients of HTTP/1.0 need not say it.
void checkHost(const HttpRequest& request, bool isLocal)
{
    const std::vector<std::string_view> hosts = valuesOf(request, "Host");
    if (hosts.size() > 1)
        fail(400, "found the header Host several times, expected it once");
    if (hosts.empty() && !isHttp10(request))
        fail(400, "expected the header Host");
    for (const std::string_view host : hosts)
        checkAuthority(host, isLocal);
    if (const std::optional<std::string_view> authority = authorityOf(request.target))
        checkAuthority(*authority, isLocal);
}

/// Browsers say where a page comes from whose script asks; CIM clients are no pages.
void checkOrigin(const HttpRequest& request)
{
    if (!valuesOf(request, "Origin").empty())
        fail(403, "found the header Origin, expected none: pages in browsers are not answered");
}

} // namespace

bool isLoopbackHost(std::string_view host)
{
    if (cim::sameName(host, "localhost") || cim::sameName(host, "localhost."))
        return true;
    const bool isBracketed = host.size() > 2 && host.front() == '[' && host.back() == ']';
    const std::string address(isBracketed ? host.substr(1, host.size() - 2) : host);
    in_addr four{};
    in6_addr six{};
    if (!isBracketed)
        return inet_pton(AF_INET, address.c_str(), &four) == 1 &&
               (ntohl(four.s_addr) >> 24U) == IN_LOOPBACKNET;
    return inet_pton(AF_INET6, address.c_str(), &six) == 1 &&
           (IN6_IS_ADDR_LOOPBACK(&six) || (IN6_IS_ADDR_V4MAPPED(&six) && six.s6_addr[12] == IN_LOOPBACKNET));
}

std::optional<HttpError> refusalOf(const HttpRequest& request, bool isLocal)
{
    try {
        checkNames(request);
        checkLength(request);
        checkHost(request, isLocal);
        checkOrigin(request);
        return std::nullopt;
    } catch (const HttpError& refusal) {
        return refusal;
    }
}

} // namespace cimhost::serve
