/// \file
/// All function tables that a broker and its objects answer through, as values that can be changed.
#ifndef CIMHOST_BROKER_FUNCTIONTABLES_H
#define CIMHOST_BROKER_FUNCTIONTABLES_H

#include <cmpift.h>

namespace cimhost {

/// One set belongs to one broker; every object that the broker makes points into it.
struct FunctionTables
{
    CMPIBrokerFT broker;
    CMPIBrokerEncFT enc;
    CMPIBrokerExtFT ext;
    CMPIBrokerMemFT mem;
    CMPIContextFT context;
    CMPIResultFT result;
    CMPIStringFT string;
    CMPIArrayFT array;
    CMPIEnumerationFT enumeration;
    CMPIInstanceFT instance;
    CMPIObjectPathFT objectPath;
    CMPIArgsFT args;
    CMPIDateTimeFT dateTime;
    CMPIErrorFT error;
};

} // namespace cimhost

#endif
