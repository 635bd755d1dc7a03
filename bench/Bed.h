/// \file
/// Where the library and the floor run: the host's broker, an inventory, and one request for each run.
#ifndef BENCH_BED_H
#define BENCH_BED_H

#include "Floor.h"
#include "Indicators.h"

#include "broker/Broker.h"
#include "testing/Operations.h"

#include <cstddef>
#include <string>
#include <vector>

namespace bench {

/// An operation with what it asks a request's path to be.
struct Task
{
    Operation operation;
    FloorOperation floor;
    cimhost::cim::ObjectPath path;
};

/// Every operation of testing/Operations.h that has a floor.
std::vector<Task> allTasks();

enum class Side
{
    library,
    floor
};

/// One server with its broker, which knows one computer system.
class Bed
{
public:
    Bed();

    /// What the inventory has from now on.
    void setIndicators(std::size_t count);
    [[nodiscard]] std::size_t indicatorCount() const { return indicators.deviceIDs.size(); }

    /// Makes a request with its path, and calls `around` with the handles and a function that runs the
    /// operation. The request ends after that, with all of its objects.
    template <class Around>
    void run(const Task& task, Side side, Around around)
    {
        cimhost::Request request(host);
        CMPIObjectPath* const path = request.path(task.path);
        const RequestHandles handles{host.cmpiBroker(), request.context(), request.result(),
                                     [path](const auto&...) { return path; }};
        const FloorRequest floorRequest{handles.broker, handles.ctx, handles.rslt, path, indicators};
        around(handles, path, [&] {
            if (side == Side::library)
                task.operation.run(handles);
            else
                task.floor(floorRequest);
        });
    }

    /// The floor of collecting the indicators.
    void collectAtFloor() const;

    cimhost::Broker host;

private:
    Indicators indicators;
};

} // namespace bench

#endif
