// Brokers call the providers from several threads, and make a provider again while another thread is in one
// of its operations: every answer is right and no trace line is torn.

#include "EntryPoints.h"
#include "support/Operations.h"
#include "support/ProviderFixture.h"

#include <atomic>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

class Threads : public ProviderFixture
{
protected:
    Threads() { MadeInventory::set({{"a", "1", 1, 1}, {"b", "2", 20, 3}}); }

    /// What an operation answers in a request of its own: number of paths, number of instances, code.
    static std::string answerOf(cimhost::Broker& asked, const Operation& operation)
    {
        cimhost::Request own(asked);
        const auto path = [&](const std::string& className, const std::string& key,
                              const std::string& value) {
            cimhost::cim::ObjectPath wanted{"", "root/cimv2", className, {}};
            if (!key.empty())
                wanted.keys.push_back({key, {CMPI_string, false, {value}}});
            return own.path(wanted);
        };
        const CMPIStatus status = operation.run({asked.cmpiBroker(), own.context(), own.result(), path});
        const auto answer = own.answer(status);
        return std::to_string(answer.paths.size()) + " paths, " + std::to_string(answer.instances.size()) +
               " instances, code " + std::to_string(answer.status.code);
    }
};

} // namespace

TEST_F(Threads, GetTheAnswersThatOneAloneGets)
{
    constexpr std::size_t threads = 8;
    constexpr int rounds = 3;
    // A broker without the recording layer, which gives objects their names one request at a time.
    cimhost::Broker plain(computerSystemRegistration(), {providerDirectory()});
    const std::vector<Operation> operations = allOperations();
    std::vector<std::string> expected;
    expected.reserve(operations.size());
    for (const Operation& operation : operations)
        expected.push_back(answerOf(plain, operation));
    RecordedLog::clear();

    std::atomic<int> wrong{0};
    std::vector<std::thread> running;
    running.reserve(threads);
    for (std::size_t thread = 0; thread < threads; ++thread) {
        running.emplace_back([&, thread] {
            for (int round = 0; round < rounds; ++round) {
                for (std::size_t i = 0; i < operations.size(); ++i) {
                    const std::size_t turn = (i + thread * 5) % operations.size();
                    if (answerOf(plain, operations[turn]) != expected[turn])
                        ++wrong;
                }
            }
        });
    }
    for (std::thread& thread : running)
        thread.join();

    EXPECT_EQ(wrong, 0);
    EXPECT_EQ(MadeInventory::openCursors(), 0);
    for (const RecordedLog::Line& line : RecordedLog::lines()) {
        const std::string where =
            line.function + "() in " + line.file + " [Line: " + std::to_string(line.line) + "]";
        ASSERT_THAT(line.text, ::testing::AnyOf(::testing::StartsWith("ENTERING: " + where),
                                                ::testing::StartsWith("EXITING: " + where)));
    }
}
