// A broker that lets any single call fail, in any way, and a memory that lets any single allocation fail:
// each operation answers, tells and traces what is described for it, does not crash or leak, and the next
// request is whole.

#include "support/Allocations.h"
#include "support/DescribedProviders.h"
#include "support/Operations.h"
#include "support/ProviderFixture.h"
#include "support/SampleInventories.h"

#include <algorithm>
#include <cstddef>
#include <cstdlib>
#include <iostream>
#include <new>
#include <string>
#include <tuple>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace cim = cimhost::cim;

using ::testing::AnyOf;
using ::testing::Contains;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::StartsWith;

namespace {

class FailingBroker : public ProviderFixture
{
protected:
    /// Runs an operation in the open request.
    CMPIStatus run(const Operation& operation) { return run(operation, host.cmpiBroker()); }

    CMPIStatus run(const Operation& operation, const CMPIBroker* servingBroker)
    {
        const auto path = [this](const cim::ObjectPath& wanted) {
            const Allocations::Pause pause;
            return ref(wanted);
        };
        return operation.run({servingBroker, ctx(), rslt(), path});
    }

    /// The calls of one whole request of its own.
    std::vector<std::string> wholeRequest(const Operation& operation)
    {
        newRequest();
        RecordedLog::clear();
        run(operation);
        return broker.calls();
    }
};

// Every call of every operation, failing in every way.

struct Inventory
{
    std::string name;
    std::vector<MadeInventory::Node> nodes;
    std::vector<std::string> computerSystems;
    std::size_t mostCalls = 0; ///< how many calls of an operation are to fail; 0: all of them
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
    return {
        {"TwoIndicators", {{"a", "1", 1, 1}, {"b", "2", 20, 3}}, {"one", "two"}},
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

class EveryCall : public FailingBroker,
                  public ::testing::WithParamInterface<std::tuple<Inventory, std::size_t>>
{
protected:
    EveryCall()
    {
        const Inventory& inventory = std::get<0>(GetParam());
        MadeInventory::set(inventory.nodes);
        setComputerSystems(inventory.computerSystems);
    }

    Course courseOf(const Operation& operation, std::size_t nth, Failure failure)
    {
        newRequest();
        RecordedLog::clear();
        if (nth > 0)
            broker.fail("", static_cast<int>(nth), failure);
        const CMPIStatus status = run(operation);
        EXPECT_EQ(MadeInventory::openCursors(), 0);
        return {timeline(), {answer(status), request->doneCount()}};
    }

    const Operation library = allOperations().at(std::get<1>(GetParam()));
    const Operation described = allOperations(describedEntryPoints()).at(std::get<1>(GetParam()));
};

std::string nameOf(const ::testing::TestParamInfo<EveryCall::ParamType>& suite)
{
    return std::get<0>(suite.param).name + "_" + allOperations().at(std::get<1>(suite.param)).name;
}

INSTANTIATE_TEST_SUITE_P(All, EveryCall,
                         ::testing::Combine(::testing::ValuesIn(inventories()),
                                            ::testing::Range<std::size_t>(0, allOperations().size())),
                         nameOf);

// Every allocation of every operation.

class EveryOperation : public FailingBroker, public ::testing::WithParamInterface<Operation>
{
protected:
    EveryOperation()
    {
        MadeInventory::set({{"a", "1", 1, 1}, {"b", "2", 20, 3}});
        setComputerSystems({"one", "two"});
    }

    CMPIStatus run() { return FailingBroker::run(GetParam()); }
    CMPIStatus runServedBy(const CMPIBroker& other) { return FailingBroker::run(GetParam(), &other); }
    std::vector<std::string> wholeRequest() { return FailingBroker::wholeRequest(GetParam()); }
};

/// How many lines the inventory collection has written.
std::size_t linesOfTheCollection()
{
    const auto lines = RecordedLog::lines();
    return static_cast<std::size_t>(
        std::count_if(lines.begin(), lines.end(),
                      [](const RecordedLog::Line& line) { return line.category == "Mavrel.Glimmark"; }));
}

INSTANTIATE_TEST_SUITE_P(All, EveryOperation, ::testing::ValuesIn(allOperations()),
                         [](const auto& suite) { return suite.param.name; });

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

TEST_P(EveryOperation, OutlivesABrokerThatLacksServices)
{
    const std::vector<std::string> whole = wholeRequest();
    const CMPIBrokerEncFT noServices{};
    const CMPIBrokerFT noUpCalls{};
    CMPIBroker bare = *host.cmpiBroker();
    bare.eft = &noServices;
    bare.bft = &noUpCalls;
    newRequest();
    const CMPIStatus status = runServedBy(bare);
    // Not found: what the path says of a key that it lacks.
    const auto expected = AnyOf(CMPI_RC_OK, CMPI_RC_ERR_FAILED, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_THAT(status.rc, expected);
    EXPECT_EQ(status.msg, nullptr) << "there is nobody who makes strings";
    EXPECT_THAT(broker.calls(), Not(Contains(StartsWith("new"))));
    EXPECT_EQ(MadeInventory::openCursors(), 0);

    // Without up-calls alone, the broker has no computer systems.
    bare.eft = host.cmpiBroker()->eft;
    newRequest();
    EXPECT_THAT(runServedBy(bare).rc, expected);
    EXPECT_THAT(broker.calls(), Not(Contains(StartsWith("enumerate"))));
    EXPECT_EQ(wholeRequest(), whole) << "the next request is whole";
}

TEST_P(EveryOperation, HandsAnExhaustedMemoryOnToTheBroker)
{
    const std::vector<std::string> whole = wholeRequest();
    const std::size_t wholeCollection = linesOfTheCollection();
    int runs = 0;
    for (bool failed = true; failed; ++runs) {
        newRequest();
        RecordedLog::clear();
        Allocations::failNth(static_cast<std::size_t>(runs) + 1);
        bool thrown = false;
        try {
            run();
        } catch (const std::bad_alloc&) {
            thrown = true;
        }
        failed = Allocations::stop();
        EXPECT_EQ(MadeInventory::openCursors(), 0);
        EXPECT_TRUE(!thrown || failed);
        // Only the inventory collection keeps a failure to itself and goes on without records, and the stream
        // of a trace line, as streams do, without the rest of the line.
        if (failed && !thrown && linesOfTheCollection() == wholeCollection) {
            EXPECT_EQ(broker.calls(), whole) << "allocation " << runs + 1;
        }
    }
    EXPECT_EQ(wholeRequest(), whole) << "the next request is whole";
    std::cout << runs - 1 << " runs with one failing allocation each\n";
}

TEST_P(EveryOperation, LetsOtherExceptionsOfTheInventoryPass)
{
    const std::vector<std::string> whole = wholeRequest();
    MadeInventory::throwAt(1, std::make_exception_ptr(7));
    newRequest();
    // The capabilities need no inventory, except on the way that searches; without keys nothing is collected.
    const std::vector<std::string> withoutInventory{
        "TAVRO_Glimmark_GetInstance_WithoutKeys",
        "TAVRO_GlimmarkCapabilities_EnumInstanceNames",
        "TAVRO_GlimmarkCapabilities_EnumInstances",
        "TAVRO_GlimmarkCapabilities_GetInstance_ByIdentifier",
        "TAVRO_GlimmarkCapabilities_GetInstance_WithoutKeys",
        "TAVRO_GlimmarkElementCapabilities_GetInstance_WithoutKeys",
        "TAVRO_GlimmarkSystemDevice_GetInstance_WithoutKeys"};
    if (std::count(withoutInventory.begin(), withoutInventory.end(), GetParam().name) > 0) {
        EXPECT_NO_THROW(run());
    } else {
        EXPECT_THROW(run(), int);
    }
    EXPECT_EQ(MadeInventory::openCursors(), 0);
    MadeInventory::throwAt(std::nullopt, nullptr);
    EXPECT_EQ(wholeRequest(), whole) << "the next request is whole";
}
