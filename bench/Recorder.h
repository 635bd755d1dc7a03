/// \file
/// Records a tape. A thin layer stands in the broker's function tables, and this executable defines the
/// functions of the support libraries ahead of them (SupportCalls.cpp): each writes its call down and makes
/// it, or just makes it where nothing is recorded. What a call makes of calls in its turn is not the
/// library's and not written down.
#ifndef BENCH_RECORDER_H
#define BENCH_RECORDER_H

#include "Tape.h"

#include "broker/Broker.h"
#include "testing/Allocations.h"

#include <functional>
#include <optional>
#include <tuple>
#include <type_traits>
#include <unordered_map>
#include <utility>

namespace bench {

/// Runs something in a request and records its calls. What the calls allocate is not counted, but for those
/// that return a text. \throw std::logic_error  a call cannot be recorded: of a service that is not in
/// Recorder.cpp's list, on an
///     object that is not the request's and that no call has brought, or with a value of an unknown type
Tape record(cimhost::Broker& host, const TapeRequest& request, const std::function<void()>& run);

/// An object of a support library, which its user keeps a place for.
struct Held
{};

class Recorder
{
public:
    Recorder(cimhost::Broker& host, const TapeRequest& request);
    ~Recorder();
    Recorder(const Recorder&) = delete;
    Recorder& operator=(const Recorder&) = delete;

    /// Null: nothing is recorded.
    static Recorder* current() { return active; }

    /// \throw std::logic_error  what could not be recorded, also where the library has caught it
    Tape take();

    [[noreturn]] void fail(const std::string& reason);

    /// While it lives, calls are made as if nothing were recorded.
    class Pause
    {
    public:
        explicit Pause(Recorder& paused) : recorder(paused) { recorder.pause(); }
        ~Pause() { recorder.resume(); }
        Pause(const Pause&) = delete;
        Pause& operator=(const Pause&) = delete;

    private:
        Recorder& recorder;
    };

    /// Adds the number of a call's step. \param typeOfValue  of the value that is among its arguments
    void begin(Tape::Number step, CMPIType typeOfValue);
    /// Adds the number of an argument.
    template <class Value>
    void addArgument(const Value& value)
    {
        add(numberOf(value));
    }
    /// Adds the number of what the call has brought.
    void addResult(const void* object);
    void addResult(const CMPIData& data);

private:
    void pause();
    void resume();
    void add(Tape::Number number) { tape.code.push_back(number); }
    Tape::Number newWord(Tape::Word word, const std::string& shown);
    Tape::Number newObject(const void* object);
    template <class Make>
    Tape::Number constant(const std::string& shown, Make make);

    template <class Integer, class = std::enable_if_t<std::is_integral_v<Integer> || std::is_enum_v<Integer>>>
    Tape::Number numberOf(Integer number)
    {
        return numberOf(static_cast<std::uint64_t>(number));
    }
    Tape::Number numberOf(std::uint64_t number);
    Tape::Number numberOf(const void* address) { return numberOf(reinterpret_cast<std::uintptr_t>(address)); }
    Tape::Number numberOf(const std::string& text);
    Tape::Number numberOf(const std::wstring& text);
    Tape::Number numberOf(const char* text);
    Tape::Number numberOf(const char** list);
    Tape::Number numberOf(CMPIStatus* status);
    Tape::Number numberOf(const CMPIValue* value);
    template <class Object, class = std::enable_if_t<std::is_class_v<Object>>>
    Tape::Number numberOf(Object* object)
    {
        const auto known = objects.find(object);
        if (known != objects.end())
            return known->second;
        if constexpr (!std::is_base_of_v<Held, Object>)
            fail("an object is used that is not the request's and that no call has brought");
        return newObject(object);
    }

