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

/// Nothing: it has vanished.
std::optional<Node> readLed(const SysfsDirectory& leds, const std::string& place, const std::string& name)
{
    const SysfsDirectory led(leds, name);
    if (led.isAbsent() || led.errorCode() == ENOTDIR)
        return std::nullopt;
    Node node = indicatorNode(describeLed(name), devicePath(leds, place, name), place + '/' + name);
    if (!led.isOpen())
        return node;

    // In this order: where a trigger is missing because the LED has gone, so is the brightness.
    const SysfsAttribute trigger = led.attribute("trigger", longestTriggerList);
    const SysfsAttribute brightness = led.attribute("brightness");
    if (brightness.isAbsent() && !leds.leadsTo(led, name))
        return std::nullopt;
    const std::optional<unsigned int> value =
        brightness.isRead() ? wholeNumber(brightness.text) : std::nullopt;
    if (value) {
        node.status = wellStatus;
        node.alarmState = alarmStateOf(*value, trigger);
    }
    return node;
}

} // namespace

/// An indicator for each LED, in the order of their names.
void appendLeds(const std::string& place, Sysfs& sysfs, std::vector<Node>& nodes)
{
    const SysfsDirectory leds = sysfs.open(place);
    for (const std::string& name : leds.names())
        if (std::optional<Node> node = readLed(leds, place, name))
            nodes.push_back(*std::move(node));
}

} // namespace Tavro
