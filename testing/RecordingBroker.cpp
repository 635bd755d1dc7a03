#include "testing/RecordingBroker.h"

#include "testing/Allocations.h"

#include <algorithm>
#include <type_traits>

using cimhost::FunctionTables;

namespace {

RecordingBroker* active = nullptr;

std::string quoted(const char* text)
{
    return text == nullptr ? "null" : '"' + std::string(text) + '"';
}

// Arguments as text. An empty one is left out of the record.

std::string show(const CMPIBroker*)
{
    return "";
}
std::string show(const CMPIResult*)
{
    return "";
}
std::string show(CMPIString**)
{
    return "";
}
std::string show(const char* text)
{
    return quoted(text);
}
std::string show(const CMPIStatus* status)
{
    return status == nullptr ? "null" : "rc";
}
std::string show(CMPICount number)
{
    return std::to_string(number);
}
std::string show(CMPILevel level)
{
    return std::to_string(level);
}

std::string show(const char** list)
{
    if (list == nullptr)
        return "null";
    std::string text;
    for (; *list != nullptr; ++list)
        text += (text.empty() ? "" : " ") + std::string(*list);
    return "[" + text + "]";
}

std::string show(const CMPIString* string)
{
    const auto text = cimhost::read(string);
    return text ? quoted(text->c_str()) : "null";
}

std::string show(const CMPIObjectPath* path)
{
    return active->nameOf(path, "path");
}
std::string show(const CMPIInstance* instance)
{
    return active->nameOf(instance, "instance");
}
std::string show(const CMPIArray* array)
{
    return active->nameOf(array, "array");
}
std::string show(const CMPIEnumeration* enumeration)
{
    return active->nameOf(enumeration, "enumeration");
}
std::string show(const CMPIContext* context)
{
    return active->nameOf(context, "context");
}

std::string show(CMPIType type)
{
    switch (type) {
    case CMPI_chars:
        return "chars";
    case CMPI_uint16:
        return "uint16";
    case CMPI_uint16A:
        return "uint16A";
    case CMPI_boolean:
        return "boolean";
    case CMPI_ref:
        return "ref";
    default:
        return "type " + std::to_string(type);
    }
}

std::string show(const CMPIValue* value, CMPIType type)
{
    if (value == nullptr)
        return "null";
    switch (type) {
    case CMPI_chars:
        return quoted(reinterpret_cast<const char*>(value));
    case CMPI_uint16:
        return std::to_string(value->uint16);
    case CMPI_uint16A:
        return show(value->array);
    case CMPI_boolean:
        return std::to_string(value->boolean);
    case CMPI_ref:
        return show(static_cast<const CMPIObjectPath*>(value->ref));
    default:
        return "?";
    }
}

/// All arguments as texts; a value is shown by the type that follows it.
std::vector<std::string> showAll()
{
    return {};
}

template <class... Rest>
std::vector<std::string> showAll(const CMPIValue* value, CMPIType type, Rest... rest)
{
    std::vector<std::string> texts = showAll(rest...);
    texts.insert(texts.begin(), {show(value, type), show(type)});
    return texts;
}

template <class First, class... Rest>
std::vector<std::string> showAll(First first, Rest... rest)
{
    std::vector<std::string> texts = showAll(rest...);
    if (const std::string text = show(first); !text.empty())
        texts.insert(texts.begin(), text);
    return texts;
}

// Results of calls that fail.

bool setsStatus(Failure failure)
{
    return failure == Failure::errorStatus || failure == Failure::noMessage ||
           failure == Failure::servedError;
}

void fillStatus(CMPIStatus* status, Failure failure)
{
    if (status != nullptr)
        *status = active->injectedStatus(failure);
}

template <class Other>
void fillStatus(Other, Failure)
{}

template <class Object>
struct TableOf;

#define TABLE_OF(object, table)                                                                              \
    template <>                                                                                              \
    struct TableOf<object>                                                                                   \
    {                                                                                                        \
        static constexpr auto member = &FunctionTables::table;                                               \
    }
TABLE_OF(CMPIObjectPath, objectPath);
TABLE_OF(CMPIInstance, instance);
TABLE_OF(CMPIString, string);
TABLE_OF(CMPIArray, array);
TABLE_OF(CMPIEnumeration, enumeration);
#undef TABLE_OF

FunctionTables* activeTables = nullptr;

/// An object with a table and without a handle.
template <class Object>
Object* objectWithoutHandle()
{
    static Object object;
    object = Object{nullptr, &(activeTables->*TableOf<Object>::member)};
    return &object;
}

/// Whether a service that answers so makes or finds an object.
template <class Result>
constexpr bool makesObject = std::is_pointer_v<Result> && !std::is_const_v<std::remove_pointer_t<Result>>;

template <class Result>
Result failed(Failure failure)
{
    if constexpr (std::is_same_v<Result, CMPIStatus>) {
        return failure == Failure::nullResult ? CMPIStatus{CMPI_RC_OK, nullptr}
                                              : active->injectedStatus(failure);
    } else if constexpr (std::is_same_v<Result, CMPIData>) {
        CMPIData data = CMPIData();
        data.type = failure == Failure::wrongValue ? CMPI_uint64 : CMPI_null;
        data.state = failure == Failure::wrongValue ? CMPI_goodValue : CMPI_nullValue;
        if (failure == Failure::wrongValue)
            data.value.uint64 = 1; // no pointer
        return data;
    } else if constexpr (makesObject<Result>) {
        return failure == Failure::noHandle ? objectWithoutHandle<std::remove_pointer_t<Result>>() : nullptr;
    } else {
        return Result();
    }
}

/// Leaves the object that a call is made on without a handle.
template <class Object, class... Rest>
void dropHandle(const Object* object, Rest...)
{
    const_cast<Object*>(object)->hdl = nullptr;
}

template <class... Rest>
void dropHandle(const CMPIBroker*, Rest...)
{
    // The broker outlives the request, with its handle.
}

/// While it lives, this thread is inside an up-call: its calls are those of other providers.
class UpCall
{
public:
    UpCall() { ++depth; }
    ~UpCall() { --depth; }
    UpCall(const UpCall&) = delete;
    UpCall& operator=(const UpCall&) = delete;

