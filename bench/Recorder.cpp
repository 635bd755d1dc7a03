#include "Recorder.h"

#include <cstring>
#include <sstream>
#include <stdexcept>

namespace bench {

namespace {

using Number = Tape::Number;

std::string quoted(const std::string& text)
{
    return '"' + text + '"';
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

Number Recorder::newWord(Tape::Word word, std::string shown)
{
    tape.words.push_back(word);
    tape.shown.push_back(std::move(shown));
    return static_cast<Number>(tape.words.size() - 1);
}

Number Recorder::newObject(const void* object)
{
    return objects[object] = newWord(Tape::Word(), "#" + std::to_string(tape.words.size()));
}

Number Recorder::numberOfObject(const void* object)
{
    const auto known = objects.find(object);
    if (known == objects.end())
        fail("an object is used that is not the request's and that no call has brought");
    return known->second;
}

/// \param make  the word of a constant that the tape keeps
template <class Map, class Key, class Make>
Number Recorder::constant(Map& known, const Key& key, std::string shown, Make make)
{
    const auto [entry, isNew] = known.try_emplace(key, Number{});
    if (isNew)
        entry->second = newWord(make(entry->first), std::move(shown));
    return entry->second;
}

namespace {

Tape::Word pointerTo(const void* kept)
{
    Tape::Word word{};
    word.pointer = const_cast<void*>(kept);
    return word;
}

} // namespace

Number Recorder::numberOf(std::uint64_t number)
{
    return constant(tape.numbers, number, std::to_string(number),
                    [](std::uint64_t kept) { return Tape::Word{kept}; });
}

Number Recorder::numberOf(const void* address)
{
    return numberOf(reinterpret_cast<std::uintptr_t>(address));
}

Number Recorder::numberOf(const std::string& text)
{
    return constant(tape.strings, text, quoted(text),
                    [](const std::string& kept) { return pointerTo(&kept); });
}

Number Recorder::numberOf(const std::wstring& text)
{
    return constant(tape.wideStrings, text, quoted({text.begin(), text.end()}),
                    [](const std::wstring& kept) { return pointerTo(&kept); });
}

Number Recorder::numberOf(const char* text)
{
    if (text == nullptr)
        return Tape::nullWord;
    return constant(tape.characters, std::string(text), quoted(text),
                    [](const std::string& kept) { return pointerTo(kept.c_str()); });
}

Number Recorder::numberOf(const char** list)
{
    if (list == nullptr)
        return Tape::nullWord;
    std::vector<const char*> texts;
    std::string shown;
    for (; *list != nullptr; ++list) {
        texts.push_back(static_cast<const char*>(tape.words[numberOf(*list)].pointer));
        shown += quoted(*list);
    }
    texts.push_back(nullptr);
    return constant(tape.lists, texts, shown, [](const auto& kept) { return pointerTo(kept.data()); });
}

Number Recorder::numberOf(CMPIStatus* status)
{
    return status == nullptr ? Tape::nullWord : Tape::statusWord;
}

Number Recorder::numberOf(const CMPIValue* value)
{
    const auto numeric = [&](std::uint64_t number, auto set) {
        return constant(tape.values, std::pair(valueType, number), std::to_string(number),
                        [&](const auto& /*kept*/) {
                            Tape::Word word{};
                            set(word.value);
                            return word;
                        });
    };
    switch (valueType) {
    case CMPI_chars:
        return numberOf(reinterpret_cast<const char*>(value)) | Tape::textInPlaceOfValue;
    case CMPI_boolean:
        return numeric(value->boolean, [&](CMPIValue& kept) { kept.boolean = value->boolean; });
    case CMPI_uint16:
        return numeric(value->uint16, [&](CMPIValue& kept) { kept.uint16 = value->uint16; });
    case CMPI_uint16A:
        return numberOfObject(value->array);
    case CMPI_ref:
        return numberOfObject(value->ref);
    default:
        fail("a value has type " + std::to_string(valueType));
    }
}

} // namespace bench
