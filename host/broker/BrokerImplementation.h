/// \file
/// What a Broker consists of.
#ifndef CIMHOST_BROKER_BROKERIMPLEMENTATION_H
#define CIMHOST_BROKER_BROKERIMPLEMENTATION_H

#include "broker/Broker.h"
#include "broker/Core.h"
#include "broker/Router.h"

#include <string>
#include <utility>
#include <vector>

namespace cimhost {

class Broker::Implementation
{
public:
    Implementation(Broker& broker, Registration registration, std::vector<std::string> directories,
                   Listeners listeners, const Habits* habits, schema::Classes classes)
        : core(broker, std::move(listeners), habits, std::move(classes)),
          router(core, std::move(registration), std::move(directories))
    {}

    Core core;
    Router router;
};

} // namespace cimhost

#endif
