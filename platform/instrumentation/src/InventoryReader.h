/// \file
/// The inventory file's format.
#ifndef TAVRO_INVENTORYREADER_H
#define TAVRO_INVENTORYREADER_H

#include "Node.h"
#include "sources/NodeSource.h"

#include <stdexcept>
#include <string>
#include <vector>

namespace Tavro {

/// A text is no inventory; what() names the place and says what was expected there. The place is a line
/// and column where the text is not JSON, and a JSON pointer, such as /nodes/3/status, where it is.
class InventoryError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// What an inventory file says.
struct Inventory
{
    std::vector<Node> nodes;         ///< in their order there
    std::vector<NodeSource> sources; ///< read after the nodes, in this order; none twice
};

/// \throw InventoryError at the first fault
Inventory readInventory(const std::string& json);

} // namespace Tavro

#endif
