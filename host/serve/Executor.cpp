#include "serve/Executor.h"

namespace cimhost::serve {

cim::Answer execute(const RequestMessage& message, Broker& broker)
{
    if (const auto* status = std::get_if<cim::Status>(&message.content))
        return {*status, {}, {}};
    return perform(std::get<OperationRequest>(message.content), broker);
}

} // namespace cimhost::serve
