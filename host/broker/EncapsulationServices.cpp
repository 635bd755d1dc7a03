#include "broker/Call.h"
#include "broker/DateTime.h"
#include "broker/ObjectText.h"
#include "broker/Tables.h"
#include "broker/Values.h"
#include "cim/Values.h"

namespace cimhost {

namespace {

CMPIInstance* newInstance(const CMPIBroker* broker, const CMPIObjectPath* path, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newInstance", rc, static_cast<CMPIInstance*>(nullptr), [&](Call& call) {
        const Core& core = call.broker(broker);
        InstanceObject instance(call.use<ObjectPathObject>(path, "the object path").path.read());
        const std::vector<std::string>& keys = core.classes.keysOf(instance.content.read().path.className);
        instance.classKeys = keys.empty() ? nullptr : &keys;
        return call.make<InstanceObject>(std::move(instance));
    });
}

/// A null namespace is one that is not given.
CMPIObjectPath* newObjectPath(const CMPIBroker* broker, const char* nameSpace, const char* className,
                              CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newObjectPath", rc, static_cast<CMPIObjectPath*>(nullptr), [&](Call& call) {
        call.broker(broker);
        cim::ObjectPath path;
        path.nameSpace = nameSpace == nullptr ? "" : nameSpace;
        path.className = call.text(className, "the class name");
        return call.make<ObjectPathObject>(cim::CopyOnWrite<cim::ObjectPath>(std::move(path)));
    });
}

CMPIArgs* newArgs(const CMPIBroker* broker, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newArgs", rc, static_cast<CMPIArgs*>(nullptr), [&](Call& call) {
        call.broker(broker);
        return call.make<ArgsObject>();
    });
}

CMPIString* newString(const CMPIBroker* broker, const char* text, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newString", rc, static_cast<CMPIString*>(nullptr), [&](Call& call) {
        call.broker(broker);
        return call.makeString(call.text(text, "the text"));
    });
}

/// More elements than any answer carries; a larger size is one that was never set.
constexpr CMPICount mostElements = CMPICount{1} << 22U;

/// All elements are null at first.
CMPIArray* newArray(const CMPIBroker* broker, CMPICount size, CMPIType type, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newArray", rc, static_cast<CMPIArray*>(nullptr), [&](Call& call) {
        call.broker(broker);
        if (!isScalarType(type))
            call.refuse(CMPI_RC_ERR_INVALID_DATA_TYPE, "no array has elements of " + cim::typeName(type));
        if (size > mostElements)
            call.refuse(CMPI_RC_ERR_INVALID_PARAMETER, "an array of " + std::to_string(size) +
                                                           " elements; there may be " +
                                                           std::to_string(mostElements));
        return call.make<ArrayObject>(keptType(type), std::vector<cim::Value::Scalar>(size));
    });
}

CMPIDateTime* newDateTime(const CMPIBroker* broker, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newDateTime", rc, static_cast<CMPIDateTime*>(nullptr), [&](Call& call) {
        call.broker(broker);
        return call.make<DateTimeObject>(currentDateTime());
    });
}

CMPIDateTime* newDateTimeFromBinary(const CMPIBroker* broker, CMPIUint64 microseconds, CMPIBoolean interval,
                                    CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newDateTimeFromBinary", rc, static_cast<CMPIDateTime*>(nullptr),
                 [&](Call& call) {
                     call.broker(broker);
                     return call.make<DateTimeObject>(toDateTime(microseconds, interval != 0));
                 });
}

CMPIDateTime* newDateTimeFromChars(const CMPIBroker* broker, const char* text, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newDateTimeFromChars", rc, static_cast<CMPIDateTime*>(nullptr),
                 [&](Call& call) {
                     call.broker(broker);
                     const std::string dateTime = call.text(text, "the text");
                     if (!isDateTime(dateTime))
                         Call::leave(CMPI_RC_ERR_INVALID_PARAMETER);
                     return call.make<DateTimeObject>(dateTime);
                 });
}

CMPISelectExp* newSelectExp(const CMPIBroker* broker, const char* /*query*/, const char* /*language*/,
                            CMPIArray** /*projection*/, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newSelectExp", rc, static_cast<CMPISelectExp*>(nullptr),
                 [&](Call& call) -> CMPISelectExp* {
                     call.broker(broker);
                     Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
                 });
}

CMPIBoolean classPathIsA(const CMPIBroker* broker, const CMPIObjectPath* path, const char* className,
                         CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.classPathIsA", rc, CMPIBoolean{0}, [&](Call& call) {
        call.broker(broker);
        const auto& content = call.use<ObjectPathObject>(path, "the object path");
        const std::string& own = content.path.read().className;
        const bool is = call.core().classes.isA(own, call.text(className, "the class name"));
        return static_cast<CMPIBoolean>(is ? 1 : 0);
    });
}

