/// \file
/// The CMPI services that the library uses, one typed function each. The only place that touches a
/// function table.
///
/// No null pointer is followed: a call on a null object, or of a service that its table lacks, does
/// nothing and returns a null pointer, a zero or { CMPI_RC_OK, null }. A status pointer may be null.
/// Null arguments other than the object itself are handed on; what they mean is the broker's matter.
///
/// Each function names the macro of cmpimacs.h that C programmers know. Such a macro is the call alone:
///
///     CMNewObjectPath(broker, nameSpace, className, rc)
///         -> broker->eft->newObjectPath(broker, nameSpace, className, rc)
///
/// where newObjectPath(broker, nameSpace, className, rc) here makes the same call, and first looks whether
/// `broker`, its `eft` and that table's `newObjectPath` are there.
#ifndef TAVRO_GLIMMARK_CMPI_H
#define TAVRO_GLIMMARK_CMPI_H

#include <cmpidt.h>
#include <cmpift.h>

#include <string>
#include <type_traits>

namespace Tavro::GlimmarkProvider::Cmpi {

/// Hands an argument to a function table's slot. Older headers leave out a `const` here and there;
/// no slot writes through such a pointer.
template <class Parameter, class Argument>
Parameter adapt(Argument argument)
{
    if constexpr (std::is_convertible_v<Argument, Parameter>)
        return argument;
    else
        return const_cast<Parameter>(argument);
}

/// Calls a slot of a function table with all its arguments, the object itself among them.
template <class Table, class Slots, class Result, class... Parameters, class... Arguments>
Result callSlot(const Table* table, Result (*Slots::*slot)(Parameters...), Arguments... arguments)
{
    if (table == nullptr || table->*slot == nullptr)
        return Result();
    return (table->*slot)(adapt<Parameters>(arguments)...);
}

/// Calls a service of an encapsulated object.
template <class Object, class Slot, class... Arguments>
auto call(const Object* object, Slot slot, Arguments... arguments)
{
    return callSlot(object != nullptr ? object->ft : nullptr, slot, object, arguments...);
}

/// Calls one of the broker's factory and utility services.
template <class Slot, class... Arguments>
auto callEncapsulated(const CMPIBroker* broker, Slot slot, Arguments... arguments)
{
    return callSlot(broker != nullptr ? broker->eft : nullptr, slot, broker, arguments...);
}

/// Makes an up-call into the broker.
template <class Slot, class... Arguments>
auto callBroker(const CMPIBroker* broker, Slot slot, Arguments... arguments)
{
    return callSlot(broker != nullptr ? broker->bft : nullptr, slot, broker, arguments...);
}

/// Whether there is an object behind the pointer: neither it nor its handle is null.
template <class Object>
bool exists(const Object* object)
{
    return object != nullptr && object->hdl != nullptr;
}

// Making objects. They belong to the broker and end with the request.

/// CMNewObjectPath.
inline CMPIObjectPath* newObjectPath(const CMPIBroker* broker, const char* nameSpace, const char* className,
                                     CMPIStatus* rc)
{
    return callEncapsulated(broker, &CMPIBrokerEncFT::newObjectPath, nameSpace, className, rc);
}

/// CMNewInstance.
inline CMPIInstance* newInstance(const CMPIBroker* broker, const CMPIObjectPath* path, CMPIStatus* rc)
{
    return callEncapsulated(broker, &CMPIBrokerEncFT::newInstance, path, rc);
}

/// CMNewString.
inline CMPIString* newString(const CMPIBroker* broker, const char* text)
{
    return callEncapsulated(broker, &CMPIBrokerEncFT::newString, text, static_cast<CMPIStatus*>(nullptr));
}

/// CMNewArray.
inline CMPIArray* newArray(const CMPIBroker* broker, CMPICount size, CMPIType type, CMPIStatus* rc)
{
    return callEncapsulated(broker, &CMPIBrokerEncFT::newArray, size, type, rc);
}

// Telling the broker.

/// CMTraceMessage, with the text as characters.
inline void trace(const CMPIBroker* broker, CMPILevel level, const char* component, const char* text)
{
    callEncapsulated(broker, &CMPIBrokerEncFT::trace, level, component, text,
                     static_cast<const CMPIString*>(nullptr));
}

/// Reports a failure as every operation does: code 1 and a message in the status, a warning in the
/// broker's trace. The two texts often differ.
/// \param status  null: nobody asked for it, and no message is made. Without a broker the message is null.
inline void reportFailure(const CMPIBroker* broker, const char* component, CMPIStatus* status,
                          const char* message, const char* traceText)
{
    if (status != nullptr) {
        status->rc = CMPI_RC_ERR_FAILED;
        status->msg = newString(broker, message);
    }
    trace(broker, CMPI_LEV_WARNING, component, traceText);
}

// Object paths.

/// CMGetCharsPtr: the characters belong to the string; null for a null string.
inline const char* characters(const CMPIString* string, CMPIStatus* rc)
{
    return call(string, &CMPIStringFT::getCharPtr, rc);
}

/// CMGetNameSpace.
inline const char* nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return characters(call(path, &CMPIObjectPathFT::getNameSpace, rc), rc);
}

