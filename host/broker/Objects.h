/// \file
/// The contents of the objects that providers see, one type for each kind, and what connects a type
/// with its kind, its envelope and its function table.
#ifndef CIMHOST_BROKER_OBJECTS_H
#define CIMHOST_BROKER_OBJECTS_H

#include "broker/FunctionTables.h"
#include "broker/Handle.h"
#include "broker/Names.h"
#include "cim/CopyOnWrite.h"
#include "cim/Model.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace cimhost {

struct ObjectPathObject
{
    cim::CopyOnWrite<cim::ObjectPath> path;
};

/// An instance under construction. Its path is completed by the rule of `completed` whenever it is
/// read or handed on.
struct InstanceObject
{
    explicit InstanceObject(cim::ObjectPath path) : content(cim::Instance{std::move(path), {}}) {}
    explicit InstanceObject(std::shared_ptr<const cim::Instance> shared) : content(std::move(shared)) {}

    cim::CopyOnWrite<cim::Instance> content;
    std::shared_ptr<const NameSet> wanted; ///< the property filter; null: every property
    std::vector<std::string> keyNames;     ///< the filter's key list
    /// Those that the class declares, kept by the broker's classes; null: it is not known, or has none.
    const std::vector<std::string>* classKeys = nullptr;
    /// References that the filter keeps out of the properties; they still identify the instance.
    std::vector<cim::Property> hiddenReferences;
};

/// The path of an instance with all its keys. A key that the path lacks is taken from the property of that
/// name if the class declares it as a key or the filter's key list names it. Where the class is not known,
/// an instance made on a path without any key takes every reference as a key, since the references of an
/// association are its keys.
cim::ObjectPath completedPath(const InstanceObject& instance);

/// The instance with its path completed; shared with the object when there was nothing to add.
std::shared_ptr<const cim::Instance> completed(const InstanceObject& instance);

struct StringObject
{
    std::string text;
};

struct ArrayObject
{
    CMPIType elementType; ///< without CMPI_ARRAY; CMPI_string for CMPI_chars
    std::vector<cim::Value::Scalar> elements;
};

struct EnumerationObject
{
    CMPIType elementType; ///< CMPI_ref or CMPI_instance
    std::vector<cim::Value::Scalar> elements;
    std::size_t position = 0;
};

/// An entry of a context, an argument of a method call.
struct NamedValue
{
    std::string name;
    cim::Value value;
};

struct ContextObject
{
    std::vector<NamedValue> entries;
};

struct ArgsObject
{
    std::vector<NamedValue> arguments;
};

/// What a provider has returned so far, as it was when it returned it.
struct ResultObject
{
    cim::ObjectPaths paths;
    cim::Instances instances;
    int doneCount = 0;
};

struct DateTimeObject
{
    std::string text; ///< the 25 characters of CIM's datetime
};

struct ErrorObject
{
    std::string owningEntity;
    std::string messageId;
    std::string message;
    CMPIErrorSeverity severity{};
    CMPIErrorProbableCause probableCause{};
    CMPIrc statusCode = CMPI_RC_OK;
    CMPIErrorType type{};
    CMPIErrorSrcFormat sourceFormat{};
    std::string otherType;
    std::string probableCauseDescription;
    std::string source;
    std::string otherSourceFormat;
    std::string statusCodeDescription;
    std::vector<cim::Value::Scalar> recommendedActions;
    std::vector<cim::Value::Scalar> messageArguments;
};

class ObjectStore;

/// A place in a store: everything made after it goes when the mark is released.
struct MarkObject
{
    ObjectStore* store;
    std::size_t ordinal;
};

/// A block of the memory services; freed with the object.
struct MemoryObject
{
    MemoryObject(void* memory, std::size_t bytes) : block(memory), size(bytes) {}
    ~MemoryObject();
    MemoryObject(const MemoryObject&) = delete;
    MemoryObject& operator=(const MemoryObject&) = delete;

    void* block;
    std::size_t size;
};

/// For each content type: its kind, what the kind is called, its envelope and its function table.
template <class Object>
struct Traits;

template <>
struct Traits<ObjectPathObject>
{
    using Envelope = CMPIObjectPath;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::objectPath;
    static constexpr auto envelope = &Handle::Envelope::objectPath;
    static constexpr auto table = &FunctionTables::objectPath;
};

template <>
struct Traits<InstanceObject>
{
    using Envelope = CMPIInstance;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::instance;
    static constexpr auto envelope = &Handle::Envelope::instance;
    static constexpr auto table = &FunctionTables::instance;
};

template <>
struct Traits<StringObject>
{
    using Envelope = CMPIString;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::string;
    static constexpr auto envelope = &Handle::Envelope::string;
    static constexpr auto table = &FunctionTables::string;
};

template <>
struct Traits<ArrayObject>
{
    using Envelope = CMPIArray;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::array;
    static constexpr auto envelope = &Handle::Envelope::array;
    static constexpr auto table = &FunctionTables::array;
};

template <>
struct Traits<EnumerationObject>
{
    using Envelope = CMPIEnumeration;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::enumeration;
    static constexpr auto envelope = &Handle::Envelope::enumeration;
    static constexpr auto table = &FunctionTables::enumeration;
};

template <>
struct Traits<ContextObject>
{
    using Envelope = CMPIContext;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::context;
    static constexpr auto envelope = &Handle::Envelope::context;
    static constexpr auto table = &FunctionTables::context;
};

template <>
struct Traits<ResultObject>
{
    using Envelope = CMPIResult;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::result;
    static constexpr auto envelope = &Handle::Envelope::result;
    static constexpr auto table = &FunctionTables::result;
};

template <>
struct Traits<ArgsObject>
{
    using Envelope = CMPIArgs;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::args;
    static constexpr auto envelope = &Handle::Envelope::args;
    static constexpr auto table = &FunctionTables::args;
};

template <>
struct Traits<DateTimeObject>
{
    using Envelope = CMPIDateTime;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::dateTime;
    static constexpr auto envelope = &Handle::Envelope::dateTime;
    static constexpr auto table = &FunctionTables::dateTime;
};

template <>
struct Traits<ErrorObject>
{
    using Envelope = CMPIError;
    static constexpr bool hasTable = true;
    static constexpr Kind kind = Kind::error;
    static constexpr auto envelope = &Handle::Envelope::error;
    static constexpr auto table = &FunctionTables::error;
};

template <>
struct Traits<MarkObject>
{
    static constexpr bool hasTable = false;
    static constexpr Kind kind = Kind::mark;
};

template <>
struct Traits<MemoryObject>
{
    static constexpr bool hasTable = false;
    static constexpr Kind kind = Kind::memory;
};

template <class Object>
using EnvelopeOf = typename Traits<Object>::Envelope;

/// The CMPI name of a kind, such as CMPIObjectPath.
const char* typeName(Kind kind);

/// The content of a handle; of the type that belongs to the handle's kind.
template <class Object>
Object& contentOf(const Handle& handle)
{
    return *static_cast<Object*>(handle.payload);
}

} // namespace cimhost

#endif
