#include "testing/SampleInventories.h"

#include "InventoryReader.h"

#include <fstream>
#include <iterator>

std::vector<MadeInventory::Node> sampleInventory(const std::string& name)
{
    std::ifstream file(std::string(TEST_INVENTORY_DIRECTORY) + "/" + name);
    const std::string json{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    std::vector<MadeInventory::Node> nodes;
    const Tavro::Inventory inventory = Tavro::readInventory(json);
    for (const Tavro::Node& node : inventory.nodes)
        nodes.push_back({node.description, node.path, node.status, node.alarmState, node.kind});
    return nodes;
}
