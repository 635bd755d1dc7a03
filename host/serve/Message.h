/// \file
/// A request message of CIM-XML, as far as it is understood.
#ifndef CIMHOST_SERVE_MESSAGE_H
#define CIMHOST_SERVE_MESSAGE_H

#include "broker/OperationRequest.h"
#include "cim/Model.h"

#include <string>
#include <variant>

namespace cimhost::serve {

struct RequestMessage
{
    std::string id;              ///< the client's own; the response bears the same
    std::string protocolVersion; ///< such as "1.0"
    std::string method;          ///< as the client wrote it
    bool isIntrinsic = true;     ///< one of CIM's own operations; otherwise a method of a class
    std::string nameSpace;       ///< such as root/cimv2
    /// What is asked, or what is wrong with the question.
    std::variant<OperationRequest, cim::Status> content;
};

} // namespace cimhost::serve

#endif
