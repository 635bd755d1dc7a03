/// \file
/// Request messages out of their bytes. Knows nothing of HTTP and of no broker: any bytes may be read.
#ifndef CIMHOST_SERVE_REQUESTREADER_H
#define CIMHOST_SERVE_REQUESTREADER_H

#include "serve/Fault.h"
#include "serve/Message.h"
#include "serve/Xml.h"

#include <string_view>

namespace cimhost::serve {

/// Reads a message with one operation request (DMTF DSP0201). What is wrong with the operation itself
/// (one that is not served, a parameter that is missing, repeated, unknown or of the wrong type) is the
/// message's content, since it is answered in a response.
/// \throws RequestError  the bytes are no message, or none that is understood
RequestMessage readRequest(std::string_view bytes, const XmlLimits& limits = {});

} // namespace cimhost::serve

#endif
