/// \file
/// A CIM operation as a value: what a client asks of the broker, whatever way the question came.
#ifndef CIMHOST_BROKER_OPERATIONREQUEST_H
#define CIMHOST_BROKER_OPERATIONREQUEST_H

#include "broker/Broker.h"
#include "cim/Model.h"

#include <string>

namespace cimhost {

/// The intrinsic operations that a provider answers.
enum class Operation
{
    enumerateInstanceNames,
    enumerateInstances,
    getInstance,
    createInstance,
    modifyInstance,
    deleteInstance,
    execQuery,
    associators,
    associatorNames,
    references,
    referenceNames,
};

/// One question. What an operation has no use for is left as it is here.
struct OperationRequest
{
    Operation operation = Operation::enumerateInstanceNames;
    /// The class or object asked for, with a namespace.
    cim::ObjectPath target{};
    Traversal traversal{};          ///< of the four traversals
    cim::PropertyList properties{}; ///< of what brings instances, and of modifyInstance
    cim::Instance instance{};       ///< of createInstance and modifyInstance
    std::string query{};            ///< of execQuery
    std::string queryLanguage{};    ///< of execQuery
};

/// Whether the answer consists of paths; otherwise it consists of instances, or of nothing at all.
bool answersPaths(Operation operation);

/// The two that ask for all of a class.
bool isEnumeration(Operation operation);

/// The four traversals, and of them the two that answer associations.
bool isTraversal(Operation operation);
bool isReferenceTraversal(Operation operation);

/// Asks the broker.
cim::Answer perform(const OperationRequest& request, Broker& broker);

} // namespace cimhost

#endif
