/// \file
/// Instances for tests of what is shown.
#ifndef CIMHOST_CLI_TESTS_LAMP_H
#define CIMHOST_CLI_TESTS_LAMP_H

#include "cim/Values.h"

#include <cstdint>
#include <string>

namespace cimhost::cli {

/// An alarm device with these states.
inline cim::Instance lamp(const std::string& id, std::uint64_t health = 5, std::uint64_t alarm = 1)
{
    return {{"",
             "root/cimv2",
             "CIM_Lamp",
             {{"CreationClassName", cim::textValue("CIM_Lamp")}, {"DeviceID", cim::textValue(id)}}},
            {{"DeviceID", cim::textValue(id)},
             {"Name", cim::textValue("L")},
             {"HealthState", cim::unsignedValue(health, CMPI_uint16)},
             {"OperationalStatus", cim::arrayValue(CMPI_uint16, {std::uint64_t{2}})},
             {"AlarmState", cim::unsignedValue(alarm, CMPI_uint16)}}};
}

} // namespace cimhost::cli

#endif
