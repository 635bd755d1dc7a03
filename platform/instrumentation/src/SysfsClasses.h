/// \file
/// The classes of devices in sysfs that have indicators, by the names that an inventory file calls them.
#ifndef TAVRO_SYSFSCLASSES_H
#define TAVRO_SYSFSCLASSES_H

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Tavro {

enum class SysfsClass
{
    Leds,
    Enclosures
};

/// In the order in which they are reported.
std::vector<SysfsClass> allSysfsClasses();

/// "leds" or "enclosures"; letter case matters.
std::optional<SysfsClass> findSysfsClass(std::string_view name);

/// Where sysfs keeps its devices, relative to the root: "class/leds".
const char* folderOf(SysfsClass sysfsClass);

/// All names, quoted and separated by commas.
std::string listSysfsClasses();

} // namespace Tavro

#endif
