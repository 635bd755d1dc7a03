// Brokers call the providers from several threads, and make a provider again while another thread is in one
// of its operations, and the inventory changes at any time: every answer is right and no trace line is torn.

#include "testing/Operations.h"
#include "testing/ProviderFixture.h"
#include "testing/SampleInventories.h"

#include <algorithm>
#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <iostream>
#include <mutex>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

namespace ThreadsTests {

namespace {

using Nodes = std::vector<MadeInventory::Node>;

/// A thread that puts the next of several inventories in place, in turn, whenever it is asked to.
class Switcher
{
public:
    explicit Switcher(const std::vector<Nodes>& all) : inventories(all), thread([this] { run(); }) {}
    ~Switcher()
    {
        {
            const std::lock_guard lock(mutex);
            ending = true;
        }
        wanted.notify_one();
        thread.join();
    }
    Switcher(const Switcher&) = delete;
    Switcher& operator=(const Switcher&) = delete;

    /// Returns at once; the inventory changes soon after.
    void wantNext()
    {
        {
            const std::lock_guard lock(mutex);
            ++pending;
        }
        wanted.notify_one();
    }

private:
    void run()
    {
        std::size_t next = 0;
        std::unique_lock lock(mutex);
        for (;;) {
            wanted.wait(lock, [this] { return ending || pending > 0; });
            if (ending)
                return;
            --pending;
            lock.unlock();
            MadeInventory::set(inventories[next++ % inventories.size()]);
            lock.lock();
        }
    }

    const std::vector<Nodes>& inventories;
    std::mutex mutex;
    std::condition_variable wanted;
    int pending = 0;
    bool ending = false;
    std::thread thread; // last: it uses all the others
};

/// A line with each address replaced: what it is in every run.
std::string shapeOf(const RecordedLog::Line& line)
{
    std::string shape;
    for (std::size_t i = 0; i < line.text.size();) {
        if (line.text.compare(i, 2, "0x") != 0) {
            shape += line.text[i++];
            continue;
        }
        shape += "ADDRESS";
        i = std::min(line.text.find_first_not_of("0123456789abcdef", i + 2), line.text.size());
    }
    return shape;
}

std::set<std::string> shapes()
{
    std::set<std::string> all;
    for (const RecordedLog::Line& line : RecordedLog::lines())
        all.insert(shapeOf(line));
    return all;
}

class Threads : public ProviderFixture
{
protected:
    Threads()
    {
        const std::vector<Operation> fixed = fixedOperations();
        operations.insert(operations.end(), fixed.begin(), fixed.end());
    }

    /// What every operation answers to each of the inventories, one after the other.
    std::vector<std::vector<Outcome>> answers()
    {
        std::vector<std::vector<Outcome>> all;
        for (const Nodes& nodes : inventories) {
            MadeInventory::set(nodes);
            std::vector<Outcome>& outcomes = all.emplace_back();
            for (const Operation& operation : operations)
                outcomes.push_back(ask(plain, operation));
        }
        return all;
    }

    const std::vector<Nodes> inventories{{{"a", "1", 1, 1}, {"b", "2", 20, 3}},
                                         {},
                                         {{"b", "2", 21, 2}, {"c", "3", 0}, {"d", "4", 27, 4}},
                                         sampleInventory("small-server.json")};
    std::vector<Operation> operations = allOperations();
    // Without the recording layer, which gives objects their names one request at a time.
    cimhost::Broker plain{computerSystemRegistration(), {providerDirectory()}};
};

} // namespace

TEST_F(Threads, GetTheAnswersThatOneAloneGetsFromOneOfTheInventories)
{
    constexpr std::size_t threads = 8;
    constexpr std::size_t rounds = 3;
    const std::vector<std::vector<Outcome>> expected = answers();
    const std::set<std::string> expectedShapes = shapes();
    RecordedLog::clear();

    std::atomic<std::size_t> requests{0};
    std::atomic<int> wrong{0};
    std::vector<std::atomic<bool>> seen(inventories.size());
    const auto check = [&](std::size_t turn, const Outcome& outcome) {
        ++requests;
        bool right = false;
        for (std::size_t i = 0; i < expected.size(); ++i) {
            if (outcome == expected[i][turn]) {
                right = true;
                // The first operation's answers differ from inventory to inventory.
                if (turn == 0)
                    seen[i] = true;
            }
        }
        if (!right)
            ++wrong;
    };
    {
        Switcher switcher(inventories);
        std::vector<std::thread> running;
        running.reserve(threads);
        for (std::size_t thread = 0; thread < threads; ++thread) {
            running.emplace_back([&, thread] {
                for (std::size_t i = 0; i < rounds * operations.size(); ++i) {
                    const std::size_t turn = (i + thread * 5) % operations.size();
                    switcher.wantNext();
                    check(turn, ask(plain, operations[turn]));
                }
            });
        }
        for (std::thread& thread : running)
            thread.join();
    }

    EXPECT_EQ(wrong, 0);
    EXPECT_EQ(MadeInventory::openCursors(), 0);
    const auto used = std::count(seen.begin(), seen.end(), true);
    EXPECT_GT(used, 1) << "the inventory did not change";
    const std::vector<RecordedLog::Line> lines = RecordedLog::lines();
    for (const RecordedLog::Line& line : lines)
        ASSERT_EQ(expectedShapes.count(shapeOf(line)), 1U) << line.text;
    std::cout << requests << " requests by " << threads << " threads, " << used << " of "
              << inventories.size() << " inventories seen, " << lines.size() << " trace lines\n";
}

} // namespace ThreadsTests
