/// \file
/// Alarm devices as Prometheus reads them. The names and labels are an interface: rules and queries of others rely
/// on them.
#ifndef CIMHOST_CLI_METRICS_ALARMDEVICES_H
#define CIMHOST_CLI_METRICS_ALARMDEVICES_H

#include "cim/Model.h"

#include <chrono>
#include <stdexcept>
#include <string>

namespace cimhost::cli {

/// The DMTF's class of what is shown, and those of its properties that are read.
constexpr const char* alarmDeviceClass = "CIM_AlarmDevice";
std::vector<std::string> alarmDeviceProperties();

/// Why an answer is no picture of the alarm devices.
class NoPicture : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// The gauges of each alarm device, and how many there are.
/// \throws NoPicture  the answer has an error status; it has no instance, which is also what a provider answers
/// that cannot read its hardware; one has no DeviceID, or two have the same
std::string alarmDeviceGauges(const cim::Answer& answer);

/// How a collection went.
struct Collection
{
    bool isSuccessful = false;
    std::chrono::duration<double> duration{};
    std::chrono::system_clock::time_point end;
};

std::string collectionGauges(const Collection& collection);

} // namespace cimhost::cli

#endif
