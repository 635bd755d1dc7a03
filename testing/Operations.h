/// \file
/// Every operation of every provider, as one list: for tests of what holds for all of them.
#ifndef TESTING_OPERATIONS_H
#define TESTING_OPERATIONS_H

#include "broker/Broker.h"
#include "cim/Model.h"

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
    /// Makes the request's path of one without a namespace.
    std::function<CMPIObjectPath*(const cimhost::cim::ObjectPath&)> path;
};

struct Operation
{
    std::string name; ///< letters, digits and underscores
    std::function<CMPIStatus(const RequestHandles&)> run;
};

void PrintTo(const Operation& operation, std::ostream* stream);

/// How the four providers are made: the six factory functions, or others in their place.
struct EntryPoints
{
    using CreateInstanceMI = CMPIInstanceMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
    using CreateAssociationMI = CMPIAssociationMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

    CreateInstanceMI glimmarks;
    CreateInstanceMI capabilities;
    CreateInstanceMI elementCapabilities;
    CreateAssociationMI elementCapabilitiesTraversal;
    CreateInstanceMI systemDevices;
    CreateAssociationMI systemDevicesTraversal;
};

/// Those of the library.
EntryPoints libraryEntryPoints();

/// The instance operations of the four classes, by every way they have, and the traversals of both
/// associations from each class that has a way through them and from one that has none. Each makes its
/// provider first. Those that name an indicator name "b:/2", those that name a computer system "one".
std::vector<Operation> allOperations(const EntryPoints& of = libraryEntryPoints());

/// Those that the providers refuse, create, modify, delete and query, and their clean-ups.
std::vector<Operation> fixedOperations(const EntryPoints& of = libraryEntryPoints());

/// What one request brought.
struct Outcome
{
    cimhost::cim::Answer answer;
    int doneCount; ///< how often the operation has called returnDone
};

bool operator==(const Outcome& a, const Outcome& b);
void PrintTo(const Outcome& outcome, std::ostream* stream);

/// Runs an operation in a request of its own, in root/cimv2.
Outcome ask(cimhost::Broker& broker, const Operation& operation);

#endif
