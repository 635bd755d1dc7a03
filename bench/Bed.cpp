#include "Bed.h"

#include <cstdlib>

namespace cim = cimhost::cim;

namespace bench {

namespace {

cimhost::Broker makeHost()
{
    ::setenv("TAVRO_COMPUTER_SYSTEMS", "alpha", 1);
    return {cimhost::readRegistrationFile(BENCH_COMPUTER_SYSTEM_REGISTRATION), {BENCH_PROVIDER_DIRECTORY}};
}

/// What the operation makes of a path: runs it once, on an empty inventory.
cim::ObjectPath pathOf(const Operation& operation, cimhost::Broker& host)
{
    cim::ObjectPath asked{"", "root/cimv2", "", {}};
    cimhost::Request request(host);
    const auto makePath = [&](const std::string& className, const std::string& key,
                              const std::string& value) {
        asked.className = className;
        if (!key.empty())
            asked.keys.push_back({key, {CMPI_string, false, {value}}});
        return request.path(asked);
    };
    operation.run({host.cmpiBroker(), request.context(), request.result(), makePath});
    return asked;
}

} // namespace

std::vector<Task> allTasks()
{
    MadeInventory::set({});
    cimhost::Broker host = makeHost();
    std::vector<Task> tasks;
    for (const Operation& operation : allOperations())
        tasks.push_back({operation, floorOf(operation.name), pathOf(operation, host)});
    return tasks;
}

void Bed::collectAtFloor() const
{
    collectOnly({nullptr, nullptr, nullptr, nullptr, indicators});
}

Bed::Bed() : host(makeHost()), indicators({}) {}

void Bed::setIndicators(std::size_t count)
{
    std::vector<MadeInventory::Node> nodes = makeNodes(count);
    indicators = Indicators(nodes);
    MadeInventory::set(std::move(nodes));
}

} // namespace bench
