/// \file
/// The record of one diagnostic indicator.
#ifndef TAVRO_GLIMMARK_GLIMMARK_H
#define TAVRO_GLIMMARK_GLIMMARK_H

#include <cstdint>
#include <initializer_list>
#include <string>
#include <vector>

namespace Tavro::GlimmarkProvider {

/// All that the library knows about one diagnostic indicator, a copyable value. Accessors are named
/// after the CIM properties that they feed.
///
/// The setters of the three states do not store what they are given: they translate the raw status
/// of a hardware node into the property's value.
///
///     node status   RequestedState   HealthState   OperationalStatus
///     1             2                5             [2, 11]
///     20            2                10            [3, 5]
///     21 to 26      2                10            [3]
///     any other     3                0             [0]
///
/// The values are those of the CIM schema: RequestedState 2 Enabled, 3 Disabled; HealthState 0
/// Unknown, 5 OK, 10 Degraded/Warning; OperationalStatus 0 Unknown, 2 OK, 3 Degraded, 5 Predictive
/// Failure, 11 In Service.
///
/// Every setter returns whether the value is acceptable; only the two texts can fail to be.
class Glimmark
{
public:
    /// Empty texts, zero numbers, an empty list, no alarm.
    Glimmark() = default;

    /// The identifier without leading and trailing blanks; the stored one keeps them.
    [[nodiscard]] std::string getDeviceID() const;
    /// The name without leading and trailing blanks; the stored one keeps them.
    [[nodiscard]] std::string getElementName() const;
    [[nodiscard]] unsigned int getRequestedState() const;
    [[nodiscard]] unsigned int getHealthState() const;
    [[nodiscard]] std::vector<std::uint16_t> getOperationalStatus() const;
    [[nodiscard]] bool getAudibleAlarm() const;
    [[nodiscard]] bool getVisibleAlarm() const;
    [[nodiscard]] bool getMotionAlarm() const;
    [[nodiscard]] std::uint16_t getAlarmState() const;

    /// \return false for an empty identifier, which is stored all the same
    bool setDeviceID(std::string deviceID);
    /// \return false for an empty name, which is stored all the same
    bool setElementName(std::string elementName);
    bool setRequestedState(unsigned int nodeStatus);
    bool setHealthState(unsigned int nodeStatus);
    bool setOperationalStatus(unsigned int nodeStatus);
    bool setAudibleAlarm(bool audibleAlarm);
    bool setVisibleAlarm(bool visibleAlarm);
    bool setMotionAlarm(bool motionAlarm);
    /// Stores 0 (Unknown), 1 (Off), 2 (Steady) or 3 (Alternating) as given, and 0 for any other value.
    bool setAlarmState(std::uint16_t alarmState);

private:
    std::string DeviceID;
    std::string ElementName;
    std::uint16_t RequestedState = 0;
    std::uint16_t HealthState = 0;
    std::initializer_list<std::uint16_t> OperationalStatus; ///< one of a few that live as long as the library
    bool AudibleAlarm = false;
    bool VisibleAlarm = false;
    bool MotionAlarm = false;
    std::uint16_t AlarmState = 0;
};

} // namespace Tavro::GlimmarkProvider

#endif
