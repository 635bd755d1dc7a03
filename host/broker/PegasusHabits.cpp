#include "broker/Habits.h"
#include "broker/Names.h"

#include <array>

#include <unistd.h>

namespace cimhost {

// The habits of each broker have names in common.
namespace pegasus {

constexpr const char* pegasus2144 = "OpenPegasus 2.14.4";

/// Of data that is not there.
constexpr unsigned int nullAndNotFound = CMPI_nullValue | CMPI_notFound;

void leaveSlotsEmpty(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.result.release = nullptr;
    tables.result.clone = nullptr;
    tables.context.clone = nullptr;
    tables.objectPath.getClassQualifier = nullptr;
    tables.objectPath.getPropertyQualifier = nullptr;
    tables.objectPath.getMethodQualifier = nullptr;
    tables.objectPath.getParameterQualifier = nullptr;
}

CMPIData getNextAsNull(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    constexpr auto noMoreElements = static_cast<CMPIrc>(18); // of CMPI 2.1
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIData item = plainServices().enumeration.getNext(enumeration, &status);
    if (status.rc == CMPI_RC_ERR_NOT_FOUND) {
        const CMPIArray* const items = plainServices().enumeration.toArray(enumeration, nullptr);
        item.type = plainServices().array.getSimpleType(items, nullptr);
        status.rc = noMoreElements;
    }
    writeCode(rc, status.rc);
    return withState(item, CMPI_nullValue);
}

void tellItemsAsNull(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.enumeration.getNext = getNextAsNull;
}

/// Data as it was got, or told to be null as well where there is none.
CMPIData toldAsNull(const CMPIData& data)
{
    return (data.state & CMPI_notFound) != 0 ? withState(data, nullAndNotFound) : data;
}

CMPIData getKey(const CMPIObjectPath* path, const char* name, CMPIStatus* rc)
{
    return toldAsNull(plainServices().objectPath.getKey(path, name, rc));
}

CMPIData getKeyAt(const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* rc)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const CMPIData key = plainServices().objectPath.getKeyAt(path, index, name, &status);
    writeCode(rc, status.rc == CMPI_RC_ERR_NOT_FOUND ? CMPI_RC_ERR_NO_SUCH_PROPERTY : status.rc);
    return toldAsNull(key);
}

CMPIData getProperty(const CMPIInstance* instance, const char* name, CMPIStatus* rc)
{
    return toldAsNull(plainServices().instance.getProperty(instance, name, rc));
}

CMPIData getEntry(const CMPIContext* context, const char* name, CMPIStatus* rc)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const CMPIData entry = plainServices().context.getEntry(context, name, &status);
    writeCode(rc, status.rc == CMPI_RC_ERR_NOT_FOUND ? CMPI_RC_ERR_NO_SUCH_PROPERTY : status.rc);
    return toldAsNull(entry);
}

CMPIData getElementAt(const CMPIArray* array, CMPICount index, CMPIStatus* rc)
{
    const CMPIData element = plainServices().array.getElementAt(array, index, rc);
    return (element.state & CMPI_notFound) != 0 ? withState(element, CMPI_nullValue) : element;
}

void tellWhatIsNotThereAsNull(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.objectPath.getKey = getKey;
    tables.objectPath.getKeyAt = getKeyAt;
    tables.instance.getProperty = getProperty;
    tables.context.getEntry = getEntry;
    tables.array.getElementAt = getElementAt;
}

CMPIStatus setKeyListAlone(const CMPIInstance* instance, const char** /*properties*/, const char** keys)
{
    return plainServices().instance.setPropertyFilter(instance, nullptr, keys);
}

void filterAnswersAlone(FunctionTables& tables, CMPIBroker& /*broker*/)
{
    tables.instance.setPropertyFilter = setKeyListAlone;
}

void keepOnlyWhatWasAskedFor(cim::Answer& answer, const OperationRequest& question)
{
    if (!question.properties)
        return;
    const NameSet asked(*question.properties);
    answer.instances.edit([&](cim::Instance& instance) { keepOnly(instance.properties, asked); });
}

void handInTheHost(OperationRequest& question, const RegisteredClass& /*served*/)
{
    std::array<char, 256> name{};
    if (question.target.host.empty() && gethostname(name.data(), name.size() - 1) == 0)
        question.target.host = name.data();
}

void setTheAssociationClass(OperationRequest& question, const RegisteredClass& served)
{
    if (!isTraversal(question.operation))
        return;
    auto& associationClass = isReferenceTraversal(question.operation) ? question.traversal.resultClass
                                                                      : question.traversal.assocClass;
    associationClass = served.className;
}

void takeAnEmptyRoleForNone(OperationRequest& question, const RegisteredClass& /*served*/)
{
    for (auto* const role : {&question.traversal.role, &question.traversal.resultRole})
        if (*role && (*role)->empty())
            role->reset();
}

} // namespace pegasus

const Habits& pegasusHabits()
{
    using namespace pegasus;
    static const Habits habits{
        "pegasus",
        {
            {"there are no memory services", pegasus2144, haveNoMemoryServices},
            {"slots of results, contexts and qualifiers are null", pegasus2144, leaveSlotsEmpty},
            {"every item of an enumeration has the state of a null value, and beyond the end there are no more "
             "elements (18)",
             pegasus2144, tellItemsAsNull},
            {"a key, property, entry or element that is not there is null as well; by its position or in a "
             "context it is no such property",
             pegasus2144, tellWhatIsNotThereAsNull},
            {"a property filter is known to the answer alone: the provider can set and get any property",
             pegasus2144, filterAnswersAlone},
            {"an answer has the properties asked for, without keys among them that were not", pegasus2144,
             keepOnlyWhatWasAskedFor},
            {"paths handed in have the broker's host", pegasus2144, handInTheHost},
            {"the association class of a traversal is always that registered, as it is spelt there",
             pegasus2144, setTheAssociationClass},
            {"an empty role is none", pegasus2144, takeAnEmptyRoleForNone},
        }};
    return habits;
}

} // namespace cimhost
