#include "Enclosures.h"

#include "SysfsAttributes.h"
#include "SysfsNode.h"
#include "Words.h"

#include <array>
#include <optional>
#include <string>

namespace Tavro {
namespace {

constexpr const char* enclosureFolder = "/sys/class/enclosure";

struct Light
{
    const char* attribute;
    const char* description;
};

constexpr std::array lights = {Light{"fault", "Fault LED"}, Light{"locate", "Locate LED"}};

/// The places that an enclosure, or a slot of it, has in sysfs.
struct Place
{
    std::string devicePath;
    std::string classPath;

    [[nodiscard]] Place below(const std::string& name) const
    {
        return {devicePath + '/' + name, classPath + '/' + name};
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

void appendSlot(const SysfsDirectory& slot, const std::string& description, const Place& place,
                std::vector<Node>& nodes)
{
    // First: where it is missing because the slot has gone, so are the lights.
    const SysfsAttribute status = slot.attribute("status");
    for (const Light& light : lights) {
        const SysfsAttribute value = slot.attribute(light.attribute);
        if (value.isAbsent())
            continue;
        const Place lightPlace = place.below(light.attribute);
        Node node =
            indicatorNode(description + ' ' + light.description, lightPlace.devicePath, lightPlace.classPath);
        node.status = status.isRead() ? slotStatus(status.text) : unknownStatus;
        if (value.isRead())
            if (const std::optional<unsigned int> number = wholeNumber(value.text))
                node.alarmState = lightState(*number);
        nodes.push_back(std::move(node));
    }
}

} // namespace

void appendEnclosures(const SysfsDirectory& enclosures, std::vector<Node>& nodes)
{
    for (const std::string& name : enclosures.names()) {
        const SysfsDirectory enclosure(enclosures, name);
        if (!enclosure.isOpen())
            continue;
        const Place place{devicePath(enclosures, enclosureFolder, name), enclosureFolder + ('/' + name)};
        for (const std::string& slotName : enclosure.names()) {
            if (!enclosure.hasDirectory(slotName))
                continue;
            const SysfsDirectory slot(enclosure, slotName);
            if (slot.isOpen())
                appendSlot(slot, describeSlot(name, slotName), place.below(slotName), nodes);
        }
    }
}

} // namespace Tavro
