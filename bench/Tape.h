/// \file
/// The floor under the library's cost: a tape of the calls that an operation of the library made of the
/// broker's function tables and of the four support libraries. Replaying it makes the same calls in the same
/// order with the same arguments, and does nothing else: no record, no map, no text is put together.
///
/// A call is the number of its step and the numbers of its arguments, side by side in one array. A number is
/// that of a word: a constant, whose text or value the tape holds, or what an earlier call of the tape has
/// brought. What a call brings and no later one takes is dropped at once.
///
/// Replaying costs 2 to 4 ns for each call on top of the call itself, measured with steps that read their
/// arguments and call nothing: 81 of 4,800 ns for an instance of the system device association, 210 of some
/// 8,000 ns for one of an indicator.
#ifndef BENCH_TAPE_H
#define BENCH_TAPE_H

#include <cstddef>
#include <cstdint>
#include <deque>
#include <string>
#include <vector>

#include <cmpift.h>

namespace bench {

/// The objects that a request hands to an operation. All may be null where the calls need none.
struct TapeRequest
{
    const CMPIBroker* broker;
    const CMPIContext* ctx;
    const CMPIResult* rslt;
    const CMPIObjectPath* ref;
};

/// Recorded by record() of Recorder.h.
class Tape
{
public:
    using Number = std::uint32_t;

    /// An argument, or what a call has brought; an object of a support library lives in its word.
    union Word
    {
        std::uint64_t number;
        void* pointer;
        CMPIValue value;
    };

    /// Words that every tape has.
    enum : Number
    {
        nullWord,
        brokerWord,
        contextWord,
        resultWord,
        pathWord,
        statusWord,  ///< where calls leave their status
        droppedWord, ///< for what no call can take as an argument
        countWord,   ///< for a number that a call changes
        fixedWords
    };

    /// Stands in the number of a word that is a text in the place of a value.
    static constexpr Number textInPlaceOfValue = 1U << 31;

    /// One kind of call.
    struct Step
    {
        std::string name;
        std::size_t numbers; ///< how many of them a call has, that of its result among them
        /// Makes a call. \return what follows its numbers
        const Number* (*make)(const Number* numbers, Word* words);
    };

    /// One without calls.
    Tape();
    Tape(Tape&&) = default;
    Tape& operator=(Tape&&) = default;
    Tape(const Tape&) = delete;
    Tape& operator=(const Tape&) = delete;
    ~Tape() = default;

    /// \return the number of the step, for every tape of this process
    static Number addStep(Step step);

    /// Makes the calls. The request is one as the tape was recorded in.
    void replay(const TapeRequest& request);

    /// Each call as its name with its arguments: texts quoted, objects as "#" with the number of their word.
    [[nodiscard]] std::vector<std::string> calls() const;

private:
    friend class Recorder;
    static std::vector<Step>& steps();

    std::vector<Number> code;
    std::vector<Word> words;
    std::vector<std::string> shown; ///< each of the words in calls()

    // What words point to.
    std::deque<std::string> texts;
    std::deque<std::wstring> wideTexts;
    std::deque<std::vector<const char*>> lists;
};

} // namespace bench

#endif
