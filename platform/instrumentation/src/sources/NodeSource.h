/// \file
/// Where the nodes of the inventory come from. A source is a row of the table in NodeSources.cpp and a
/// function that reads it, in a file of its own beside it.
#ifndef TAVRO_NODESOURCE_H
#define TAVRO_NODESOURCE_H

#include "Node.h"

#include <string>
#include <vector>

namespace Tavro {

class Sysfs;

/// Appends the nodes of a source as they are now, in the order in which they are reported. A source that this
/// machine does not have has no nodes. One that cannot be read has none either, and says why in one error
/// line in the log. Throws nothing but std::bad_alloc. Any number of threads may read at once. \param place
/// that of its row \param sysfs  opens the directories of the sources in sysfs; the others leave it alone
using NodeReader = void(const std::string& place, Sysfs& sysfs, std::vector<Node>& nodes);

struct NodeSource
{
    std::string name;  ///< what an inventory file calls it; letter case matters
    std::string place; ///< where it is on a running system: "/sys/class/leds"
    NodeReader* appendNodes;
};

/// All sources, in the order in which they are reported.
std::vector<NodeSource> nodeSources();

/// Appends the nodes of these sources, in their order.
void appendNodesOf(const std::vector<NodeSource>& sources, std::vector<Node>& nodes);

/// The nodes of the inventory that the environment variable TAVRO_INVENTORY names, as they are now: "sysfs",
/// or nothing, is all sources of this machine; anything else is the name of an inventory file. Throws nothing
/// but std::bad_alloc.
std::vector<Node> readNodes();

} // namespace Tavro

#endif
