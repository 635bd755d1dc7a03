/// \file
/// Nodes of what lies in sysfs.
#ifndef TAVRO_SYSFSNODE_H
#define TAVRO_SYSFSNODE_H

#include "Node.h"
#include "SysfsDirectory.h"

#include <string>

namespace Tavro {

/// Where the device of a class lies in the tree of devices, such as
/// /sys/devices/platform/leds/leds/red:fault: what its link in the class's directory says.
/// \param directory  the class's
/// \param folder     the path of that directory on a running system, such as /sys/class/leds
std::string devicePath(const SysfsDirectory& directory, const std::string& folder, const std::string& name);

/// A node of the kind diagnostic indicator of which no more is known yet: status and alarm state are 0.
Node indicatorNode(std::string description, std::string devicePath, const std::string& displayPath);

} // namespace Tavro

#endif