CMPIString* toString(const CMPIBroker* broker, const void* object, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.toString", rc, static_cast<CMPIString*>(nullptr), [&](Call& call) {
        call.broker(broker);
        return call.makeString(objectText(call.resolve(object, "the object")));
    });
}

CMPIBoolean isOfType(const CMPIBroker* broker, const void* object, const char* type, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.isOfType", rc, CMPIBoolean{0}, [&](Call& call) {
        call.broker(broker);
        const Handle& handle = call.resolve(object, "the object");
        const bool same = call.text(type, "the type") == std::string(typeName(handle.kind));
        return static_cast<CMPIBoolean>(same ? 1 : 0);
    });
}

CMPIString* getType(const CMPIBroker* broker, const void* object, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.getType", rc, static_cast<CMPIString*>(nullptr), [&](Call& call) {
        call.broker(broker);
        return call.makeString(typeName(call.resolve(object, "the object").kind));
    });
}

/// There are no message catalogues: the message is the default one, its arguments not filled in.
CMPIString* defaultMessage(const char* service, const CMPIBroker* broker, const char* message, CMPIStatus* rc)
{
    return serve(service, rc, static_cast<CMPIString*>(nullptr), [&](Call& call) {
        call.broker(broker);
        return call.makeString(call.text(message, "the default message"));
    });
}

CMPIString* getMessage(const CMPIBroker* broker, const char* /*id*/, const char* message, CMPIStatus* rc,
                       CMPICount /*count*/, ...)
{
    return defaultMessage("CMPIBrokerEncFT.getMessage", broker, message, rc);
}

CMPIString* getMessage2(const CMPIBroker* broker, const char* /*id*/, CMPIMsgFileHandle /*file*/,
                        const char* message, CMPIStatus* rc, CMPICount /*count*/, ...)
{
    return defaultMessage("CMPIBrokerEncFT.getMessage2", broker, message, rc);
}

std::string textOrEmpty(const char* text)
{
    return text == nullptr ? std::string() : std::string(text);
}

/// The text, or that of the string object when there is no text.
std::string textOf(Call& call, const char* text, const CMPIString* string)
{
    if (text != nullptr || string == nullptr)
        return textOrEmpty(text);
    return call.use<StringObject>(string, "the string").text;
}

CMPIStatus logMessage(const CMPIBroker* broker, CMPISeverity severity, const char* id, const char* text,
                      const CMPIString* string)
{
    return perform("CMPIBrokerEncFT.logMessage", [&](Call& call) {
        Core& core = call.broker(broker);
        core.tell(LogRecord{severity, textOrEmpty(id), textOf(call, text, string)});
    });
}

CMPIStatus trace(const CMPIBroker* broker, CMPILevel level, const char* component, const char* text,
                 const CMPIString* string)
{
    return perform("CMPIBrokerEncFT.trace", [&](Call& call) {
        Core& core = call.broker(broker);
        core.tell(TraceRecord{level, textOrEmpty(component), textOf(call, text, string)});
    });
}

CMPIError* newCMPIError(const CMPIBroker* broker, const char* owner, const char* id, const char* message,
                        const CMPIErrorSeverity severity, const CMPIErrorProbableCause cause,
                        const CMPIrc statusCode, CMPIStatus* rc)
{
    return serve("CMPIBrokerEncFT.newCMPIError", rc, static_cast<CMPIError*>(nullptr), [&](Call& call) {
        call.broker(broker);
        ErrorObject error;
        error.owningEntity = textOrEmpty(owner);
        error.messageId = textOrEmpty(id);
        error.message = textOrEmpty(message);
        error.severity = severity;
        error.probableCause = cause;
        error.statusCode = statusCode;
        return call.make<ErrorObject>(std::move(error));
    });
}

CMPIStatus openMessageFile(const CMPIBroker* broker, const char* /*file*/, CMPIMsgFileHandle* handle)
{
    return perform("CMPIBrokerEncFT.openMessageFile", [&](Call& call) {
        call.broker(broker);
        if (handle != nullptr)
            *handle = nullptr;
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

CMPIStatus closeMessageFile(const CMPIBroker* broker, CMPIMsgFileHandle /*handle*/)
{
    return perform("CMPIBrokerEncFT.closeMessageFile", [&](Call& call) {
        call.broker(broker);
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

} // namespace

CMPIBrokerEncFT encapsulationServices()
{
    return {servedVersion,
            newInstance,
            newObjectPath,
            newArgs,
            newString,
            newArray,
            newDateTime,
            newDateTimeFromBinary,
            newDateTimeFromChars,
            newSelectExp,
            classPathIsA,
            toString,
            isOfType,
            getType,
            getMessage,
            logMessage,
            trace,
            newCMPIError,
            openMessageFile,
            closeMessageFile,
            getMessage2};
}

} // namespace cimhost
