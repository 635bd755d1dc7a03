/// \file
/// Every read operation of every provider, as one list: for tests of what holds for all of them.
#ifndef TESTS_SUPPORT_OPERATIONS_H
#define TESTS_SUPPORT_OPERATIONS_H

#include <functional>
#include <ostream>
#include <string>
#include <vector>

#include <cmpift.h>

/// What an operation is called with.
struct RequestHandles
{
    const CMPIBroker* broker;
    const CMPIContext* ctx;
    const CMPIResult* rslt;
    /// Makes a path of a class with one key, or with none where its name is empty.
    std::function<CMPIObjectPath*(const std::string& className, const std::string& key,
                                  const std::string& value)>
        path;
};

struct Operation
{
    std::string name; ///< letters, digits and underscores
    std::function<CMPIStatus(const RequestHandles&)> run;
};

void PrintTo(const Operation& operation, std::ostream* stream);

/// The instance operations of the four classes, by every way they have, and the traversals of both
/// associations in both directions. Those that name an indicator name "b:/2".
std::vector<Operation> allOperations();

#endif
