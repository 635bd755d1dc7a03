// Brokers differ in what the interface leaves open, and some break it: no operation answers less for that.

#include "broker/Habits.h"
#include "testing/Operations.h"
#include "testing/ProviderFixture.h"

#include <string>
#include <tuple>

#include <gtest/gtest.h>

namespace {

class Habits : public ProviderFixture,
               public ::testing::WithParamInterface<std::tuple<const cimhost::Habits*, Operation>>
{
protected:
    Habits()
    {
        MadeInventory::set({{"a", "1", 1, 1}, {"b", "2", 20, 3}});
        setComputerSystems({"one", "two"});
        request.reset(); // each question is a request of its own
    }

    cimhost::Broker withHabits{
        computerSystemRegistration(), {providerDirectory()}, {}, std::get<0>(GetParam())};
};

INSTANTIATE_TEST_SUITE_P(All, Habits,
                         ::testing::Combine(::testing::Values(&cimhost::sfcbHabits(),
                                                              &cimhost::pegasusHabits()),
                                            ::testing::ValuesIn(allOperations())),
                         [](const auto& suite) {
                             return std::string(std::get<0>(suite.param)->name) + "_" +
                                    std::get<1>(suite.param).name;
                         });

} // namespace

TEST_P(Habits, DoNotChangeAnAnswer)
{
    const Operation& operation = std::get<1>(GetParam());
    EXPECT_EQ(ask(withHabits, operation), ask(host, operation));
}
