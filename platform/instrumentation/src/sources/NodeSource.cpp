#include "NodeSource.h"

#include "FileNodeSource.h"
#include "SysfsNodeSource.h"

#include <cstdlib>

namespace Tavro {

void appendNodesOf(const std::vector<NodeSource>& sources, std::vector<Node>& nodes)
{
    Sysfs sysfs;
    for (const NodeSource& source : sources)
        source.appendNodes(source.place, sysfs, nodes);
}

std::vector<Node> readNodes()
{
    const char* const variable = secure_getenv("TAVRO_INVENTORY");
    const std::string inventory = variable == nullptr ? "" : variable;
    if (!inventory.empty() && inventory != "sysfs")
        return readNodesOfFile(inventory);
    std::vector<Node> nodes;
    appendNodesOf(nodeSources(), nodes);
    return nodes;
}

} // namespace Tavro
