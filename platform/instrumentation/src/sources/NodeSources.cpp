#include "NodeSource.h"

namespace Tavro {

// Each in a file of its own.
NodeReader appendLeds;
NodeReader appendEnclosures;

std::vector<NodeSource> nodeSources()
{
    return {
        {"leds", "/sys/class/leds", appendLeds},
        {"enclosures", "/sys/class/enclosure", appendEnclosures},
    };
}

} // namespace Tavro
