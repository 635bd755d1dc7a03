#include "serve/Enumerations.h"

#include "cim/Values.h"
#include "serve/ValueReader.h"

#include <algorithm>
#include <iterator>
#include <random>
#include <utility>

namespace cimhost::serve {

namespace {

/// A name that nobody guesses and that means nothing to a server started anew.
std::string newContext()
{
    std::random_device source;
    std::string context;
    for (int part = 0; part < 4; ++part)
        context += (part == 0 ? "" : "-") + std::to_string(source());
    return context;
}

/// An answer has either paths or instances.
std::size_t sizeOf(const cim::Answer& answer)
{
    return answer.paths.size() + answer.instances.size();
}

} // namespace

Enumerations::Enumerations(const EnumerationLimits& limits, std::function<Clock::time_point()> now)
    : limits_(limits),
      now_(std::move(now))
{}

void Enumerations::checkOpening(const Question& question)
{
    if (question.timeout && (*question.timeout == 0 || *question.timeout > limits_.longest.count()))
        throw ValueError(invalidOperationTimeout, "found an OperationTimeout of " +
                                                      std::to_string(*question.timeout) + ", expected 1 to " +
                                                      std::to_string(limits_.longest.count()) + " seconds");
    const std::lock_guard<std::mutex> lock(mutex_);
    requireRoom();
}

Reply Enumerations::open(const Question& question, cim::Answer answer)
{
    const std::lock_guard<std::mutex> lock(mutex_);
    requireRoom(); // others may have been opened since the check
    requireRoomFor(sizeOf(answer) - std::min<std::size_t>(question.mostItems, sizeOf(answer)));
    Held held{question.request.target.nameSpace, question.items, limits_.usual, {}, std::move(answer)};
    if (question.timeout)
        held.timeout = std::chrono::seconds(*question.timeout);
    return nextPiece(held_.emplace(newContext(), std::move(held)).first, question.mostItems);
}

Reply Enumerations::pull(const Question& question)
{
    const std::lock_guard<std::mutex> lock(mutex_);
    const auto place = find(question);
    if (place->second.items != question.items)
        throw ValueError(invalidEnumerationContext, "the enumeration was opened for another kind of items");
    return nextPiece(place, question.mostItems);
}

void Enumerations::close(const Question& question)
{
    const std::lock_guard<std::mutex> lock(mutex_);
    held_.erase(find(question));
}

std::uint64_t Enumerations::count(const Question& question)
{
    const std::lock_guard<std::mutex> lock(mutex_);
    const Held& held = find(question)->second;
    return sizeOf(held.rest) - held.given;
}

void Enumerations::giveUpForgotten()
{
    for (auto entry = held_.begin(); entry != held_.end();)
        entry = entry->second.end < now_() ? held_.erase(entry) : std::next(entry);
}

void Enumerations::requireRoom()
{
    giveUpForgotten();
    if (held_.size() >= limits_.open)
        throw ValueError(serverLimitsExceeded,
                         std::to_string(limits_.open) + " enumerations are open, which is the most");
}

void Enumerations::requireRoomFor(std::size_t items)
{
    for (const auto& [context, held] : held_)
        items += sizeOf(held.rest) - held.given;
    if (items > limits_.items)
        throw ValueError(serverLimitsExceeded, "the enumerations that are open would have " +
                                                   std::to_string(items) + " items left, expected at most " +
                                                   std::to_string(limits_.items));
}

Enumerations::Place Enumerations::find(const Question& question)
{
    giveUpForgotten();
    const auto place = held_.find(question.context);
    if (place == held_.end() || !cim::sameName(place->second.nameSpace, question.request.target.nameSpace))
        throw ValueError(invalidEnumerationContext, "there is no such enumeration in " +
                                                        question.request.target.nameSpace +
                                                        ", or it has been given up");
    return place;
}

Reply Enumerations::nextPiece(Place place, std::uint32_t most)
{
    Held& held = place->second;
    Reply piece;
    piece.answer.paths = held.rest.paths.take(held.given, most);
    piece.answer.instances = held.rest.instances.take(held.given, most);
    held.given += sizeOf(piece.answer);
    held.end = now_() + held.timeout;
    if (held.given < sizeOf(held.rest))
        piece.context = place->first;
    else
        held_.erase(place);
    return piece;
}

} // namespace cimhost::serve
