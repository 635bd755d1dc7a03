/// \file
/// What the head of a request of HTTP has to be before anything is answered (RFC 9112), and who may ask.
#ifndef CIMHOST_SERVE_HEADRULES_H
#define CIMHOST_SERVE_HEADRULES_H

#include "serve/Http.h"

#include <optional>
#include <string_view>

namespace cimhost::serve {

/// Whether a host is this machine by its name or address alone, whatever a name service says: localhost and the
/// loopback addresses.
/// \param host  as in a URL, IPv6 in brackets
bool isLoopbackHost(std::string_view host);

/// The refusal of a request by its head; nothing: its body may be read. What is refused is what two readers could
/// take for different requests, and what a page in a browser sends. The connection is to be closed.
/// \param isLocal  whether the server listens on a loopback address: its clients then have to call it by one, so
/// that a page whose name leads there by a lie of its name service is refused
std::optional<HttpError> refusalOf(const HttpRequest& request, bool isLocal);

} // namespace cimhost::serve

#endif
