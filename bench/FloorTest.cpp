// The floor makes the library's calls, all of them, in the same order with the same arguments; and what the
// library holds on top of what the broker and the support libraries do.

#include "Bed.h"
#include "RecordedCalls.h"

#include "testing/Allocations.h"
#include "testing/RecordingBroker.h"

#include <cstddef>
#include <string>
#include <tuple>
#include <vector>

#include <gtest/gtest.h>

namespace bench {
namespace {

/// Calls of the broker and of the support libraries, in the order in which they were made.
std::vector<std::string> sequence(const RecordingBroker& broker)
{
    const std::vector<std::string> support = RecordedCalls::all();
    const std::vector<std::string> calls = broker.calls();
    const std::vector<std::size_t> supportBefore = broker.othersBeforeCalls();
    std::vector<std::string> all;
    std::size_t next = 0;
    for (std::size_t call = 0; call < calls.size(); ++call) {
        for (; next < supportBefore[call]; ++next)
            all.push_back(support[next]);
        all.push_back(calls[call]);
    }
    all.insert(all.end(), support.begin() + static_cast<std::ptrdiff_t>(next), support.end());
    return all;
}

std::vector<std::string> callsOf(Bed& bed, const Task& task, Side side)
{
    RecordingBroker broker(bed.host, RecordedCalls::count);
    bed.run(task, side, [&](const RequestHandles& handles, const CMPIObjectPath* path, const auto& run) {
        broker.name(handles.ctx, "ctx");
        broker.name(path, "ref");
        broker.clear();
        RecordedCalls::clear();
        run();
    });
    return sequence(broker);
}

/// The two sequences side by side from a little before the place where they part.
std::string difference(const std::vector<std::string>& library, const std::vector<std::string>& floor)
{
    constexpr std::size_t shownBefore = 3;
    constexpr std::size_t shownAfter = 3;
    std::size_t place = 0;
    while (place < library.size() && place < floor.size() && library[place] == floor[place])
        ++place;
    std::string text = "they part at call " + std::to_string(place) + ":\n";
    for (std::size_t i = place - std::min(place, shownBefore); i <= place + shownAfter; ++i)
        text += "  library  " + (i < library.size() ? library[i] : "-") + "\n  floor    " +
                (i < floor.size() ? floor[i] : "-") + "\n";
    return text;
}

class FloorTest : public ::testing::TestWithParam<Task>
{};

TEST_P(FloorTest, MakesTheCallsOfTheLibrary)
{
    Bed bed;
    for (const std::size_t count : {1U, 2U, 10U}) {
        bed.setIndicators(count);
        const std::vector<std::string> library = callsOf(bed, GetParam(), Side::library);
        const std::vector<std::string> floor = callsOf(bed, GetParam(), Side::floor);
        EXPECT_FALSE(library.empty());
        EXPECT_TRUE(library == floor) << "with " << count << " indicators " << difference(library, floor);
    }
}

/// What the library has allocated itself, at its peak: neither in a call of the broker nor in one of the
/// support libraries, but for the texts that those return to it.
std::ptrdiff_t heldBy(Bed& bed, const Task& task, std::size_t indicators)
{
    Allocations::Use use;
    RecordingBroker pausing(bed.host);
    bed.setIndicators(indicators);
    bed.run(task, Side::library, [&](const auto&, const auto*, const auto& run) {
        Allocations::startCounting();
        run();
        use = Allocations::stopCounting();
    });
    return use.peak;
}

TEST_P(FloorTest, HoldsAtMostOneKibibyteForAnIndicator)
{
    // The list of records has just doubled its place: it is never less filled.
    constexpr std::size_t count = 129;
    Bed bed;
    heldBy(bed, GetParam(), 1); // what is allocated once
    const std::ptrdiff_t each = heldBy(bed, GetParam(), count) / static_cast<std::ptrdiff_t>(count);
    RecordProperty("bytes_for_an_indicator", std::to_string(each));
    EXPECT_LE(each, 1024);
}

INSTANTIATE_TEST_SUITE_P(AllOperations, FloorTest, ::testing::ValuesIn(allTasks()),
                         [](const auto& task) { return task.param.operation.name; });

} // namespace

void PrintTo(const Task& task, std::ostream* stream)
{
    *stream << task.operation.name;
}

} // namespace bench
