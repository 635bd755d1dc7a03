#include "Recorder.h"

#include <cstring>
#include <stdexcept>

namespace bench {

namespace {

using Number = Tape::Number;

std::string quoted(const std::string& text)
{
    return '"' + text + '"';
}

Tape::Word pointerTo(const void* kept)
{
    Tape::Word word{};
    word.pointer = const_cast<void*>(kept);
    return word;
}

/// A service of the broker: the layer stands in its slot.
template <auto Slot>
struct Service;

template <class Table, class Result, class Object, class... Others, Result (*Table::*Slot)(Object, Others...)>
struct Service<Slot> : Recorded<Service<Slot>, Result, Object, Others...>
{
    static inline const char* name = nullptr;

    static Result call(Object object, Others... others)
    {
        if constexpr (std::is_same_v<Table, CMPIBrokerFT>)
            return (object->bft->*Slot)(object, others...);
        else if constexpr (std::is_same_v<Table, CMPIBrokerEncFT>)
            return (object->eft->*Slot)(object, others...);
        else
            return (object->ft->*Slot)(object, others...);
    }

    static Result layer(Object object, Others... others)
    {
        return Service::record(*Recorder::current(), name, object, others...);
    }

    static void install(Table& table, const char* slotName)
    {
        name = slotName;
        table.*Slot = &layer;
    }
};

void refuse()
{
    Recorder::current()->fail("a service of the broker is called that Recorder.cpp does not list");
}

/// Lets every service of a table be refused. \param head  the bytes before its first slot
template <class Table>
void refuseAll(Table& table, std::size_t head)
{
    void (*const refusal)() = &refuse;
    for (std::size_t place = head; place < sizeof table; place += sizeof refusal)
        std::memcpy(reinterpret_cast<char*>(&table) + place, &refusal, sizeof refusal);
}

void refuseAll(cimhost::FunctionTables& tables)
{
    const auto refuseEach = [](auto&... table) { (refuseAll(table, sizeof(void*)), ...); };
    refuseAll(tables.broker, offsetof(CMPIBrokerFT, prepareAttachThread));
    refuseEach(tables.enc, tables.ext, tables.mem, tables.context, tables.result, tables.string, tables.array,
               tables.enumeration, tables.instance, tables.objectPath, tables.args, tables.dateTime,
               tables.error);
}

#define SERVICE(table, Type, slot) Service<&Type::slot>::install(tables.table, #slot)

void install(cimhost::FunctionTables& tables)
{
    refuseAll(tables);
    SERVICE(broker, CMPIBrokerFT, enumerateInstanceNames);
    SERVICE(broker, CMPIBrokerFT, enumerateInstances);
    SERVICE(enc, CMPIBrokerEncFT, newInstance);
    SERVICE(enc, CMPIBrokerEncFT, newObjectPath);
    SERVICE(enc, CMPIBrokerEncFT, newString);
    SERVICE(enc, CMPIBrokerEncFT, newArray);
    SERVICE(enc, CMPIBrokerEncFT, trace);
    SERVICE(objectPath, CMPIObjectPathFT, setNameSpace);
    SERVICE(objectPath, CMPIObjectPathFT, getNameSpace);
    SERVICE(objectPath, CMPIObjectPathFT, setHostname);
    SERVICE(objectPath, CMPIObjectPathFT, getClassName);
    SERVICE(objectPath, CMPIObjectPathFT, addKey);
    SERVICE(objectPath, CMPIObjectPathFT, getKey);
    SERVICE(objectPath, CMPIObjectPathFT, getKeyCount);
    SERVICE(instance, CMPIInstanceFT, setProperty);
    SERVICE(instance, CMPIInstanceFT, getObjectPath);
    SERVICE(instance, CMPIInstanceFT, setPropertyFilter);
    SERVICE(string, CMPIStringFT, getCharPtr);
    SERVICE(array, CMPIArrayFT, setElementAt);
    SERVICE(enumeration, CMPIEnumerationFT, hasNext);
    SERVICE(enumeration, CMPIEnumerationFT, getNext);
    SERVICE(result, CMPIResultFT, returnInstance);
    SERVICE(result, CMPIResultFT, returnObjectPath);
    SERVICE(result, CMPIResultFT, returnDone);
}

#undef SERVICE

} // namespace

Tape record(cimhost::Broker& host, const TapeRequest& request, const std::function<void()>& run)
{
    Recorder recorder(host, request);
    run();
    return recorder.take();
}

Recorder::Recorder(cimhost::Broker& host, const TapeRequest& request)
    : broker(host),
      ownTables(host.tables()),
      recordingTables(host.tables()),
      objects{{nullptr, Tape::nullWord},
              {request.broker, Tape::brokerWord},
              {request.ctx, Tape::contextWord},
              {request.rslt, Tape::resultWord},
              {request.ref, Tape::pathWord}}
{
    install(recordingTables);
    resume();
}

Recorder::~Recorder()
{
    pause();
}

Tape Recorder::take()
{
    if (!failure.empty())
        fail(failure);
    return std::move(tape);
}

void Recorder::fail(const std::string& reason)
{
    failure = reason;
    throw std::logic_error("cannot be recorded: " + reason);
}

void Recorder::pause()
{
    active = nullptr;
    broker.tables() = ownTables;
}

void Recorder::resume()
{
    broker.tables() = recordingTables;
    active = this;
}

void Recorder::begin(Number step, CMPIType typeOfValue)
{
    add(step);
    valueType = typeOfValue;
}

void Recorder::addResult(const void* object)
{
    if (object == nullptr)
        return add(Tape::droppedWord);
    const auto known = objects.find(object);
    add(known != objects.end() ? known->second : newObject(object));
}

void Recorder::addResult(const CMPIData& data)
{
    addResult((data.type & CMPI_ENC) != 0 ? data.value.inst : nullptr);
}

Number Recorder::newWord(Tape::Word word, const std::string& shown)
{
    tape.words.push_back(word);
    tape.shown.push_back(shown);
    return static_cast<Number>(tape.words.size() - 1);
}

Number Recorder::newObject(const void* object)
{
    return objects[object] = newWord(Tape::Word(), "#" + std::to_string(tape.words.size()));
}

/// \param shown  another for every other constant \param make  returns the word of a new one
template <class Make>
Number Recorder::constant(const std::string& shown, Make make)
{
    const auto [known, isNew] = constants.try_emplace(shown);
    if (isNew)
        known->second = newWord(make(), shown);
    return known->second;
}

Number Recorder::numberOf(std::uint64_t number)
{
    return constant(std::to_string(number), [&] { return Tape::Word{number}; });
}

Number Recorder::numberOf(const std::string& text)
{
    return constant("string " + quoted(text), [&] { return pointerTo(&tape.texts.emplace_back(text)); });
}

Number Recorder::numberOf(const std::wstring& text)
{
    return constant("wide " + quoted({text.begin(), text.end()}),
                    [&] { return pointerTo(&tape.wideTexts.emplace_back(text)); });
}

Number Recorder::numberOf(const char* text)
{
    if (text == nullptr)
        return Tape::nullWord;
    return constant(quoted(text), [&] { return pointerTo(tape.texts.emplace_back(text).c_str()); });
}

Number Recorder::numberOf(const char** list)
{
    if (list == nullptr)
        return Tape::nullWord;
    std::string shown = "list";
    std::vector<const char*> kept;
    for (; *list != nullptr; ++list) {
        shown += ' ' + quoted(*list);
        kept.push_back(static_cast<const char*>(tape.words[numberOf(*list)].pointer));
    }
    kept.push_back(nullptr);
    return constant(shown, [&] { return pointerTo(tape.lists.emplace_back(kept).data()); });
}

Number Recorder::numberOf(CMPIStatus* status)
{
    return status == nullptr ? Tape::nullWord : Tape::statusWord;
}

Number Recorder::numberOf(const CMPIValue* value)
{
    Tape::Word word{};
    switch (valueType) {
    case CMPI_chars:
        return numberOf(reinterpret_cast<const char*>(value)) | Tape::textInPlaceOfValue;
    case CMPI_boolean:
        word.value.boolean = value->boolean;
        return constant("boolean " + std::to_string(value->boolean), [&] { return word; });
    case CMPI_uint16:
        word.value.uint16 = value->uint16;
        return constant("uint16 " + std::to_string(value->uint16), [&] { return word; });
    case CMPI_uint16A:
        return numberOf(value->array);
    case CMPI_ref:
        return numberOf(value->ref);
    default:
        fail("a value has type " + std::to_string(valueType));
    }
}

} // namespace bench