    static bool isRunning() { return depth > 0; }

private:
    static inline thread_local int depth = 0;
};

/// What a service answers with, and on what it is called.
struct ServiceKind
{
    bool returnsStatus;
    bool returnsData;
    bool returnsObject;
    bool isOnObject; ///< not on the broker
};

std::map<std::string, ServiceKind> serviceKinds;

/// Stands in a slot of a function table.
template <auto Slot>
struct Layer;

template <class Table, class Result, class... Arguments, Result (*Table::*Slot)(Arguments...)>
struct Layer<Slot>
{
    static inline Result (*original)(Arguments...) = nullptr;
    static inline const char* service = nullptr;

    static Result call(Arguments... arguments)
    {
        const Allocations::Pause pause; // what the broker allocates is not the library's
        if (UpCall::isRunning())
            return original(arguments...);
        const auto failure = active->record(service, showAll(arguments...));
        if (!failure)
            return serve(arguments...);
        if (*failure == Failure::lostHandle) {
            const Result result = serve(arguments...);
            dropHandle(arguments...);
            return result;
        }
        if constexpr (std::is_same_v<Result, CMPIData>) {
            if (*failure == Failure::nullState) {
                CMPIData data = serve(arguments...);
                data.state = static_cast<CMPIValueState>(data.state | CMPI_nullValue);
                return data;
            }
        }
        return fail(*failure, arguments...);
    }

    static Result fail(Failure failure, Arguments... arguments)
    {
        if (failure == Failure::servedError) {
            const Result result = serve(arguments...);
            (fillStatus(arguments, failure), ...);
            if constexpr (std::is_same_v<Result, CMPIStatus>)
                return active->injectedStatus(failure);
            else
                return result;
        }
        if (setsStatus(failure))
            (fillStatus(arguments, failure), ...);
        return failed<Result>(failure);
    }

    static Result serve(Arguments... arguments)
    {
        if constexpr (std::is_same_v<Table, CMPIBrokerFT>) {
            const UpCall running;
            return original(arguments...);
        } else {
            return original(arguments...);
        }
    }

