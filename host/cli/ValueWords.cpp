#include "cli/ValueWords.h"

#include "cim/Values.h"

#include <algorithm>
#include <array>

namespace cimhost::cli {

namespace {

struct ValueWord
{
    std::string_view property;
    std::uint64_t number;
    std::string_view word;
};

constexpr std::array valueWords{
    // CIM_ManagedSystemElement
    ValueWord{"HealthState", 0, "Unknown"},
    ValueWord{"HealthState", 5, "OK"},
    ValueWord{"HealthState", 10, "Degraded/Warning"},
    ValueWord{"HealthState", 15, "Minor failure"},
    ValueWord{"HealthState", 20, "Major failure"},
    ValueWord{"HealthState", 25, "Critical failure"},
    ValueWord{"HealthState", 30, "Non-recoverable error"},

    ValueWord{"OperationalStatus", 0, "Unknown"},
    ValueWord{"OperationalStatus", 1, "Other"},
    ValueWord{"OperationalStatus", 2, "OK"},
    ValueWord{"OperationalStatus", 3, "Degraded"},
    ValueWord{"OperationalStatus", 4, "Stressed"},
    ValueWord{"OperationalStatus", 5, "Predictive Failure"},
    ValueWord{"OperationalStatus", 6, "Error"},
    ValueWord{"OperationalStatus", 7, "Non-Recoverable Error"},
    ValueWord{"OperationalStatus", 8, "Starting"},
    ValueWord{"OperationalStatus", 9, "Stopping"},
    ValueWord{"OperationalStatus", 10, "Stopped"},
    ValueWord{"OperationalStatus", 11, "In Service"},
    ValueWord{"OperationalStatus", 12, "No Contact"},
    ValueWord{"OperationalStatus", 13, "Lost Communication"},
    ValueWord{"OperationalStatus", 14, "Aborted"},
    ValueWord{"OperationalStatus", 15, "Dormant"},
    ValueWord{"OperationalStatus", 16, "Supporting Entity in Error"},
    ValueWord{"OperationalStatus", 17, "Completed"},
    ValueWord{"OperationalStatus", 18, "Power Mode"},
    ValueWord{"OperationalStatus", 19, "Relocating"},

    ValueWord{"PrimaryStatus", 0, "Unknown"},
    ValueWord{"PrimaryStatus", 1, "OK"},
    ValueWord{"PrimaryStatus", 2, "Degraded"},
    ValueWord{"PrimaryStatus", 3, "Error"},

    // CIM_EnabledLogicalElement
    ValueWord{"EnabledState", 0, "Unknown"},
    ValueWord{"EnabledState", 1, "Other"},
    ValueWord{"EnabledState", 2, "Enabled"},
    ValueWord{"EnabledState", 3, "Disabled"},
    ValueWord{"EnabledState", 4, "Shutting Down"},
    ValueWord{"EnabledState", 5, "Not Applicable"},
    ValueWord{"EnabledState", 6, "Enabled but Offline"},
    ValueWord{"EnabledState", 7, "In Test"},
    ValueWord{"EnabledState", 8, "Deferred"},
    ValueWord{"EnabledState", 9, "Quiesce"},
    ValueWord{"EnabledState", 10, "Starting"},

    ValueWord{"RequestedState", 0, "Unknown"},
    ValueWord{"RequestedState", 2, "Enabled"},
    ValueWord{"RequestedState", 3, "Disabled"},
    ValueWord{"RequestedState", 4, "Shut Down"},
    ValueWord{"RequestedState", 5, "No Change"},
    ValueWord{"RequestedState", 6, "Offline"},
    ValueWord{"RequestedState", 7, "Test"},
    ValueWord{"RequestedState", 8, "Deferred"},
    ValueWord{"RequestedState", 9, "Quiesce"},
    ValueWord{"RequestedState", 10, "Reboot"},
    ValueWord{"RequestedState", 11, "Reset"},
    ValueWord{"RequestedState", 12, "Not Applicable"},

    ValueWord{"EnabledDefault", 2, "Enabled"},
    ValueWord{"EnabledDefault", 3, "Disabled"},
    ValueWord{"EnabledDefault", 5, "Not Applicable"},
    ValueWord{"EnabledDefault", 6, "Enabled but Offline"},
    ValueWord{"EnabledDefault", 7, "No Default"},
    ValueWord{"EnabledDefault", 9, "Quiesce"},

    // CIM_AlarmDevice and its capabilities
    ValueWord{"AlarmState", 0, "Unknown"},
    ValueWord{"AlarmState", 1, "Off"},
    ValueWord{"AlarmState", 2, "Steady"},
    ValueWord{"AlarmState", 3, "Alternating"},

    ValueWord{"RequestedAlarmStatesSupported", 1, "Off"},
    ValueWord{"RequestedAlarmStatesSupported", 2, "Steady"},
    ValueWord{"RequestedAlarmStatesSupported", 3, "Alternating"},

    // CIM_ComputerSystem
    ValueWord{"Dedicated", 0, "Not Dedicated"},
    ValueWord{"Dedicated", 1, "Unknown"},
    ValueWord{"Dedicated", 2, "Other"},
    ValueWord{"Dedicated", 3, "Storage"},
    ValueWord{"Dedicated", 4, "Router"},
    ValueWord{"Dedicated", 5, "Switch"},
    ValueWord{"Dedicated", 6, "Layer 3 Switch"},
    ValueWord{"Dedicated", 7, "Central Office Switch"},
    ValueWord{"Dedicated", 8, "Hub"},
    ValueWord{"Dedicated", 9, "Access Server"},
    ValueWord{"Dedicated", 10, "Firewall"},
    ValueWord{"Dedicated", 11, "Print"},
    ValueWord{"Dedicated", 12, "I/O"},
    ValueWord{"Dedicated", 13, "Web Caching"},
    ValueWord{"Dedicated", 14, "Management"},
    ValueWord{"Dedicated", 15, "Block Server"},
    ValueWord{"Dedicated", 16, "File Server"},
    ValueWord{"Dedicated", 17, "Mobile User Device"},
    ValueWord{"Dedicated", 18, "Repeater"},
    ValueWord{"Dedicated", 19, "Bridge/Extender"},
    ValueWord{"Dedicated", 20, "Gateway"},
};

} // namespace

std::optional<std::string_view> valueWord(std::string_view property, std::uint64_t number)
{
    const auto* found = std::find_if(valueWords.begin(), valueWords.end(), [&](const ValueWord& entry) {
        return entry.number == number && cim::sameName(entry.property, property);
    });
    return found == valueWords.end() ? std::nullopt : std::optional(found->word);
}

} // namespace cimhost::cli