/// CMGetClassName.
inline const char* classNameOf(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return characters(call(path, &CMPIObjectPathFT::getClassName, rc), rc);
}

/// CMSetNameSpace.
inline void setNameSpace(const CMPIObjectPath* path, const char* nameSpace)
{
    call(path, &CMPIObjectPathFT::setNameSpace, nameSpace);
}

/// CMSetHostname.
inline void setHostname(const CMPIObjectPath* path, const std::string& host)
{
    call(path, &CMPIObjectPathFT::setHostname, host.c_str());
}

/// CMGetKeyCount.
inline CMPICount keyCountOf(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return call(path, &CMPIObjectPathFT::getKeyCount, rc);
}

// Data is what its type and its value say. Its state says nothing reliable: there are brokers whose good
// items have the state of a null value.

/// CMGetKey: the value of a key where it is a string with content; null where it is missing, null or
/// something else.
inline CMPIString* stringKeyOf(const CMPIObjectPath* path, const char* name, CMPIStatus* rc)
{
    const CMPIData key = call(path, &CMPIObjectPathFT::getKey, name, rc);
    return key.type == CMPI_string && exists(key.value.string) ? key.value.string : nullptr;
}

// Values, each with its CMPI type. A text is passed as the character pointer itself in the place of
// the pointer to a value: so the standard wants it for CMPI_chars.

/// A value as addKey and setProperty take it.
struct TypedValue
{
    CMPIType type;
    CMPIValue value;
    const char* text; ///< only for CMPI_chars

    [[nodiscard]] const CMPIValue* pointer() const
    {
        return type == CMPI_chars ? reinterpret_cast<const CMPIValue*>(text) : &value;
    }
};

inline TypedValue typed(const std::string& text)
{
    return {CMPI_chars, CMPIValue(), text.c_str()};
}
inline TypedValue typed(const char* text)
{
    return {CMPI_chars, CMPIValue(), text};
}

inline TypedValue typed(CMPIUint16 number)
{
    TypedValue result{CMPI_uint16, CMPIValue(), nullptr};
    result.value.uint16 = number;
    return result;
}

inline TypedValue typed(bool flag)
{
    TypedValue result{CMPI_boolean, CMPIValue(), nullptr};
    result.value.boolean = flag ? 1 : 0;
    return result;
}

/// An array of uint16.
inline TypedValue typed(CMPIArray* array)
{
    TypedValue result{CMPI_uint16A, CMPIValue(), nullptr};
    result.value.array = array;
    return result;
}

inline TypedValue typed(const CMPIObjectPath* path)
{
    TypedValue result{CMPI_ref, CMPIValue(), nullptr};
    result.value.ref = const_cast<CMPIObjectPath*>(path);
    return result;
}

