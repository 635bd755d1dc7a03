// A broker that lets any single call fail, in any way: each operation answers, tells and traces what is
// described for that failure, does not crash or leak, and the next request is whole. So do they where the
// broker has the habits of a real one.

#include "FailureFixture.h"
#include "described/Providers.h"

#include "broker/Habits.h"
#include "testing/SampleInventories.h"

#include <algorithm>
#include <cstddef>
#include <cstdlib>
#include <iostream>
#include <string>
#include <tuple>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using ::testing::IsEmpty;
using ::testing::Not;

namespace {

struct Inventory
{
    std::string name;
    std::vector<MadeInventory::Node> nodes;
    std::vector<std::string> computerSystems;
    std::size_t mostCalls = 0;               ///< how many calls of an operation are to fail; 0: all of them
    const cimhost::Habits* habits = nullptr; ///< of the broker that serves it
};

/// A walk repeats itself for each indicator: of the longer ones, calls all over the walk fail, or all of them
/// where the environment has GLIMMARK_FAULTS=all, for some minutes.
std::size_t mostCallsOfLongWalks()
{
    const char* const wanted = std::getenv("GLIMMARK_FAULTS");
    return wanted != nullptr && std::string(wanted) == "all" ? 0 : 12;
}

void PrintTo(const Inventory& inventory, std::ostream* stream)
{
    *stream << inventory.name;
}

std::vector<Inventory> inventories()
{
    const std::vector<MadeInventory::Node> two{{"a", "1", 1, 1}, {"b", "2", 20, 3}};
    return {
        {"TwoIndicators", two, {"one", "two"}},
        {"TwoIndicatorsLikeSfcb", two, {"one", "two"}, mostCallsOfLongWalks(), &cimhost::sfcbHabits()},
        {"TwoIndicatorsLikePegasus", two, {"one", "two"}, mostCallsOfLongWalks(), &cimhost::pegasusHabits()},
        {"NoIndicators", {{"Fan", "1", 1, 1, 6}}, {"one"}},
        {"SmallServer", sampleInventory("small-server.json"), {"one"}, mostCallsOfLongWalks()},
        {"EdgeCases", sampleInventory("edge-cases.json"), {"one"}},
        {"EdgeCasesReadable", sampleInventory("edge-cases-readable.json"), {"one"}, mostCallsOfLongWalks()}};
}

/// All that a request brings about.
struct Course
{
    std::vector<std::string> timeline;
    Outcome outcome;
};

/// Where two of them part; empty: they are the same.
std::string difference(const Course& actual, const Course& described)
{
    const auto& [lines, expected] = std::tie(actual.timeline, described.timeline);
    const auto common = static_cast<std::ptrdiff_t>(std::min(lines.size(), expected.size()));
    const auto parting = std::mismatch(lines.begin(), lines.begin() + common, expected.begin());
    const auto textAt = [](auto position, const auto& list) {
        return position != list.end() ? *position : "the end";
    };
    if (parting.first != lines.end() || parting.second != expected.end())
        return textAt(parting.first, lines) + ", described is " + textAt(parting.second, expected);
    if (actual.outcome == described.outcome)
        return "";
    return ::testing::PrintToString(actual.outcome) + ", described is " +
           ::testing::PrintToString(described.outcome);
}

class EveryCall : public FailureFixture,
                  public ::testing::WithParamInterface<std::tuple<Inventory, std::size_t>>
{
protected:
    EveryCall() : FailureFixture(std::get<0>(GetParam()).habits)
    {
        const Inventory& inventory = std::get<0>(GetParam());
        MadeInventory::set(inventory.nodes);
        setComputerSystems(inventory.computerSystems);
    }

    Course courseOf(const Operation& operation, std::size_t nth, Failure failure)
    {
        newRequest();
        if (nth > 0)
            broker.fail("", static_cast<int>(nth), failure);
        const CMPIStatus status = run(operation);
        EXPECT_EQ(MadeInventory::openCursors(), 0);
        return {timeline(), {answer(status), request->doneCount()}};
    }

    const Operation library = allOperations().at(std::get<1>(GetParam()));
    const Operation described = allOperations(described::entryPoints()).at(std::get<1>(GetParam()));
};

std::string nameOf(const ::testing::TestParamInfo<EveryCall::ParamType>& suite)
{
    return std::get<0>(suite.param).name + "_" + allOperations().at(std::get<1>(suite.param)).name;
}

INSTANTIATE_TEST_SUITE_P(All, EveryCall,
                         ::testing::Combine(::testing::ValuesIn(inventories()),
                                            ::testing::Range<std::size_t>(0, allOperations().size())),
                         nameOf);

} // namespace

TEST_P(EveryCall, FailsAsDescribed)
{
    const std::vector<std::string> whole = wholeRequest(library);
    ASSERT_THAT(whole, Not(IsEmpty()));
    ASSERT_EQ(difference(courseOf(library, 0, {}), courseOf(described, 0, {})), "") << "nothing fails";
    const std::size_t most = std::get<0>(GetParam()).mostCalls;
    const std::size_t step = most > 0 ? whole.size() / most + 1 : 1;
    int runs = 0;
    for (std::size_t nth = 1; nth <= whole.size(); nth += step) {
        for (const Failure failure : RecordingBroker::failuresOf(whole[nth - 1])) {
            const Course course = courseOf(library, nth, failure);
            EXPECT_EQ(difference(course, courseOf(described, nth, failure)), "")
                << "call " << nth << ", " << whole[nth - 1] << ", failed in way "
                << static_cast<int>(failure);
            ++runs;
        }
    }
    EXPECT_EQ(wholeRequest(library), whole) << "the next request is whole";
    std::cout << runs << " runs with one failing call each\n";
}
