#include "Bed.h"

#include "testing/MadeInventory.h"

#include <cstdlib>
#include <iterator>
#include <stdexcept>
#include <string>
#include <utility>

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

MadeInventory::Node makeNode(std::size_t number)
{
    constexpr unsigned int statuses[] = {1, 20, 21, 0, 2};
    constexpr unsigned int alarmStates = 4;
    const std::string text = std::to_string(number);
    MadeInventory::Node node{"Drive " + text + " Fault LED", "chassis-1/drive-bay-" + text + "/indicator-1"};
    node.status = statuses[number % std::size(statuses)];
    if (number % (alarmStates + 1) != 0)
        node.alarmState = static_cast<unsigned int>(number % (alarmStates + 1)) - 1;
    return node;
}

} // namespace

std::vector<Task> allTasks()
{
    MadeInventory::set({});
    cimhost::Broker host = makeHost();
    std::vector<Task> tasks;
    for (const Operation& operation : allOperations())
        tasks.push_back({operation, pathOf(operation, host)});
    return tasks;
}

Bed::Bed() : host(makeHost())
{
    if (host.enumerateInstanceNames({"", "root/cimv2", "TAVRO_ComputerSystem", {}}).paths.size() != 1)
        throw std::runtime_error("the provider of the computer system does not answer");
}

void Bed::joinFreedMemory()
{
    constexpr std::size_t large = 1 << 20;
    void* volatile memory = std::malloc(large);
    std::free(memory);
}

void Bed::setIndicators(std::size_t count)
{
    std::vector<MadeInventory::Node> nodes;
    nodes.reserve(count);
    for (std::size_t number = 1; number < count; ++number)
        nodes.push_back(makeNode(number));
    nodes.push_back({"b", "2"});
    MadeInventory::set(std::move(nodes));
    indicators = count;
}

Tape Bed::record(const Task& task)
{
    Tape tape;
    run(task, [&](const TapeRequest& request, const auto& operation) {
        tape = bench::record(host, request, operation);
    });
    return tape;
}

Tape Bed::record(const std::function<void()>& run)
{
    return bench::record(host, {}, run);
}

} // namespace bench
