/// \file
/// Where the nodes of the inventory come from.
#ifndef TAVRO_NODESOURCE_H
#define TAVRO_NODESOURCE_H

#include "Node.h"

#include <memory>
#include <vector>

namespace Tavro {

class NodeSource
{
public:
    NodeSource() = default;
    virtual ~NodeSource() = default;
    NodeSource(const NodeSource&) = delete;
    NodeSource& operator=(const NodeSource&) = delete;

    /// All nodes as they are now, in the inventory's order. A source that cannot be read logs why, in
    /// one error line, and has no nodes. Throws nothing but std::bad_alloc.
    [[nodiscard]] virtual std::vector<Node> read() const = 0;
};

/// The source that the environment variable TAVRO_INVENTORY names: "sysfs", or nothing, is what Linux
/// knows of this machine; anything else is the name of an inventory file.
std::unique_ptr<const NodeSource> chooseNodeSource();

} // namespace Tavro

#endif
