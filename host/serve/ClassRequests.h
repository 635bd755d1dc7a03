/// \file
/// Questions for declarations of classes (DMTF DSP0200: GetClass, EnumerateClasses, EnumerateClassNames).
#ifndef CIMHOST_SERVE_CLASSREQUESTS_H
#define CIMHOST_SERVE_CLASSREQUESTS_H

#include "broker/Broker.h"
#include "serve/Message.h"

namespace cimhost::serve {

/// Looks the classes up that the broker knows. A class that is registered is in the namespaces of its
/// registration, any other in each. What is wrong with the question is an answer too.
Reply findClasses(const Question& question, const Broker& broker);

} // namespace cimhost::serve

#endif
