#include "FileNodeSource.h"

#include "InventoryReader.h"
#include "ReadFile.h"

#include <MVLog/MVLogger.h>

#include <cstddef>
#include <cstdlib>

namespace Tavro {
namespace {

constexpr const char* variable = "TAVRO_INVENTORY";
constexpr std::size_t mostBytes = 64UL * 1024 * 1024; ///< hundreds of thousands of nodes
constexpr int errorLevel = 6000;

std::vector<Node> emptyInventory(const std::string& reason)
{
    MVLog::MVLogger::logLevelMessage(static_cast<const char*>(__func__), "FileNodeSource.cpp", __LINE__,
                                     "Mavrel.Instrumentation", errorLevel, nullptr, 0, 0, reason);
    return {};
}

} // namespace

std::vector<Node> FileNodeSource::read() const
{
    const char* const file = std::getenv(variable);
    if (file == nullptr || *file == '\0')
        return emptyInventory(std::string(variable) + " is not set: expected the name of an inventory file");
    try {
        return readInventory(readFile(file, mostBytes));
    } catch (const ReadFailure& failure) {
        return emptyInventory(std::string(file) + ": " + failure.what());
    } catch (const InventoryError& error) {
        return emptyInventory(std::string(file) + ": " + error.what());
    }
}

std::string FileNodeSource::displayText(const std::string& path) const
{
    return path;
}

} // namespace Tavro