    static void install(Table& table, const char* name)
    {
        original = table.*Slot;
        service = name;
        table.*Slot = &call;
        serviceKinds[name] = {
            std::is_same_v<Result, CMPIStatus>, std::is_same_v<Result, CMPIData>, makesObject<Result>,
            !std::is_same_v<Table, CMPIBrokerFT> && !std::is_same_v<Table, CMPIBrokerEncFT>};
    }
};

#define LAYER(table, Type, slot) Layer<&Type::slot>::install(tables.table, #slot)

void install(FunctionTables& tables)
{
    LAYER(broker, CMPIBrokerFT, enumerateInstanceNames);
    LAYER(broker, CMPIBrokerFT, enumerateInstances);
    LAYER(broker, CMPIBrokerFT, getInstance);
    LAYER(enc, CMPIBrokerEncFT, newInstance);
    LAYER(enc, CMPIBrokerEncFT, newObjectPath);
    LAYER(enc, CMPIBrokerEncFT, newString);
    LAYER(enc, CMPIBrokerEncFT, newArray);
    LAYER(enc, CMPIBrokerEncFT, trace);
    LAYER(objectPath, CMPIObjectPathFT, setNameSpace);
    LAYER(objectPath, CMPIObjectPathFT, getNameSpace);
    LAYER(objectPath, CMPIObjectPathFT, setHostname);
    LAYER(objectPath, CMPIObjectPathFT, getClassName);
    LAYER(objectPath, CMPIObjectPathFT, addKey);
    LAYER(objectPath, CMPIObjectPathFT, getKey);
    LAYER(objectPath, CMPIObjectPathFT, getKeyAt);
    LAYER(objectPath, CMPIObjectPathFT, getKeyCount);
    LAYER(instance, CMPIInstanceFT, setProperty);
    LAYER(instance, CMPIInstanceFT, getObjectPath);
    LAYER(instance, CMPIInstanceFT, setPropertyFilter);
    LAYER(string, CMPIStringFT, getCharPtr);
    LAYER(array, CMPIArrayFT, setElementAt);
    LAYER(enumeration, CMPIEnumerationFT, hasNext);
    LAYER(enumeration, CMPIEnumerationFT, getNext);
    LAYER(result, CMPIResultFT, returnInstance);
    LAYER(result, CMPIResultFT, returnObjectPath);
    LAYER(result, CMPIResultFT, returnDone);
}

#undef LAYER

bool endsWith(const std::string& text, const std::string& end)
{
    return text.size() >= end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

bool beginsWith(const std::string& call, const std::string& service)
{
    return call.compare(0, service.size() + 1, service + "(") == 0;
}

} // namespace

RecordingBroker::RecordingBroker(cimhost::Broker& recordedBroker, std::size_t (*countOfOthers)())
    : broker(recordedBroker),
      originalTables(recordedBroker.tables()),
      othersSoFar(countOfOthers)
{
    active = this;
    activeTables = &broker.tables();
    install(broker.tables());
}

RecordingBroker::~RecordingBroker()
{
    broker.tables() = originalTables;
    active = nullptr;
}

RecordingBroker* RecordingBroker::current()
{
    return active;
}

void RecordingBroker::name(const void* object, const std::string& objectName)
{
    const std::lock_guard lock(mutex);
    givenNames[object] = objectName;
}

void RecordingBroker::clear()
{
    const std::lock_guard lock(mutex);
    recorded.clear();
    othersBefore.clear();
    names.clear();
    counters.clear();
}

void RecordingBroker::forget()
{
    clear();
    const std::lock_guard lock(mutex);
    givenNames.clear();
    plans.clear();
}

std::vector<std::string> RecordingBroker::calls() const
{
    const std::lock_guard lock(mutex);
    return recorded;
}

std::vector<std::size_t> RecordingBroker::othersBeforeCalls() const
{
    const std::lock_guard lock(mutex);
    return othersBefore;
}

std::vector<std::string> RecordingBroker::calls(const std::vector<std::string>& services) const
{
    std::vector<std::string> found;
    for (const std::string& call : calls()) {
        const auto matches = [&](const std::string& service) { return beginsWith(call, service); };
        if (std::any_of(services.begin(), services.end(), matches))
            found.push_back(call);
    }
    return found;
}

std::vector<Failure> RecordingBroker::failuresOf(const std::string& call)
{
    const ServiceKind& kind = serviceKinds.at(call.substr(0, call.find('(')));
    std::vector<Failure> failures{Failure::nullResult};
    if (kind.returnsObject)
        failures.push_back(Failure::noHandle);
    if (kind.returnsStatus || endsWith(call, "rc)"))
        failures.insert(failures.end(), {Failure::errorStatus, Failure::noMessage, Failure::servedError});
    if (kind.returnsData)
        failures.insert(failures.end(), {Failure::wrongValue, Failure::nullState});
    if (kind.isOnObject)
        failures.push_back(Failure::lostHandle);
    return failures;
}

void RecordingBroker::fail(const std::string& service, int nth, Failure failure)
{
    const std::lock_guard lock(mutex);
    plans.push_back({service, nth, failure});
}

std::optional<Failure> RecordingBroker::record(const std::string& service,
                                               const std::vector<std::string>& arguments)
{
    std::string call = service + "(";
    for (std::size_t i = 0; i < arguments.size(); ++i)
        call += (i == 0 ? "" : ", ") + arguments[i];
    const std::lock_guard lock(mutex);
    recorded.push_back(call + ")");
    othersBefore.push_back(othersSoFar != nullptr ? othersSoFar() : 0);
    std::optional<Failure> failure;
    for (Plan& plan : plans) {
        if ((plan.service.empty() || plan.service == service) && --plan.remaining == 0)
            failure = plan.failure;
    }
    return failure;
}

std::string RecordingBroker::nameOf(const void* object, const std::string& kind)
{
    if (object == nullptr)
        return "null";
    const std::lock_guard lock(mutex);
    if (const auto given = givenNames.find(object); given != givenNames.end())
        return given->second;
    const auto found = names.find(object);
    if (found != names.end())
        return found->second;
    return names[object] = kind + std::to_string(++counters[kind]);
}

CMPIStatus RecordingBroker::injectedStatus(Failure failure)
{
    if (failure == Failure::noMessage)
        return {CMPI_RC_ERR_FAILED, nullptr};
    return {CMPI_RC_ERR_FAILED, originalTables.enc.newString(broker.cmpiBroker(), "injected", nullptr)};
}
