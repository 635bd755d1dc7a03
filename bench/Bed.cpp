#include "Bed.h"

#include <cstdlib>
#include <stdexcept>

namespace cim = cimhost::cim;

namespace bench {

namespace {

cimhost::Broker makeHost()
{
    ::setenv("TAVRO_COMPUTER_SYSTEMS", "one", 1);
    return {cimhost::readRegistrationFile(BENCH_COMPUTER_SYSTEM_REGISTRATION), {BENCH_PROVIDER_DIRECTORY}};
}

/// The path that the operation asks for: runs it once, on an empty inventory.
cim::ObjectPath pathOf(const Operation& operation, cimhost::Broker& host)
{
    cim::ObjectPath path;
    cimhost::Request request(host);
    const auto makePath = [&](const cim::ObjectPath& wanted) {
        path = wanted;
        path.nameSpace = "root/cimv2";
        return request.path(path);
    };
    operation.run({host.cmpiBroker(), request.context(), request.result(), makePath});
    return path;
}

} // namespace

std::vector<Task> allTasks()
{
    MadeInventory::set({});
    cimhost::Broker host = makeHost();
    std::vector<Task> tasks;
    for (const Operation& operation : allOperations()) {
        if (const FloorOperation floor = floorOf(operation.name))
            tasks.push_back({operation, floor, pathOf(operation, host)});
    }
    if (tasks.size() != floorCount())
        throw std::logic_error("a floor is that of no operation");
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
