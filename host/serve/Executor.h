/// \file
#ifndef CIMHOST_SERVE_EXECUTOR_H
#define CIMHOST_SERVE_EXECUTOR_H

#include "broker/Broker.h"
#include "serve/Enumerations.h"
#include "serve/Message.h"

namespace cimhost::serve {

/// What the broker answers; what is wrong with the question is an answer too.
Reply execute(const RequestMessage& message, Broker& broker, Enumerations& enumerations);

} // namespace cimhost::serve

#endif
