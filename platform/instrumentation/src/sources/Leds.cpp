#include "LedName.h"
#include "SysfsAttributes.h"
#include "SysfsNode.h"
#include "SysfsNodeSource.h"

#include <cerrno>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace Tavro {
namespace {

/// The list of triggers has an entry for each processor, and so can be longer than a page.
constexpr std::size_t longestTriggerList = 16 * SysfsDirectory::pageSize;

unsigned int alarmStateOf(unsigned int brightness, const SysfsAttribute& trigger)
{
    if (!trigger.isRead())
        return trigger.isAbsent() ? lightState(brightness) : unknownState;
    const std::optional<std::string_view> active = activeTrigger(trigger.text);
    if (!active)
        return unknownState;
    return blinks(*active) ? alternatingState : lightState(brightness);
}

struct LedAttributes
{
    SysfsAttribute trigger;
    SysfsAttribute brightness;
};

/// In this order: where a trigger is missing because the LED has gone, so is the brightness.
/// \param led  what leads from the directory to the LED's attributes
LedAttributes readAttributes(const SysfsDirectory& directory, const std::string& led)
{
    LedAttributes attributes;
    attributes.trigger = directory.attribute(led + "trigger", longestTriggerList);
    attributes.brightness = directory.attribute(led + "brightness");
    return attributes;
}

/// Reads the attributes of an LED that lacks some. Nothing: it has vanished.
std::optional<LedAttributes> readAttributesThatAreThere(const SysfsDirectory& leds, const std::string& name)
{
    const SysfsDirectory led(leds, name);
    if (led.isAbsent() || led.errorCode() == ENOTDIR)
        return std::nullopt;
    LedAttributes attributes = readAttributes(led, "");
    if (attributes.brightness.isAbsent() && !leds.leadsTo(led, name))
        return std::nullopt;
    return attributes;
}

/// Nothing: it has vanished.
std::optional<Node> readLed(const SysfsDirectory& leds, const std::string& place, const std::string& name)
{
    // By their names, without opening the LED's directory, which is two calls of the kernel more for each LED.
    std::optional<LedAttributes> led = readAttributes(leds, name + '/');
    if (!led->trigger.isRead() || !led->brightness.isRead())
        led = readAttributesThatAreThere(leds, name);
    if (!led)
        return std::nullopt;
    Node node = indicatorNode(describeLed(name), devicePath(leds, place, name), place + '/' + name);
    const std::optional<unsigned int> value =
        led->brightness.isRead() ? wholeNumber(led->brightness.text) : std::nullopt;
    if (value) {
        node.status = wellStatus;
        node.alarmState = alarmStateOf(*value, led->trigger);
    }
    return node;
}

} // namespace

/// An indicator for each LED, in the order of their names.
void appendLeds(const std::string& place, Sysfs& sysfs, std::vector<Node>& nodes)
{
    const SysfsDirectory leds = sysfs.open(place);
    const std::vector<std::string> names = leds.names();
    nodes.reserve(nodes.size() + names.size());
    for (const std::string& name : names)
        if (std::optional<Node> node = readLed(leds, place, name))
            nodes.push_back(*std::move(node));
}

} // namespace Tavro
