/// \file
/// A provider module's broker.
#ifndef TAVRO_GLIMMARK_BROKERPOINTER_H
#define TAVRO_GLIMMARK_BROKERPOINTER_H

#include <cmpift.h>

#include <atomic>

namespace Tavro::GlimmarkProvider {

/// A module's broker: written by the module's MI factory functions and read by its operations, on any
/// thread. Null until a broker has loaded the provider.
using BrokerPointer = std::atomic<const CMPIBroker*>;

} // namespace Tavro::GlimmarkProvider

#endif