    static inline Recorder* active = nullptr;
    cimhost::Broker& broker;
    const cimhost::FunctionTables ownTables;
    cimhost::FunctionTables recordingTables;
    Tape tape;
    std::unordered_map<const void*, Tape::Number> objects;
    std::unordered_map<std::string, Tape::Number> constants;
    CMPIType valueType = CMPI_null;
    std::string failure;
};

/// An argument of a call, as the function takes it.
template <class Parameter>
Parameter argument(Tape::Number number, Tape::Word* words)
{
    using Pointed = std::remove_pointer_t<Parameter>;
    if constexpr (std::is_same_v<Parameter, unsigned int&>) {
        words[Tape::countWord].value.uint32 = static_cast<unsigned int>(words[number].number);
        return words[Tape::countWord].value.uint32;
    } else if constexpr (std::is_reference_v<Parameter>) {
        return *static_cast<std::remove_reference_t<Parameter>*>(words[number].pointer);
    } else if constexpr (std::is_base_of_v<Held, std::remove_cv_t<Pointed>>) {
        return reinterpret_cast<Parameter>(&words[number]);
    } else if constexpr (std::is_same_v<Parameter, const CMPIValue*>) {
        if ((number & Tape::textInPlaceOfValue) != 0)
            return static_cast<Parameter>(words[number & ~Tape::textInPlaceOfValue].pointer);
        return &words[number].value;
    } else if constexpr (std::is_pointer_v<Parameter>) {
        return static_cast<Parameter>(words[number].pointer);
    } else {
        return static_cast<Parameter>(words[number].number);
    }
}

/// What a call can be recorded and made again by. \tparam Call  has a function `call`, which makes it
template <class Call, class Result, class... Parameters>
struct Recorded
{
    /// Whether a later call can take what this one brings as an argument.
    static constexpr bool bringsObject =
        std::is_same_v<Result, CMPIData> ||
        (std::is_pointer_v<Result> && std::is_class_v<std::remove_pointer_t<Result>>);
    static constexpr bool returnsText =
        std::is_same_v<Result, std::string> || std::is_same_v<Result, std::wstring>;

    /// Writes the call down and makes it. Not inlined, so that handing on what is not recorded takes little.
    [[gnu::noinline]] static Result record(Recorder& recorder, const char* name, Parameters... parameters)
    {
        static const Tape::Number step =
            Tape::addStep({name, sizeof...(Parameters) + (bringsObject ? 1 : 0), &replay});
        std::optional<Allocations::Pause> uncounted(std::in_place);
        recorder.begin(step, typeAmong(parameters...));
        (recorder.addArgument(parameters), ...);
        const Recorder::Pause pause(recorder);
        if constexpr (bringsObject) {
            const Result result = Call::call(parameters...);
            recorder.addResult(result);
            return result;
        } else {
            if (returnsText)
                uncounted.reset(); // the text is the caller's
            return Call::call(parameters...);
        }
    }

private:
    /// The type of the value that is among the arguments: the last one.
    static CMPIType typeAmong(const Parameters&... parameters)
    {
        if constexpr ((std::is_same_v<Parameters, const CMPIValue*> || ...))
            return std::get<sizeof...(Parameters) - 1>(std::tie(parameters...));
        else
            return CMPI_null;
    }

    static const Tape::Number* replay(const Tape::Number* numbers, Tape::Word* words)
    {
        return make(numbers, words, std::index_sequence_for<Parameters...>());
    }

    template <std::size_t... I>
    static const Tape::Number* make(const Tape::Number* numbers, [[maybe_unused]] Tape::Word* words,
                                    std::index_sequence<I...> /*places*/)
    {
        if constexpr (std::is_same_v<Result, CMPIData>)
            words[numbers[sizeof...(I)]].value = Call::call(argument<Parameters>(numbers[I], words)...).value;
        else if constexpr (bringsObject)
            words[numbers[sizeof...(I)]].pointer = Call::call(argument<Parameters>(numbers[I], words)...);
        else
            static_cast<void>(Call::call(argument<Parameters>(numbers[I], words)...));
        return numbers + sizeof...(I) + (bringsObject ? 1 : 0);
    }
};

} // namespace bench

#endif
