/// \file
/// A request and a response of HTTP, whatever library carries them.
#ifndef CIMHOST_SERVE_HTTP_H
#define CIMHOST_SERVE_HTTP_H

#include "serve/Text.h"

#include <string>
#include <string_view>
#include <vector>

namespace cimhost::serve {

struct HeaderField
{
    std::string name; ///< letter case means nothing
    std::string value;
};

struct HttpRequest
{
    std::string method;
    std::string target;               ///< such as /cimom
    std::string version;              ///< such as HTTP/1.1
    std::vector<HeaderField> headers; ///< a name may stand there several times
    std::string body;
};

struct HttpResponse
{
    unsigned int status = 0;
    std::vector<HeaderField> headers;
    Text body;
};

/// A request that is answered by the rules of HTTP alone.
struct HttpError
{
    unsigned int status;
    std::string message;              ///< goes into the body
    std::vector<HeaderField> headers; ///< besides those of every response
};

/// The value of the first field of that name; null: there is none.
const std::string* findHeader(const HttpRequest& request, std::string_view name);

/// Whether a list such as that of Accept, with wildcards and weights, takes one of the values. A request
/// without such a header takes anything.
bool accepts(const HttpRequest& request, std::string_view header,
             const std::vector<std::string_view>& values);

/// A value without its parameters, as `application/xml` of `application/xml; charset="utf-8"`.
std::string_view withoutParameters(std::string_view value);

/// The parameter of a value, without quotes; empty: there is none.
std::string_view parameterOf(std::string_view value, std::string_view name);

} // namespace cimhost::serve

#endif
