/// \file
/// The LED class of sysfs.
#ifndef TAVRO_LEDS_H
#define TAVRO_LEDS_H

#include "Node.h"
#include "SysfsDirectory.h"

#include <vector>

namespace Tavro {

/// Appends an indicator for each LED, in the order of their names.
/// \param leds  the class's directory, open
void appendLeds(const SysfsDirectory& leds, std::vector<Node>& nodes);

} // namespace Tavro

#endif
