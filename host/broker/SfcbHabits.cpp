#include "broker/Call.h"
#include "broker/Habits.h"
#include "broker/Names.h"
#include "broker/Router.h"
#include "broker/Values.h"

#include <algorithm>
#include <memory>
#include <utility>

namespace cimhost {

// The habits of each broker have names in common.
namespace sfcb {

constexpr const char* sfcb1311 = "SFCB 1.3.11";

void tellOldVersions(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.broker.brokerVersion = 0;
    for (CMPIVersion* version :
         {&tables.enc.ftVersion, &tables.context.ftVersion, &tables.result.ftVersion,
          &tables.string.ftVersion, &tables.array.ftVersion, &tables.enumeration.ftVersion,
          &tables.instance.ftVersion, &tables.objectPath.ftVersion, &tables.args.ftVersion,
          &tables.dateTime.ftVersion})
        *version = 1;
}

void leaveSlotsEmpty(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.enc.newCMPIError = nullptr;
    tables.enc.openMessageFile = nullptr;
    tables.enc.closeMessageFile = nullptr;
    tables.enc.getMessage2 = nullptr;
    tables.ext.joinThread = nullptr;
    tables.ext.exitThread = nullptr;
    tables.ext.cancelThread = nullptr;
    tables.ext.threadSleep = nullptr;
    tables.ext.signalCondition = nullptr;
    tables.result.returnError = nullptr;
    tables.instance.setPropertyWithOrigin = nullptr;
    tables.objectPath.getClassQualifier = nullptr;
    tables.objectPath.getMethodQualifier = nullptr;
    tables.objectPath.getParameterQualifier = nullptr;
}

CMPIStatus refuseTrace(const CMPIBroker* /*broker*/, CMPILevel /*level*/, const char* /*component*/,
                       const char* /*text*/, const CMPIString* /*string*/)
{
    return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
}

CMPIStatus refuseLogMessage(const CMPIBroker* /*broker*/, CMPISeverity /*severity*/, const char* /*id*/,
                            const char* /*text*/, const CMPIString* /*string*/)
{
    return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
}

void writeNoTrace(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.enc.trace = refuseTrace;
    tables.enc.logMessage = refuseLogMessage;
}

/// What stands beyond the last element: a bad value of the elements' type, under a good status.
CMPIData badValue(CMPIType type, CMPIStatus* rc)
{
    writeCode(rc, CMPI_RC_OK);
    return emptyData(type, CMPI_badValue);
}

CMPIData getNextEvenBeyond(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const CMPIData item = plainServices().enumeration.getNext(enumeration, &status);
    if (status.rc == CMPI_RC_ERR_NOT_FOUND) {
        const CMPIArray* const items = plainServices().enumeration.toArray(enumeration, nullptr);
        return badValue(plainServices().array.getSimpleType(items, nullptr), rc);
    }
    writeCode(rc, status.rc);
    return item;
}

CMPIData getElementEvenBeyond(const CMPIArray* array, CMPICount index, CMPIStatus* rc)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const CMPIData element = plainServices().array.getElementAt(array, index, &status);
    if (status.rc == CMPI_RC_ERR_NO_SUCH_PROPERTY)
        return badValue(plainServices().array.getSimpleType(array, nullptr), rc);
    writeCode(rc, status.rc);
    return element;
}

void goBeyondTheEnd(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.enumeration.getNext = getNextEvenBeyond;
    tables.array.getElementAt = getElementEvenBeyond;
}

CMPIData getKeyAsValue(const CMPIObjectPath* path, const char* name, CMPIStatus* rc)
{
    const CMPIData key = plainServices().objectPath.getKey(path, name, rc);
    return withState(key, key.state & ~static_cast<unsigned int>(CMPI_keyValue));
}

CMPIData getKeyAtAsValue(const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* rc)
{
    const CMPIData key = plainServices().objectPath.getKeyAt(path, index, name, rc);
    return withState(key, key.state & ~static_cast<unsigned int>(CMPI_keyValue));
}

void tellKeysAsValues(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.objectPath.getKey = getKeyAsValue;
    tables.objectPath.getKeyAt = getKeyAtAsValue;
}

CMPIData getPropertyOrNotFound(const CMPIInstance* instance, const char* name, CMPIStatus* rc)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const CMPIData property = plainServices().instance.getProperty(instance, name, &status);
    writeCode(rc, status.rc == CMPI_RC_ERR_NO_SUCH_PROPERTY ? CMPI_RC_ERR_NOT_FOUND : status.rc);
    return property;
}

void missPropertiesAsKeys(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.instance.getProperty = getPropertyOrNotFound;
}

CMPIData getEntryOrNull(const CMPIContext* context, const char* name, CMPIStatus* rc)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const CMPIData entry = plainServices().context.getEntry(context, name, &status);
    if (status.rc != CMPI_RC_ERR_NOT_FOUND) {
        writeCode(rc, status.rc);
        return entry;
    }
    writeCode(rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    return withState(entry, CMPI_nullValue);
}

