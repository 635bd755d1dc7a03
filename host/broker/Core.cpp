#include "broker/Core.h"

#include "broker/Habits.h"
#include "broker/ObjectStore.h"
#include "broker/Scope.h"
#include "broker/Tables.h"

#include <algorithm>
#include <shared_mutex>
#include <utility>
#include <vector>

namespace cimhost {

namespace {

/// The brokers of the process, so that a handle can be known without following it.
class LiveCores
{
public:
    static LiveCores& instance()
    {
        static LiveCores& cores = *new LiveCores;
        return cores;
    }

    void add(Core* core)
    {
        const std::unique_lock<std::shared_mutex> lock(mutex_);
        cores_.push_back(core);
    }
    void remove(const Core* core)
    {
        const std::unique_lock<std::shared_mutex> lock(mutex_);
        cores_.erase(std::remove(cores_.begin(), cores_.end(), core), cores_.end());
    }
    Core* find(const void* address)
    {
        const std::shared_lock<std::shared_mutex> lock(mutex_);
        const auto found = std::find(cores_.begin(), cores_.end(), address);
        return found == cores_.end() ? nullptr : *found;
    }

private:
    std::shared_mutex mutex_;
    std::vector<Core*> cores_;
};

} // namespace

Core::Core(Broker& owner, Listeners toldListeners, const Habits* habitsOfThisOne,
           schema::Classes classesKnown)
    : broker(owner),
      tables(servedTables()),
      cmpi{this, &tables.broker, &tables.enc, &tables.ext, &tables.mem},
      habits(habitsOfThisOne),
      classes(std::move(classesKnown)),
      lasting(std::make_unique<ObjectStore>(*this)),
      listeners_(std::move(toldListeners))
{
    takeOn(habits, tables, cmpi);
    LiveCores::instance().add(this);
}

Core::~Core()
{
    LiveCores::instance().remove(this);
}

void Core::tell(const TraceRecord& record)
{
    if (!listeners_.trace)
        return;
    const std::lock_guard<std::mutex> lock(listenersMutex_);
    listeners_.trace(record);
}

void Core::tell(const LogRecord& record)
{
    if (!listeners_.log)
        return;
    const std::lock_guard<std::mutex> lock(listenersMutex_);
    listeners_.log(record);
}

void Core::tellMisuse(const std::string& line)
{
    if (!listeners_.misuse)
        return;
    const std::lock_guard<std::mutex> lock(listenersMutex_);
    listeners_.misuse(line);
}

Core* findCore(const CMPIBroker* broker)
{
    if (broker == nullptr || broker->hdl == nullptr)
        return nullptr;
    Core* const current = Scope::currentCore();
    return current == broker->hdl ? current : LiveCores::instance().find(broker->hdl);
}

} // namespace cimhost
