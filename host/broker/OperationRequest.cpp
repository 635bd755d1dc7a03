#include "broker/OperationRequest.h"

namespace cimhost {

bool answersPaths(Operation operation)
{
    switch (operation) {
    case Operation::enumerateInstanceNames:
    case Operation::createInstance:
    case Operation::associatorNames:
    case Operation::referenceNames:
        return true;
    default:
        return false;
    }
}

bool isEnumeration(Operation operation)
{
    return operation == Operation::enumerateInstanceNames || operation == Operation::enumerateInstances;
}

bool isReferenceTraversal(Operation operation)
{
    return operation == Operation::references || operation == Operation::referenceNames;
}

bool isTraversal(Operation operation)
{
    return operation == Operation::associators || operation == Operation::associatorNames ||
           isReferenceTraversal(operation);
}

cim::Answer perform(const OperationRequest& request, Broker& broker)
{
    switch (request.operation) {
    case Operation::enumerateInstanceNames:
        return broker.enumerateInstanceNames(request.target);
    case Operation::enumerateInstances:
        return broker.enumerateInstances(request.target, request.properties);
    case Operation::getInstance:
        return broker.getInstance(request.target, request.properties);
    case Operation::createInstance:
        return broker.createInstance(request.target, request.instance);
    case Operation::modifyInstance:
        return broker.modifyInstance(request.target, request.instance, request.properties);
    case Operation::deleteInstance:
        return broker.deleteInstance(request.target);
    case Operation::execQuery:
        return broker.execQuery(request.target, request.query, request.queryLanguage);
    case Operation::associators:
        return broker.associators(request.target, request.traversal, request.properties);
    case Operation::associatorNames:
        return broker.associatorNames(request.target, request.traversal);
    case Operation::references:
        return broker.references(request.target, request.traversal, request.properties);
    case Operation::referenceNames:
        return broker.referenceNames(request.target, request.traversal);
    }
    return {};
}

} // namespace cimhost