/// Any other pointer would do as a flag, which is then TRUE.
template <class Type>
TypedValue typed(const Type* pointer) = delete;

/// CMAddKey, with the CMPI type of the value.
template <class Value>
void addKey(const CMPIObjectPath* path, const char* name, const Value& value)
{
    const TypedValue key = typed(value);
    call(path, &CMPIObjectPathFT::addKey, name, key.pointer(), key.type);
}

/// CMSetProperty, with the CMPI type of the value.
template <class Value>
void setProperty(const CMPIInstance* instance, const char* name, const Value& value)
{
    const TypedValue property = typed(value);
    call(instance, &CMPIInstanceFT::setProperty, name, property.pointer(), property.type);
}

/// CMSetArrayElementAt.
inline void setElementAt(const CMPIArray* array, CMPICount index, CMPIUint16 number)
{
    const TypedValue element = typed(number);
    call(array, &CMPIArrayFT::setElementAt, index, element.pointer(), element.type);
}

// Instances.

/// CMSetPropertyFilter. \param properties  null-terminated, or null for all  \param keys  null-terminated
inline void setPropertyFilter(const CMPIInstance* instance, const char** properties, const char** keys)
{
    call(instance, &CMPIInstanceFT::setPropertyFilter, properties, keys);
}

/// CMGetObjectPath.
inline CMPIObjectPath* objectPathOf(const CMPIInstance* instance, CMPIStatus* rc)
{
    return call(instance, &CMPIInstanceFT::getObjectPath, rc);
}

// Results.

/// CMReturnInstance.
inline void returnInstance(const CMPIResult* result, const CMPIInstance* instance)
{
    call(result, &CMPIResultFT::returnInstance, instance);
}

/// CMReturnObjectPath.
inline void returnObjectPath(const CMPIResult* result, const CMPIObjectPath* path)
{
    call(result, &CMPIResultFT::returnObjectPath, path);
}

/// CMReturnDone.
inline void returnDone(const CMPIResult* result)
{
    call(result, &CMPIResultFT::returnDone);
}

// Up-calls and what they bring.

/// CBEnumInstanceNames.
inline CMPIEnumeration* enumerateInstanceNames(const CMPIBroker* broker, const CMPIContext* context,
                                               const CMPIObjectPath* classPath, CMPIStatus* rc)
{
    return callBroker(broker, &CMPIBrokerFT::enumerateInstanceNames, context, classPath, rc);
}

/// CBEnumInstances.
inline CMPIEnumeration* enumerateInstances(const CMPIBroker* broker, const CMPIContext* context,
                                           const CMPIObjectPath* classPath, const char** properties,
                                           CMPIStatus* rc)
{
    return callBroker(broker, &CMPIBrokerFT::enumerateInstances, context, classPath, properties, rc);
}

/// CMHasNext. False for a null enumeration: it counts as empty.
inline bool hasNext(const CMPIEnumeration* enumeration)
{
    return call(enumeration, &CMPIEnumerationFT::hasNext, static_cast<CMPIStatus*>(nullptr)) != 0;
}

/// CMGetNext: the next item as a path; null where it is of another type.
inline CMPIObjectPath* nextPath(const CMPIEnumeration* enumeration)
{
    const CMPIData item = call(enumeration, &CMPIEnumerationFT::getNext, static_cast<CMPIStatus*>(nullptr));
    return item.type == CMPI_ref ? item.value.ref : nullptr;
}

/// CMGetNext: the next item as an instance; null where it is of another type.
inline CMPIInstance* nextInstance(const CMPIEnumeration* enumeration)
{
    const CMPIData item = call(enumeration, &CMPIEnumerationFT::getNext, static_cast<CMPIStatus*>(nullptr));
    return item.type == CMPI_instance ? item.value.inst : nullptr;
}

} // namespace Tavro::GlimmarkProvider::Cmpi

#endif
