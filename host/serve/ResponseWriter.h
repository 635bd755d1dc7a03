/// \file
/// Response messages of CIM-XML.
#ifndef CIMHOST_SERVE_RESPONSEWRITER_H
#define CIMHOST_SERVE_RESPONSEWRITER_H

#include "schema/Classes.h"
#include "serve/Message.h"

#include <string>

namespace cimhost::serve {

/// The response to a request, in UTF-8 (DMTF DSP0201). An answer with an error status becomes an ERROR
/// with the status's code, or CIM_ERR_FAILED for one that CIM lacks; what came before the error is not
/// sent. So does an answer with a value for which CIM-XML has no form.
/// \param hostName  for paths that name no host but have to
/// \param classes   tell the origins of properties, where the request asks for them
std::string writeResponse(const RequestMessage& request, const Reply& reply, const std::string& hostName,
                          const schema::Classes& classes = {});

} // namespace cimhost::serve

#endif
