/// \file
/// What the attributes of LEDs and enclosures say, in the inventory's numbers.
#ifndef TAVRO_SYSFSATTRIBUTES_H
#define TAVRO_SYSFSATTRIBUTES_H

#include <optional>
#include <string_view>

namespace Tavro {

/// Raw status codes of a node.
constexpr unsigned int unknownStatus = 0;
constexpr unsigned int wellStatus = 1;

/// Values of the property NodeLexicon::AlarmState.
constexpr unsigned int unknownState = 0;
constexpr unsigned int offState = 1;
constexpr unsigned int steadyState = 2;
constexpr unsigned int alternatingState = 3;

/// The number that an attribute holds, in decimal, before a line end or nothing. Nothing: it holds no
/// number from 0 to 4294967295.
std::optional<unsigned int> wholeNumber(std::string_view text);

/// Off or steady.
/// \param value  the brightness of a LED, or the value of a slot's light: 0 is off
unsigned int lightState(unsigned int value);

/// The word in brackets of a LED's list of triggers, as in "none [timer] heartbeat". Nothing: there is none.
std::optional<std::string_view> activeTrigger(std::string_view list);

/// Whether a LED with that trigger blinks for as long as it has it. Triggers that follow an event, such as
/// an access to a disk, show in the brightness what is at the moment.
bool blinks(std::string_view trigger);

/// The raw status code for the status of an enclosure's slot, a word such as "OK" or "critical" before a line
/// end or nothing. Any word that says neither well nor ill is unknown: "not installed" for one.
unsigned int slotStatus(std::string_view text);

} // namespace Tavro

#endif
