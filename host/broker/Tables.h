/// \file
/// The services of the broker, one function for each slot. None of them goes through a table itself,
/// so that a layer that replaces slots sees the provider's calls only.
#ifndef CIMHOST_BROKER_TABLES_H
#define CIMHOST_BROKER_TABLES_H

#include "broker/FunctionTables.h"

namespace cimhost {

/// What a broker reports as its version and that of all its tables.
constexpr CMPIVersion servedVersion = 200;

CMPIBrokerFT brokerServices();
CMPIBrokerEncFT encapsulationServices();
CMPIBrokerExtFT osServices();
CMPIBrokerMemFT memoryServices();
CMPIContextFT contextServices();
CMPIResultFT resultServices();
CMPIStringFT stringServices();
CMPIArrayFT arrayServices();
CMPIEnumerationFT enumerationServices();
CMPIInstanceFT instanceServices();
CMPIObjectPathFT objectPathServices();
CMPIArgsFT argsServices();
CMPIDateTimeFT dateTimeServices();
CMPIErrorFT errorServices();

/// All of them.
FunctionTables servedTables();

} // namespace cimhost

#endif
