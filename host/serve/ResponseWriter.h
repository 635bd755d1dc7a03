/// \file
/// Response messages of CIM-XML.
#ifndef CIMHOST_SERVE_RESPONSEWRITER_H
#define CIMHOST_SERVE_RESPONSEWRITER_H

#include "schema/Classes.h"
#include "serve/Message.h"
#include "serve/Text.h"

#include <memory>
#include <string>

namespace cimhost::serve {

/// The response to a request, in UTF-8 (DMTF DSP0201). What was found goes as it is written. An answer with an error status becomes an ERROR
/// with the status's code, or CIM_ERR_FAILED for one that CIM lacks; what came before the error is not
/// sent. So does an answer with a value for which CIM-XML has no form. One that is longer than the budget has left
/// becomes CIM_ERR_SERVER_LIMITS_EXCEEDED.
/// \param hostName  for paths that name no host but have to
/// \param classes   tell the origins of properties, where the request asks for them
/// \param budget    of the answers that are being given; null: there is none
Text writeResponse(const RequestMessage& request, Reply reply, const std::string& hostName,
                   const schema::Classes& classes = {}, std::shared_ptr<TextBudget> budget = nullptr);

} // namespace cimhost::serve

#endif
