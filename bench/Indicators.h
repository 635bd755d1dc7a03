/// \file
/// The indicators that the library is measured with, and what the floor knows of them beforehand.
#ifndef BENCH_INDICATORS_H
#define BENCH_INDICATORS_H

#include "testing/MadeInventory.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace bench {

/// Nodes of the inventory: one that testing/Operations.h calls "b:/2", the others with the texts of a
/// large server, in an order that is not that of their identifiers, of every kind of status.
std::vector<MadeInventory::Node> makeNodes(std::size_t count);

/// What an indicator's instance is made of.
struct Indicator
{
    std::string deviceID;
    std::string elementName;
    std::uint16_t healthState;
    std::vector<std::uint16_t> operationalStatus;
    std::uint16_t alarmState;
};

/// The answers to be given about the nodes, worked out before anything is measured.
struct Indicators
{
    explicit Indicators(const std::vector<MadeInventory::Node>& nodes);

    std::vector<std::string> deviceIDs; ///< in the inventory's order
    std::vector<Indicator> sorted;      ///< in the order of their identifiers
};

} // namespace bench

#endif
