/// \file
/// Answers that are given out in pieces (DMTF DSP0200, pulled enumerations).
#ifndef CIMHOST_SERVE_ENUMERATIONS_H
#define CIMHOST_SERVE_ENUMERATIONS_H

#include "serve/Message.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <string>

namespace cimhost::serve {

struct EnumerationLimits
{
    std::size_t open = 64;          ///< enumerations at once
    std::size_t items = 262144;     ///< held for all of them together
    std::chrono::seconds usual{60}; ///< how long one waits for its client that did not say
    std::chrono::seconds longest{300};
};

/// Holds what clients have not fetched yet. An enumeration that its client leaves alone for too long is
/// given up at the next call. Safe to use from several threads at once.
class Enumerations
{
public:
    using Clock = std::chrono::steady_clock;

    explicit Enumerations(const EnumerationLimits& limits = {},
                          std::function<Clock::time_point()> now = &Clock::now);

    /// What is refused before a provider is asked. \throws ValueError
    void checkOpening(const Question& question);

    /// The first piece of an answer; the rest is held unless it is empty.
    /// \param question  whose step is Step::open, and which was checked
    /// \throws ValueError  there are too many
    Reply open(const Question& question, cim::Answer answer);

    /// The next piece. \throws ValueError  there is no such enumeration
    Reply pull(const Question& question);

    /// \throws ValueError  there is no such enumeration
    void close(const Question& question);

    /// How many items are left. \throws ValueError  there is no such enumeration
    std::uint64_t count(const Question& question);

private:
    struct Held
    {
        std::string nameSpace;
        Items items;
        std::chrono::seconds timeout;
        Clock::time_point end;
        cim::Answer rest;
        std::size_t given = 0; ///< of the rest
    };
    using Place = std::map<std::string, Held>::iterator;

    // All with the mutex held.
    void giveUpForgotten();
    void requireRoom();
    void requireRoomFor(std::size_t items);
    Place find(const Question& question);
    Reply nextPiece(Place place, std::uint32_t most);

    EnumerationLimits limits_;
    std::function<Clock::time_point()> now_;
    std::mutex mutex_;
    std::map<std::string, Held> held_; ///< by the context
};

} // namespace cimhost::serve

#endif
