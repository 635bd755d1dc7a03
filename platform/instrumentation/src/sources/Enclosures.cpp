#include "SysfsAttributes.h"
#include "SysfsNode.h"
#include "SysfsNodeSource.h"
#include "Words.h"

#include <array>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace Tavro {
namespace {

struct Light
{
    const char* attribute;
    const char* description;
};

constexpr std::array lights = {Light{"fault", "Fault LED"}, Light{"locate", "Locate LED"}};

/// The paths that an enclosure, or a slot of it, has in sysfs.
struct Paths
{
    std::string ofDevice;
    std::string ofClass;

    [[nodiscard]] Paths below(const std::string& name) const
    {
        return {ofDevice + '/' + name, ofClass + '/' + name};
    }
};

/// Such as "Enclosure 0:0:8:0 Slot 3".
std::string describeSlot(const std::string& enclosure, const std::string& slot)
{
    std::string words = inWords(slot);
    // Where the enclosure has no names for them, slots are called by their number alone.
    if (words.find_first_not_of("0123456789") == std::string::npos)
        words = "Slot " + words;
    return "Enclosure " + printable(enclosure) + ' ' + words;
}

void appendSlot(const SysfsDirectory& enclosure, const std::string& slot, const std::string& description,
                const Paths& paths, std::vector<Node>& nodes)
{
    // First: where it is missing because the slot has gone, so are the lights.
    const SysfsAttribute status = enclosure.attribute(slot + "/status");
    for (const Light& light : lights) {
        const SysfsAttribute value = enclosure.attribute(slot + '/' + light.attribute);
        if (value.isAbsent())
            continue;
        const Paths lightPaths = paths.below(light.attribute);
        Node node =
            indicatorNode(description + ' ' + light.description, lightPaths.ofDevice, lightPaths.ofClass);
        node.status = status.isRead() ? slotStatus(status.text) : unknownStatus;
        if (value.isRead())
            if (const std::optional<unsigned int> number = wholeNumber(value.text))
                node.alarmState = lightState(*number);
        nodes.push_back(std::move(node));
    }
}

} // namespace

/// The fault and the locate indicator of each slot, in the order of the enclosures' and the slots' names.
void appendEnclosures(const std::string& place, Sysfs& sysfs, std::vector<Node>& nodes)
{
    const SysfsDirectory enclosures = sysfs.open(place);
    for (const std::string& name : enclosures.names()) {
        const SysfsDirectory enclosure(enclosures, name);
        if (!enclosure.isOpen())
            continue;
        const Paths paths{devicePath(enclosures, place, name), std::string(place).append("/").append(name)};
        for (const std::string& slot : enclosure.directories())
            appendSlot(enclosure, slot, describeSlot(name, slot), paths.below(slot), nodes);
    }
}

} // namespace Tavro
