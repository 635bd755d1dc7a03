#include "cli/watch/View.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/InstanceTable.h"
#include "cli/Output.h"

#include <algorithm>
#include <numeric>
#include <sstream>
#include <utility>

namespace cimhost::cli {

namespace {

constexpr int markedFor = 5;          ///< answers
constexpr std::size_t mostRecent = 5; ///< changes, and messages
constexpr std::size_t signColumns = 2;
constexpr const char* plain = "\x1B[0m";

/// Values of HealthState in the CIM schema.
constexpr std::uint64_t ok = 5;
constexpr std::uint64_t degraded = 10;
constexpr std::uint64_t minorFailure = 15;

std::uint64_t healthOf(const cim::Instance& instance)
{
    const cim::Value* const value = cim::findProperty(instance, "HealthState");
    if (value == nullptr || value->items.empty())
        return 0;
    const auto* const number = std::get_if<std::uint64_t>(&value->items.front());
    return number == nullptr ? 0 : *number;
}

/// Nothing where there is no state to tell.
const char* colourOf(const cim::Instance& instance)
{
    const std::uint64_t health = healthOf(instance);
    if (health >= minorFailure)
        return "\x1B[31m"; // red
    if (health >= degraded)
        return "\x1B[33m";                 // yellow
    return health == ok ? "\x1B[32m" : ""; // green
}

std::vector<std::string> linesOf(const std::string& text)
{
    std::istringstream stream(text);
    std::vector<std::string> lines;
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}

template <class Item>
void keepLast(std::vector<Item>& items)
{
    if (items.size() > mostRecent)
        items.erase(items.begin(), items.end() - static_cast<std::ptrdiff_t>(mostRecent));
}

std::string coloured(const std::string& text, const std::string& colour, bool isColoured)
{
    return isColoured && !colour.empty() ? colour + text + plain : text;
}

} // namespace

std::vector<std::string> Watched::take(const cim::Answer& answer, const std::string& time)
{
    std::vector<std::string> news;
    time_ = time;
    const std::string error = answer.status.code == CMPI_RC_OK ? "" : statusLine(answer.status);
    if (!error.empty()) {
        if (error != error_)
            news.push_back(time + ' ' + error);
        error_ = error;
        return news;
    }
    error_.clear();

    const std::vector<Change> changes = changesBetween(instances_, answer.instances);
    for (const Change& change : changes)
        news.push_back(time + ' ' + changeText(change));
    instances_ = answer.instances;
    if (!std::exchange(isFirst_, false)) {
        mark(changes);
        for (const Change& change : changes)
            recent_.push_back({time, change});
        keepLast(recent_);
    }
    return news;
}

void Watched::tell(const std::vector<std::string>& messages)
{
    messages_.insert(messages_.end(), messages.begin(), messages.end());
    keepLast(messages_);
}

void Watched::mark(const std::vector<Change>& changes)
{
    for (auto entry = marks_.begin(); entry != marks_.end();)
        entry = --entry->second.answersLeft == 0 ? marks_.erase(entry) : std::next(entry);
    for (const Change& change : changes)
        if (change.kind != Change::vanished)
            marks_[cim::lookupText(change.instance.path)] = {change.kind == Change::appeared ? '+' : '*',
                                                             markedFor};
}

char Watched::signOf(const cim::Instance& instance) const
{
    const auto found = marks_.find(cim::lookupText(instance.path));
    return found == marks_.end() ? ' ' : found->second.sign;
}

/// What was answered, and when.
std::string Watched::stateLine() const
{
    const std::string count =
        std::to_string(instances_.size()) + (instances_.size() == 1 ? " instance" : " instances");
    return error_.empty() ? count + " at " + time_ : "no answer at " + time_ + "; before: " + count;
}

/// What stands below the table: changes and messages, the last of them where the terminal is low; how to end.
std::vector<std::string> Watched::linesBelow(TerminalSize size) const
{
    const std::size_t most = std::clamp<std::size_t>(size.rows / 8, 1, mostRecent);
    std::vector<std::string> lines;
    if (!recent_.empty())
        lines.emplace_back();
    for (std::size_t i = recent_.size() - std::min(most, recent_.size()); i < recent_.size(); ++i) {
        const std::string time = recent_[i].time + ' ';
        const std::size_t left = size.columns > time.size() ? size.columns - time.size() : 0;
        lines.push_back(time + changeText(recent_[i].change, left));
    }
    if (!messages_.empty())
        lines.emplace_back();
    for (std::size_t i = messages_.size() - std::min(most, messages_.size()); i < messages_.size(); ++i)
        lines.push_back(shortenedAtEnd(cim::printable(messages_[i]), size.columns));
    lines.emplace_back();
    lines.emplace_back("q ends");
    for (std::string& line : lines)
        line = cropped(line, size.columns);
    return lines;
}

std::vector<std::string> Watched::frame(const std::string& title, TerminalSize size, bool isColoured) const
{
    std::vector<std::string> lines{shortenedAtEnd(title + ": " + stateLine(), size.columns)};
    if (!error_.empty())
        lines.push_back(coloured(shortenedAtEnd(error_, size.columns), "\x1B[31m", isColoured));
    lines.emplace_back();

    const std::size_t besideSign = size.columns > signColumns ? size.columns - signColumns : 0;
    const std::vector<std::string> table = linesOf(stateTable(instances_, isWide_ ? anyWidth : besideSign));
    // After an error an empty table would look like an empty answer.
    const std::size_t headings = !instances_.empty() ? 2 : error_.empty() ? 1 : 0;
    for (std::size_t i = 0; i < headings; ++i)
        lines.push_back(cropped("  " + table[i], size.columns));

    const std::vector<std::string> below = linesBelow(size);
    const std::size_t used = lines.size() + below.size();
    const std::size_t room = size.rows > used ? size.rows - used : 0;
    std::vector<std::size_t> order(instances_.size());
    std::iota(order.begin(), order.end(), 0);
    if (order.size() > room)
        std::stable_partition(order.begin(), order.end(), [&](std::size_t i) {
            return signOf(instances_[i]) != ' ' || healthOf(instances_[i]) >= degraded;
        });
    const bool isWhole = order.size() <= room;
    const std::size_t shown = isWhole || room == 0 ? std::min(order.size(), room) : room - 1;
    for (std::size_t i = 0; i < shown; ++i) {
        const cim::Instance& instance = instances_[order[i]];
        const char sign = signOf(instance);
        const std::string row =
            cropped(std::string(1, sign) + ' ' + table[headings + order[i]], size.columns);
        lines.push_back(
            coloured(row, std::string(sign == ' ' ? "" : "\x1B[1m") + colourOf(instance), isColoured));
    }
    if (!isWhole && room > 0)
        lines.push_back(cropped("  ... and " + std::to_string(order.size() - shown) + " more", size.columns));

    lines.insert(lines.end(), below.begin(), below.end());
    lines.resize(std::min(lines.size(), size.rows));
    return lines;
}

} // namespace cimhost::cli
