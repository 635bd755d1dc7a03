/// \file
/// What the services of a broker find behind its CMPIBroker.
#ifndef CIMHOST_BROKER_CORE_H
#define CIMHOST_BROKER_CORE_H

#include "broker/Broker.h"
#include "broker/FunctionTables.h"
#include "schema/Classes.h"

#include <memory>
#include <mutex>
#include <string>

namespace cimhost {

class ObjectStore;

struct Core
{
    Core(Broker& owner, Listeners toldListeners, const Habits* habitsOfThisOne, schema::Classes classesKnown);
    ~Core();
    Core(const Core&) = delete;
    Core& operator=(const Core&) = delete;

    /// Tells a listener, one at a time.
    void tell(const TraceRecord& record);
    void tell(const LogRecord& record);
    void tellMisuse(const std::string& line);

    Broker& broker; ///< where up-calls go
    FunctionTables tables;
    CMPIBroker cmpi;      ///< its handle is this Core
    const Habits* habits; ///< null: those of this broker alone
    const schema::Classes classes;
    /// Objects made outside of any request, and clones: they live until released or until the broker
    /// goes. Guarded by `lastingMutex`.
    std::unique_ptr<ObjectStore> lasting;
    std::mutex lastingMutex;

private:
    Listeners listeners_;
    std::mutex listenersMutex_;
};

/// The Core behind a broker that a provider passed; null when there is none (any more).
Core* findCore(const CMPIBroker* broker);

} // namespace cimhost

#endif
