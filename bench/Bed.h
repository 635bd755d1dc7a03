/// \file
/// Where the library runs and where tapes of it are replayed: the host's broker, an inventory, and one
/// request for each run.
#ifndef BENCH_BED_H
#define BENCH_BED_H

#include "Recorder.h"
#include "Tape.h"

#include "broker/Broker.h"
#include "testing/Operations.h"

#include <cstddef>
#include <functional>
#include <vector>

namespace bench {

/// An operation with what it asks a request's path to be.
struct Task
{
    Operation operation;
    cimhost::cim::ObjectPath path;
};

/// Every operation of testing/Operations.h.
std::vector<Task> allTasks();

/// One server with its broker, which knows one computer system.
class Bed
{
public:
    Bed();

    /// What the inventory has from now on: an indicator that testing/Operations.h calls "b:/2", the others
    /// with the texts of a large server, in an order that is not that of their identifiers, of every kind of
    /// status.
    void setIndicators(std::size_t count);
    [[nodiscard]] std::size_t indicatorCount() const { return indicators; }

    /// Makes a request with the task's path, and calls `around` with what the request hands over and a
    /// function that runs the operation. The request ends after that, with all of its objects.
    template <class Around>
    void run(const Task& task, Around around)
    {
        joinFreedMemory();
        cimhost::Request request(host);
        CMPIObjectPath* const path = request.path(task.path);
        const RequestHandles handles{host.cmpiBroker(), request.context(), request.result(),
                                     [path](const auto&...) { return path; }};
        around(TapeRequest{handles.broker, handles.ctx, handles.rslt, path},
               [&] { task.operation.run(handles); });
    }

    /// A tape of the task.
    Tape record(const Task& task);
    /// A tape of something that makes no call of the broker.
    Tape record(const std::function<void()>& run);

    cimhost::Broker host;

private:
    /// Lets every run begin with the memory of earlier requests joined to large pieces. The C library does so
    /// when something large is allocated, as the library's list of records is. A tape allocates nothing of
    /// its own: its objects would lie scattered, and take up to twice as long to make.
    static void joinFreedMemory();

    std::size_t indicators = 0;
};

} // namespace bench

#endif
