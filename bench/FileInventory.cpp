// MadeInventory's nodes for the stand-in of the instrumentation library: as the file that it reads.

#include "testing/MadeInventory.h"

#include <cstdlib>
#include <fstream>
#include <stdexcept>

#include <nlohmann/json.hpp>
#include <unistd.h>

namespace {

/// A file of this process's own, gone when the process ends.
class InventoryFile
{
public:
    InventoryFile()
    {
        const int descriptor = ::mkstemp(name.data());
        if (descriptor < 0)
            throw std::runtime_error("cannot make a file " + name);
        ::close(descriptor);
        ::setenv("TAVRO_INVENTORY", name.c_str(), 1);
    }
    ~InventoryFile() { ::unlink(name.c_str()); }
    InventoryFile(const InventoryFile&) = delete;
    InventoryFile& operator=(const InventoryFile&) = delete;

    std::string name = "/tmp/glimmark-bench-XXXXXX";
};

} // namespace

// NOLINTNEXTLINE(performance-unnecessary-value-param): the signature is that of the inventory in memory
void MadeInventory::set(std::vector<Node> nodes)
{
    static const InventoryFile file;
    nlohmann::json list = nlohmann::json::array();
    for (const Node& node : nodes) {
        nlohmann::json entry = {{"kind", node.kind},
                                {"description", node.description},
                                {"path", "/" + node.path},
                                {"status", node.status}};
        if (node.alarmState)
            entry["alarmState"] = *node.alarmState;
        list.push_back(entry);
    }
    std::ofstream(file.name) << nlohmann::json{{"nodes", list}};
}
