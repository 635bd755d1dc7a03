/// \file
#ifndef TAVRO_SYSFSNODESOURCE_H
#define TAVRO_SYSFSNODESOURCE_H

#include "SysfsDirectory.h"

#include <optional>
#include <string>

namespace Tavro {

/// What the sources in sysfs share while they are read. The tree is read below the directory that the
/// environment variable TAVRO_SYSFS_ROOT names, by default /sys; the nodes' paths begin with /sys whatever
/// the root.
class Sysfs
{
public:
    /// Opens a directory. One that the kernel does not have is just not open; one that cannot be opened for
    /// another reason is told in an error line in the log, and so is, once, a root that cannot.
    /// \param place  where it is on a running system: "/sys/class/leds"
    SysfsDirectory open(const std::string& place);

private:
    std::optional<SysfsDirectory> root_; ///< once it was asked for
};

} // namespace Tavro

#endif
