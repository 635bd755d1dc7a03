/// \file
/// The floor under the library's cost: routines that make the calls of the library's operations, the same
/// calls of the broker and of the support libraries in the same order with the same arguments, and do nothing
/// else. No record, no map, no line is put together: every text is there before. FloorTest holds the
/// sequences of calls against the library's.
#ifndef BENCH_FLOOR_H
#define BENCH_FLOOR_H

#include "Indicators.h"

#include <cstddef>
#include <string>

#include <cmpift.h>

namespace bench {

/// A request as an operation of the library gets it.
struct FloorRequest
{
    const CMPIBroker* broker;
    const CMPIContext* ctx;
    const CMPIResult* rslt;
    const CMPIObjectPath* ref;
    const Indicators& indicators; ///< those of the inventory
};

using FloorOperation = void (*)(const FloorRequest& request);

/// \param name  that of an operation of testing/Operations.h
/// \return null for one without a floor: those that are asked for nothing there is have none
FloorOperation floorOf(const std::string& name);

/// How many operations have a floor.
std::size_t floorCount();

/// The collection of the indicators alone: reading them from the inventory, without anything of the broker.
void collectOnly(const FloorRequest& request);

/// One trace point with four addresses.
void traceOnly();

} // namespace bench

#endif
