// A broker that lets any single call fail, in any way, and a memory that lets any single allocation fail: no
// operation may crash or leak, and the next request is whole.

#include "support/Allocations.h"
#include "support/Operations.h"
#include "support/ProviderFixture.h"

#include <algorithm>
#include <iostream>
#include <new>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using ::testing::AnyOf;
using ::testing::IsEmpty;
using ::testing::Not;

namespace {

class EveryOperation : public ProviderFixture, public ::testing::WithParamInterface<Operation>
{
protected:
    EveryOperation()
    {
        MadeInventory::set({{"a", "1", 1, 1}, {"b", "2", 20, 3}});
        setComputerSystems({"one", "two"});
    }

    /// Runs the operation in the open request.
    CMPIStatus run()
    {
        const auto path = [this](const std::string& className, const std::string& key,
                                 const std::string& value) {
            const Allocations::Pause pause;
            return key.empty() ? ref(className) : ref(className, {{key, value}});
        };
        return GetParam().run({host.cmpiBroker(), ctx(), rslt(), path});
    }

    /// The calls of one whole request of its own.
    std::vector<std::string> wholeRequest()
    {
        newRequest();
        RecordedLog::clear();
        run();
        return broker.calls();
    }
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

TEST_P(EveryOperation, OutlivesEveryFailureOfTheBroker)
{
    const std::vector<std::string> whole = wholeRequest();
    ASSERT_THAT(whole, Not(IsEmpty()));
    int runs = 0;
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus,
                                  Failure::wrongValue, Failure::nullState, Failure::lostHandle}) {
        for (std::size_t nth = 1; nth <= whole.size(); ++nth) {
            newRequest();
            RecordedLog::clear();
            broker.fail("", static_cast<int>(nth), failure);
            const CMPIStatus status = run();
            EXPECT_THAT(status.rc, AnyOf(CMPI_RC_OK, CMPI_RC_ERR_FAILED, CMPI_RC_ERR_INVALID_NAMESPACE,
                                         CMPI_RC_ERR_NOT_FOUND, CMPI_RC_ERR_INVALID_HANDLE,
                                         CMPI_RC_ERR_INVALID_PARAMETER))
                << whole[nth - 1] << ", which failed; " << message(status).value_or("no message");
            ASSERT_GE(broker.calls().size(), nth);
            EXPECT_EQ(broker.calls()[nth - 1], whole[nth - 1])
                << "what comes before a failure is not changed by it";
            EXPECT_EQ(MadeInventory::openCursors(), 0);
            Logged::lines(); // each line whole and given twice
            ++runs;
        }
    }
    EXPECT_EQ(wholeRequest(), whole) << "the next request is whole";
    std::cout << runs << " runs with one failing call each\n";
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
        "TAVRO_Glimmark_GetInstance_WithoutKeys", "TAVRO_GlimmarkCapabilities_EnumInstanceNames",
        "TAVRO_GlimmarkCapabilities_EnumInstances", "TAVRO_GlimmarkCapabilities_GetInstance_ByIdentifier"};
    if (std::count(withoutInventory.begin(), withoutInventory.end(), GetParam().name) > 0) {
        EXPECT_NO_THROW(run());
    } else {
        EXPECT_THROW(run(), int);
    }
    EXPECT_EQ(MadeInventory::openCursors(), 0);
    MadeInventory::throwAt(std::nullopt, nullptr);
    EXPECT_EQ(wholeRequest(), whole) << "the next request is whole";
}
