/// \file
/// Where the nodes of the inventory come from.
#ifndef TAVRO_NODESOURCE_H
#define TAVRO_NODESOURCE_H

#include "Node.h"

#include <string>
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

    /// What is shown to people for a path of this source.
    [[nodiscard]] virtual std::string displayText(const std::string& path) const = 0;
};

} // namespace Tavro

#endif
