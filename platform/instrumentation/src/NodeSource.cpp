#include "NodeSource.h"

#include "FileNodeSource.h"
#include "SysfsNodeSource.h"

#include <cstdlib>
#include <string>

namespace Tavro {

std::unique_ptr<const NodeSource> chooseNodeSource()
{
    const char* const variable = std::getenv("TAVRO_INVENTORY");
    const std::string inventory = variable == nullptr ? "" : variable;
    if (inventory.empty() || inventory == "sysfs")
        return std::make_unique<SysfsNodeSource>(allSysfsClasses());
    return std::make_unique<FileNodeSource>(inventory);
}

} // namespace Tavro
