// A broker without services, a memory that lets any single allocation fail, an inventory that throws: no
// operation crashes or leaks, and the next request is whole.

#include "FailureFixture.h"

#include <algorithm>
#include <cstddef>
#include <exception>
#include <iostream>
#include <new>
#include <optional>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using ::testing::AnyOf;
using ::testing::Contains;
using ::testing::Not;
using ::testing::StartsWith;

namespace {

class EveryOperation : public FailureFixture, public ::testing::WithParamInterface<Operation>
{
protected:
    EveryOperation()
    {
        MadeInventory::set({{"a", "1", 1, 1}, {"b", "2", 20, 3}});
        setComputerSystems({"one", "two"});
    }

    CMPIStatus run() { return FailureFixture::run(GetParam()); }
    CMPIStatus runServedBy(const CMPIBroker& other) { return FailureFixture::run(GetParam(), &other); }
    std::vector<std::string> wholeRequest() { return FailureFixture::wholeRequest(GetParam()); }
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
