#include "NodeSource.h"

namespace Tavro {

// Each in a file of its own. The linter reads those together with this one.
// NOLINTBEGIN(readability-redundant-declaration)
NodeReader appendLeds;
NodeReader appendEnclosures;
// NOLINTEND(readability-redundant-declaration)

std::vector<NodeSource> nodeSources()
{
    return {
        {"leds", "/sys/class/leds", appendLeds},
        {"enclosures", "/sys/class/enclosure", appendEnclosures},
    };
}

} // namespace Tavro
