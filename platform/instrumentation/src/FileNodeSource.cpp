#include "FileNodeSource.h"

#include "ErrorLine.h"
#include "InventoryReader.h"
#include "ReadFile.h"
#include "SysfsNodeSource.h"

#include <cstddef>
#include <iterator>

namespace Tavro {
namespace {

constexpr std::size_t mostOfAFile = 64UL * 1024 * 1024; ///< hundreds of thousands of nodes

std::vector<Node> emptyInventory(const std::string& reason)
{
    logError({static_cast<const char*>(__func__), "FileNodeSource.cpp", __LINE__}, reason);
    return {};
}

} // namespace

std::vector<Node> FileNodeSource::read() const
{
    try {
        Inventory inventory = readInventory(readFile(file_, mostOfAFile));
        if (!inventory.sources.empty()) {
            std::vector<Node> read = SysfsNodeSource(inventory.sources).read();
            inventory.nodes.insert(inventory.nodes.end(), std::make_move_iterator(read.begin()),
                                   std::make_move_iterator(read.end()));
        }
        return std::move(inventory.nodes);
    } catch (const ReadFailure& failure) {
        return emptyInventory(file_ + ": " + failure.what());
    } catch (const InventoryError& error) {
        return emptyInventory(file_ + ": " + error.what());
    }
}

} // namespace Tavro
