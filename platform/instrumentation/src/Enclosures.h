/// \file
/// The class of drive enclosures of sysfs.
#ifndef TAVRO_ENCLOSURES_H
#define TAVRO_ENCLOSURES_H

#include "Node.h"
#include "SysfsDirectory.h"

#include <vector>

namespace Tavro {

/// Appends the fault and the locate indicator of each slot, in the order of the enclosures' and the
/// slots' names.
/// \param enclosures  the class's directory, open
void appendEnclosures(const SysfsDirectory& enclosures, std::vector<Node>& nodes);

} // namespace Tavro

#endif
