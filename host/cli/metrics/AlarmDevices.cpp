#include "cli/metrics/AlarmDevices.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/Output.h"
#include "cli/ValueWords.h"
#include "cli/metrics/Exposition.h"

#include <array>
#include <cstdint>
#include <cstdio>
#include <set>
#include <string_view>
#include <vector>

namespace cimhost::cli {

namespace {

/// What is shown of one.
struct AlarmDevice
{
    std::string id;
    std::string name;
    std::uint64_t alarmState;
    std::uint64_t healthState;
    std::set<std::uint64_t> operationalStatus;
};

/// The value of a property, or of a key of the path where the instance lacks the property.
const cim::Value* valueOf(const cim::Instance& instance, std::string_view name)
{
    const cim::Value* const value = cim::findProperty(instance, name);
    return value != nullptr ? value : cim::findKey(instance.path, name);
}

std::string wordsOf(const cim::Instance& instance, std::string_view name)
{
    const cim::Value* const value = valueOf(instance, name);
    if (value == nullptr || value->items.empty())
        return "";
    const auto* const text = std::get_if<std::string>(&value->items.front());
    return text == nullptr ? "" : validUtf8(*text);
}

std::set<std::uint64_t> numbersOf(const cim::Instance& instance, std::string_view name)
{
    std::set<std::uint64_t> numbers;
    if (const cim::Value* const value = valueOf(instance, name))
        for (const cim::Value::Scalar& item : value->items)
            if (const auto* const number = std::get_if<std::uint64_t>(&item))
                numbers.insert(*number);
    return numbers;
}

/// What is not there is 0, which the DMTF's schema calls unknown.
std::uint64_t numberOf(const cim::Instance& instance, std::string_view name)
{
    const std::set<std::uint64_t> numbers = numbersOf(instance, name);
    return numbers.empty() ? 0 : *numbers.begin();
}

AlarmDevice alarmDeviceOf(const cim::Instance& instance)
{
    return {wordsOf(instance, "DeviceID"), wordsOf(instance, "Name"), numberOf(instance, "AlarmState"),
            numberOf(instance, "HealthState"), numbersOf(instance, "OperationalStatus")};
}

/// Prometheus refuses all of a text that has a series twice.
std::vector<AlarmDevice> alarmDevicesOf(const cim::Answer& answer)
{
    if (answer.status.code != CMPI_RC_OK)
        throw NoPicture(statusLine(answer.status));
    if (answer.instances.empty())
        throw NoPicture("there is no alarm device, or what has them cannot be read");
    std::vector<AlarmDevice> devices;
    std::set<std::string> ids;
    for (const cim::Instance& instance : answer.instances) {
        devices.push_back(alarmDeviceOf(instance));
        const std::string& id = devices.back().id;
        if (id.empty())
            throw NoPicture("an alarm device has no DeviceID");
        if (!ids.insert(id).second)
            throw NoPicture("two alarm devices have the DeviceID \"" + cim::excerpt(id) + '"');
    }
    return devices;
}

std::vector<Label> labelsOf(const AlarmDevice& device)
{
    return {{"id", device.id}, {"name", device.name}};
}

void writeStates(Exposition& exposition, const std::vector<AlarmDevice>& devices,
                 std::uint64_t AlarmDevice::*state)
{
    for (const AlarmDevice& device : devices)
        exposition.gauge(labelsOf(device), std::to_string(device.*state));
}

std::string wordOf(std::uint64_t status)
{
    const std::optional<std::string_view> word = valueWord("OperationalStatus", status);
    return word ? std::string(*word) : std::to_string(status);
}

void writeOperationalStatus(Exposition& exposition, const std::vector<AlarmDevice>& devices)
{
    for (const AlarmDevice& device : devices)
        for (const std::uint64_t status : device.operationalStatus) {
            std::vector<Label> labels = labelsOf(device);
            labels.push_back({"status", wordOf(status)});
            exposition.gauge(labels, "1");
        }
}

std::string secondsText(double seconds, int decimals)
{
    std::array<char, 64> text{};
    std::snprintf(text.data(), text.size(), "%.*f", decimals, seconds);
    return text.data();
}

} // namespace

std::vector<std::string> alarmDeviceProperties()
{
    return {"DeviceID", "Name", "AlarmState", "HealthState", "OperationalStatus"};
}

std::string alarmDeviceGauges(const cim::Answer& answer)
{
    const std::vector<AlarmDevice> devices = alarmDevicesOf(answer);
    Exposition exposition;
    exposition.begin("cim_alarm_device_alarm_state",
                     "What the device shows: 0 unknown, 1 off, 2 steady, 3 alternating.");
    writeStates(exposition, devices, &AlarmDevice::alarmState);
    exposition.begin("cim_alarm_device_health_state",
                     "Health of the part that the device belongs to: 0 unknown, 5 OK, 10 degraded, 15 minor, "
                     "20 major, 25 critical failure, 30 non-recoverable error.");
    writeStates(exposition, devices, &AlarmDevice::healthState);
    exposition.begin("cim_alarm_device_operational_status",
                     "1 for each status that the part has which the device belongs to.");
    writeOperationalStatus(exposition, devices);
    exposition.begin("cim_alarm_devices", "How many alarm devices there are.");
    exposition.gauge({}, std::to_string(devices.size()));
    return exposition.text();
}

std::string collectionGauges(const Collection& collection)
{
    const std::chrono::duration<double> end = collection.end.time_since_epoch();
    Exposition exposition;
    exposition.begin("cim_alarm_device_collection_success",
                     "Whether the alarm devices were collected; if not, none is here.");
    exposition.gauge({}, collection.isSuccessful ? "1" : "0");
    exposition.begin("cim_alarm_device_collection_duration_seconds", "How long collecting them took.");
    exposition.gauge({}, secondsText(collection.duration.count(), 6));
    exposition.begin("cim_alarm_device_collection_timestamp_seconds",
                     "When that ended, in seconds since 1970.");
    exposition.gauge({}, secondsText(end.count(), 3));
    return exposition.text();
}

} // namespace cimhost::cli
