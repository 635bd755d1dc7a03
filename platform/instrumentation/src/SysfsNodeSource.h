/// \file
#ifndef TAVRO_SYSFSNODESOURCE_H
#define TAVRO_SYSFSNODESOURCE_H

#include "NodeSource.h"
#include "SysfsClasses.h"

#include <utility>

namespace Tavro {

/// What Linux knows of this machine: an indicator for each LED, and for the lights of each drive slot.
///
/// The tree is read below the directory that the environment variable TAVRO_SYSFS_ROOT names, by default
/// /sys; the nodes' paths begin with /sys whatever the root. A class that the kernel does not have has
/// no nodes. An indicator that vanishes while it is read is left out.
class SysfsNodeSource : public NodeSource
{
public:
    /// \param classes  read in this order
    explicit SysfsNodeSource(std::vector<SysfsClass> classes) : classes_(std::move(classes)) {}

    [[nodiscard]] std::vector<Node> read() const override;

private:
    std::vector<SysfsClass> classes_;
};

} // namespace Tavro

#endif
