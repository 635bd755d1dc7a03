#include "broker/Tables.h"

namespace cimhost {

FunctionTables servedTables()
{
    return {brokerServices(),      encapsulationServices(), osServices(),         memoryServices(),
            contextServices(),     resultServices(),        stringServices(),     arrayServices(),
            enumerationServices(), instanceServices(),      objectPathServices(), argsServices(),
            dateTimeServices(),    errorServices()};
}

} // namespace cimhost
