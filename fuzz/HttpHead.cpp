// Heads of HTTP requests: method, target and version in the first line, then a header a line. What is not refused
// names a host of this machine, tells its length in one way and comes of no page.

#include "FuzzTarget.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/HeadRules.h"

#include <algorithm>
#include <sstream>
#include <string>

using namespace cimhost;
using namespace cimhost::serve;

namespace {

HttpRequest requestOf(const std::string& text)
{
    HttpRequest request;
    std::istringstream lines(text);
    std::string line;
    std::getline(lines, line);
    std::istringstream(line) >> request.method >> request.target >> request.version;
    while (std::getline(lines, line)) {
        const std::size_t colon = std::min(line.find(": "), line.size());
        request.headers.push_back({line.substr(0, colon), line.substr(std::min(colon + 2, line.size()))});
    }
    return request;
}

std::ptrdiff_t countOf(const HttpRequest& request, std::string_view name)
{
    return std::count_if(request.headers.begin(), request.headers.end(),
                         [&](const HeaderField& field) { return cim::sameName(field.name, name); });
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const HttpRequest request = requestOf(Fuzz::textOf(data, size));
    for (const bool isLocal : {false, true}) {
        if (const std::optional<HttpError> refusal = refusalOf(request, isLocal)) {
            Fuzz::require(refusal->status >= 400 && refusal->status < 600,
                          "a refusal has a status of errors");
            Fuzz::require(cim::printable(refusal->message) == refusal->message, "it may go to a terminal");
            continue;
        }
        Fuzz::require(countOf(request, "Content-Length") + countOf(request, "Transfer-Encoding") <= 1,
                      "there is one length");
        Fuzz::require(countOf(request, "Origin") == 0, "it comes of no page");
        Fuzz::require(countOf(request, "Host") == 1 ||
                          (countOf(request, "Host") == 0 && request.version == "HTTP/1.0"),
                      "there is one host");
        const std::string* const host = findHeader(request, "Host");
        if (isLocal && host != nullptr)
            Fuzz::require(isLoopbackHost(host->substr(0, host->rfind(':'))) || isLoopbackHost(*host),
                          "it is a host of this machine");
    }
    return 0;
}