void missEntriesAsNull(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.context.getEntry = getEntryOrNull;
}

/// Forgets references that the filter did not let pass; they identify the instance no more.
CMPIStatus forgetHidden(const CMPIInstance* instance, const CMPIStatus& status)
{
    if (status.rc != CMPI_RC_OK)
        return status;
    return perform("CMPIInstanceFT", [&](Call& call) {
        call.use<InstanceObject>(instance, "the instance").hiddenReferences.clear();
    });
}

CMPIStatus setPropertyThatPasses(const CMPIInstance* instance, const char* name, const CMPIValue* value,
                                 CMPIType type)
{
    return forgetHidden(instance, plainServices().instance.setProperty(instance, name, value, type));
}

CMPIStatus setFilterLiterally(const CMPIInstance* instance, const char** properties, const char** keys)
{
    return forgetHidden(instance, plainServices().instance.setPropertyFilter(instance, properties, keys));
}

/// Leaves out the properties that the provider's filter does not ask for, keys too: they are in the path.
CMPIStatus returnWhatTheFilterAsksFor(const CMPIResult* result, const CMPIInstance* instance)
{
    const CMPIStatus status = plainServices().result.returnInstance(result, instance);
    if (status.rc != CMPI_RC_OK)
        return status;
    return perform("CMPIResultFT.returnInstance", [&](Call& call) {
        const auto& wanted = call.use<InstanceObject>(instance, "the instance").wanted;
        if (!wanted)
            return;
        keepOnly(call.use<ResultObject>(result, "the result").instances.editBack().properties, *wanted);
    });
}

void takeFiltersLiterally(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.instance.setProperty = setPropertyThatPasses;
    tables.instance.setPropertyFilter = setFilterLiterally;
    tables.result.returnInstance = returnWhatTheFilterAsksFor;
}

void takeAnEmptyListForNone(OperationRequest& question, const RegisteredClass& /*served*/)
{
    if (question.properties && question.properties->empty())
        question.properties.reset();
}

void traverseFromInstancesOnly(OperationRequest& question, const RegisteredClass& /*served*/)
{
    if (isTraversal(question.operation) && question.target.keys.empty())
        throw RoutingError(CMPI_RC_ERR_NOT_SUPPORTED, "a traversal starts at an instance, not at the class " +
                                                          question.target.className);
}

cim::Value withoutHosts(cim::Value value);

template <class Named>
void dropHostsOfReferences(std::vector<Named>& list)
{
    for (Named& named : list)
        named.value = withoutHosts(std::move(named.value));
}

cim::Value withoutHosts(cim::Value value)
{
    for (cim::Value::Scalar& item : value.items) {
        auto* const path = std::get_if<std::shared_ptr<const cim::ObjectPath>>(&item);
        if (path == nullptr || *path == nullptr)
            continue;
        cim::ObjectPath local = **path;
        local.host.clear();
        dropHostsOfReferences(local.keys);
        *path = std::make_shared<const cim::ObjectPath>(std::move(local));
    }
    return value;
}

void referWithoutHosts(cim::Answer& answer, const OperationRequest& /*question*/)
{
    answer.paths.edit([](cim::ObjectPath& path) { dropHostsOfReferences(path.keys); });
    answer.instances.edit([](cim::Instance& instance) {
        dropHostsOfReferences(instance.path.keys);
        dropHostsOfReferences(instance.properties);
    });
}

} // namespace sfcb

const Habits& sfcbHabits()
{
    using namespace sfcb;
    static const Habits habits{
        "sfcb",
        {
            {"the version of the broker is 0, that of its tables 1", sfcb1311, tellOldVersions},
            {"there are no memory services", sfcb1311, haveNoMemoryServices},
            {"slots of errors, messages, threads, qualifiers and origins are null", sfcb1311,
             leaveSlotsEmpty},
            {"trace and logMessage are not supported and write nothing", sfcb1311, writeNoTrace},
            {"beyond the end of an enumeration or array is a bad value, with a good status", sfcb1311,
             goBeyondTheEnd},
            {"a key has no state of its own", sfcb1311, tellKeysAsValues},
            {"a property that is not there is not found, as a key is", sfcb1311, missPropertiesAsKeys},
            {"an entry that is not there is no such property, and null", sfcb1311, missEntriesAsNull},
            {"a property filter is taken literally: a key that it does not name is nowhere, one that only its "
             "key list names is in the path alone",
             sfcb1311, takeFiltersLiterally},
            {"an empty property list asks for all properties", sfcb1311, takeAnEmptyListForNone},
            {"a traversal from a class is not supported", sfcb1311, traverseFromInstancesOnly},
            {"references in answers have no host", sfcb1311, referWithoutHosts},
        }};
    return habits;
}

} // namespace cimhost
