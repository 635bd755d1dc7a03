#include "FileNodeSource.h"

#include "ErrorLine.h"
#include "InventoryReader.h"
#include "ReadFile.h"

#include <cstddef>
#include <utility>

namespace Tavro {
namespace {

constexpr std::size_t mostOfAFile = 64UL * 1024 * 1024; ///< hundreds of thousands of nodes

std::vector<Node> emptyInventory(const std::string& reason)
{
    logError({static_cast<const char*>(__func__), "FileNodeSource.cpp", __LINE__}, reason);
    return {};
}

} // namespace

std::vector<Node> readNodesOfFile(const std::string& file)
{
    try {
        Inventory inventory = readInventory(readFile(file, mostOfAFile));
        appendNodesOf(inventory.sources, inventory.nodes);
        return std::move(inventory.nodes);
    } catch (const ReadFailure& failure) {
        return emptyInventory(file + ": " + failure.what());
    } catch (const InventoryError& error) {
        return emptyInventory(file + ": " + error.what());
    }
}

} // namespace Tavro
