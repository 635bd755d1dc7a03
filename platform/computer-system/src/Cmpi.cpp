#include "Cmpi.h"

#include <type_traits>

namespace Tavro::ComputerSystem::Cmpi {
namespace {

/// Hands an argument to a service. Older CMPI headers leave out a `const` here and there; no service writes
/// through such a pointer.
template <class Parameter, class Argument>
Parameter adapt(Argument argument)
{
    if constexpr (std::is_convertible_v<Argument, Parameter>)
        return argument;
    else
        return const_cast<Parameter>(argument);
}

/// Calls a service with all its arguments, the object itself among them.
template <class Table, class Result, class... Parameters, class... Arguments>
Result callSlot(const char* service, const Table* table, Result (*Table::*slot)(Parameters...),
                Arguments... arguments)
{
    if (table == nullptr || table->*slot == nullptr)
        throw Failure(CMPI_RC_ERR_INVALID_HANDLE, std::string("There is no ") + service + " to call");
    return (table->*slot)(adapt<Parameters>(arguments)...);
}

/// Calls a service of an encapsulated object.
template <class Object, class Slot, class... Arguments>
auto call(const Object* object, Slot slot, const char* service, Arguments... arguments)
{
    const auto* const table = object != nullptr && object->hdl != nullptr ? object->ft : nullptr;
    return callSlot(service, table, slot, object, arguments...);
}

/// Calls a factory service of the broker.
template <class Slot, class... Arguments>
auto call(const CMPIBroker* broker, Slot slot, const char* service, Arguments... arguments)
{
    return callSlot(service, broker != nullptr ? broker->eft : nullptr, slot, broker, arguments...);
}

void require(const CMPIStatus& status, const char* service)
{
    if (status.rc != CMPI_RC_OK)
        throw Failure(status.rc, std::string("The broker's ") + service + " failed");
}

/// What a service gave, unless it failed or gave no object.
template <class Object>
Object* require(Object* object, const CMPIStatus& status, const char* service)
{
    require(status, service);
    if (object == nullptr || object->hdl == nullptr)
        throw Failure(CMPI_RC_ERR_FAILED, std::string("The broker's ") + service + " gave nothing");
    return object;
}

/// A text as the value of a CMPI_chars: the character pointer itself, in the place of the pointer to a
/// value.
const CMPIValue* asValue(const std::string& text)
{
    return reinterpret_cast<const CMPIValue*>(text.c_str());
}

} // namespace

std::string nameSpaceOf(const CMPIObjectPath* path)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIString* const string = call(path, &CMPIObjectPathFT::getNameSpace, "getNameSpace", &status);
    require(string, status, "getNameSpace");
    const char* const text = call(string, &CMPIStringFT::getCharPtr, "getCharPtr", &status);
    require(status, "getCharPtr");
    if (text == nullptr)
        throw Failure(CMPI_RC_ERR_INVALID_NAMESPACE, "The path has no namespace");
    return text;
}

CMPIObjectPath* newObjectPath(const CMPIBroker* broker, const std::string& nameSpace, const char* className)
{
    constexpr const char* service = "newObjectPath";
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIObjectPath* const path =
        call(broker, &CMPIBrokerEncFT::newObjectPath, service, nameSpace.c_str(), className, &status);
    return require(path, status, service);
}

CMPIInstance* newInstance(const CMPIBroker* broker, const CMPIObjectPath* path)
{
    constexpr const char* service = "newInstance";
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIInstance* const instance = call(broker, &CMPIBrokerEncFT::newInstance, service, path, &status);
    return require(instance, status, service);
}

CMPIArray* newArray(const CMPIBroker* broker, std::initializer_list<CMPIUint16> elements)
{
    constexpr const char* service = "newArray";
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIArray* const array =
        require(call(broker, &CMPIBrokerEncFT::newArray, service, static_cast<CMPICount>(elements.size()),
                     CMPIType{CMPI_uint16}, &status),
                status, service);
    CMPICount index = 0;
    for (const CMPIUint16 element : elements) {
        CMPIValue value{};
        value.uint16 = element;
        require(call(array, &CMPIArrayFT::setElementAt, "setElementAt", index, &value, CMPIType{CMPI_uint16}),
                "setElementAt");
        ++index;
    }
    return array;
}

void setHostname(const CMPIObjectPath* path, const std::string& host)
{
    require(call(path, &CMPIObjectPathFT::setHostname, "setHostname", host.c_str()), "setHostname");
}

void addKey(const CMPIObjectPath* path, const char* name, const std::string& value)
{
    require(call(path, &CMPIObjectPathFT::addKey, "addKey", name, asValue(value), CMPIType{CMPI_chars}),
            "addKey");
}

void setPropertyFilter(const CMPIInstance* instance, const char** properties, const char** keys)
{
    require(call(instance, &CMPIInstanceFT::setPropertyFilter, "setPropertyFilter", properties, keys),
            "setPropertyFilter");
}

namespace {

void set(const CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type)
{
    require(call(instance, &CMPIInstanceFT::setProperty, "setProperty", name, value, type), "setProperty");
}

} // namespace

void setProperty(const CMPIInstance* instance, const char* name, const std::string& value)
{
    set(instance, name, asValue(value), CMPI_chars);
}

void setProperty(const CMPIInstance* instance, const char* name, CMPIUint16 value)
{
    CMPIValue number{};
    number.uint16 = value;
    set(instance, name, &number, CMPI_uint16);
}

void setProperty(const CMPIInstance* instance, const char* name, CMPIArray* array)
{
    CMPIValue value{};
    value.array = array;
    set(instance, name, &value, CMPI_uint16A);
}

void returnInstance(const CMPIResult* result, const CMPIInstance* instance)
{
    require(call(result, &CMPIResultFT::returnInstance, "returnInstance", instance), "returnInstance");
}

void returnObjectPath(const CMPIResult* result, const CMPIObjectPath* path)
{
    require(call(result, &CMPIResultFT::returnObjectPath, "returnObjectPath", path), "returnObjectPath");
}

void returnDone(const CMPIResult* result)
{
    require(call(result, &CMPIResultFT::returnDone, "returnDone"), "returnDone");
}

CMPIStatus failed(const CMPIBroker* broker, CMPIrc code, const char* message) noexcept
{
    try {
        constexpr CMPIStatus* ignored = nullptr;
        return {code, call(broker, &CMPIBrokerEncFT::newString, "newString", message, ignored)};
    } catch (const std::exception&) {
        return {code, nullptr};
    }
}

} // namespace Tavro::ComputerSystem::Cmpi
