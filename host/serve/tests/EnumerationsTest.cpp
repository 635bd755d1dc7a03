#include "serve/Enumerations.h"

#include "serve/ValueReader.h"

#include <chrono>
#include <optional>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::serve;

namespace {

class PulledEnumerations : public testing::Test
{
protected:
    static Question about(Step step, const std::string& context = "", std::uint32_t most = 0)
    {
        Question question;
        question.step = step;
        question.request.target.nameSpace = "root/a";
        question.items = Items::paths;
        question.context = context;
        question.mostItems = most;
        return question;
    }

    /// Paths named by their number.
    static cim::Answer answerOf(int size)
    {
        cim::Answer answer;
        for (int number = 0; number < size; ++number)
            answer.paths.push_back({"", "", std::to_string(number), {}});
        return answer;
    }

    std::string open(int size, std::uint32_t most = 0)
    {
        return enumerations.open(about(Step::open, "", most), answerOf(size)).context;
    }

    /// The numbers of the next piece, with a point at the end of the enumeration.
    std::string pull(const std::string& context, std::uint32_t most)
    {
        return textOf(enumerations.pull(about(Step::pull, context, most)), context);
    }

    static std::string textOf(const Reply& reply, const std::string& context)
    {
        std::string text;
        for (const cim::ObjectPath& path : reply.answer.paths)
            text += path.className + ' ';
        EXPECT_TRUE(reply.context.empty() || reply.context == context);
        return text + (reply.context.empty() ? "." : "");
    }

    template <class Call>
    static int codeOf(const Call& call)
    {
        try {
            call();
        } catch (const ValueError& error) {
            return error.code();
        }
        return 0;
    }

    int pullCode(const std::string& context)
    {
        return codeOf([&] { enumerations.pull(about(Step::pull, context, 1)); });
    }

    Enumerations::Clock::time_point now{};
    Enumerations enumerations{{2, 100, std::chrono::seconds(60), std::chrono::seconds(300)},
                              [this] { return now; }};
};

TEST_F(PulledEnumerations, AreGivenOutInPieces)
{
    const Reply first = enumerations.open(about(Step::open, "", 2), answerOf(5));
    EXPECT_EQ(textOf(first, first.context), "0 1 ");
    EXPECT_EQ(enumerations.count(about(Step::count, first.context)), 3U);
    EXPECT_EQ(pull(first.context, 2), "2 3 ");
    EXPECT_EQ(pull(first.context, 0), "");
    EXPECT_EQ(pull(first.context, 9), "4 .");
    EXPECT_EQ(pullCode(first.context), invalidEnumerationContext);
}

TEST_F(PulledEnumerations, EndWithTheLastItem)
{
    EXPECT_EQ(open(2, 2), "");
    EXPECT_EQ(open(0), "");
    const std::string context = open(2);
    EXPECT_EQ(pull(context, 2), "0 1 .");
}

TEST_F(PulledEnumerations, HaveInstancesAsWell)
{
    cim::Answer answer;
    answer.instances = {{}, {}, {}};
    Question question = about(Step::open, "", 1);
    question.items = Items::instancesWithPaths;
    const Reply first = enumerations.open(question, answer);
    EXPECT_EQ(first.answer.instances.size(), 1U);
    question = about(Step::pull, first.context, 5);
    EXPECT_EQ(codeOf([&] { enumerations.pull(question); }), invalidEnumerationContext)
        << "opened for instances";
    question.items = Items::instancesWithPaths;
    EXPECT_EQ(enumerations.pull(question).answer.instances.size(), 2U);
}

TEST_F(PulledEnumerations, AreClosed)
{
    const std::string context = open(2);
    enumerations.close(about(Step::close, context));
    EXPECT_EQ(pullCode(context), invalidEnumerationContext);
    EXPECT_EQ(codeOf([&] { enumerations.close(about(Step::close, context)); }), invalidEnumerationContext);
    EXPECT_EQ(codeOf([&] { enumerations.count(about(Step::count, "")); }), invalidEnumerationContext);
}

TEST_F(PulledEnumerations, BelongToTheirNamespace)
{
    const std::string context = open(2);
    Question elsewhere = about(Step::pull, context, 1);
    elsewhere.request.target.nameSpace = "root/b";
    EXPECT_EQ(codeOf([&] { enumerations.pull(elsewhere); }), invalidEnumerationContext);
    EXPECT_EQ(pull(context, 1), "0 ");
}

TEST_F(PulledEnumerations, AreLimitedInNumber)
{
    const std::string first = open(2);
    const std::string second = open(2);
    EXPECT_NE(first, second);
    EXPECT_EQ(codeOf([&] { enumerations.checkOpening(about(Step::open)); }), serverLimitsExceeded);
    EXPECT_EQ(codeOf([&] { open(2); }), serverLimitsExceeded);
    EXPECT_EQ(pull(first, 2), "0 1 .");
    EXPECT_NE(open(2), "");
}

TEST_F(PulledEnumerations, AreLimitedInWhatTheyHold)
{
    const std::string first = open(6, 1); // five are left
    EXPECT_NE(first, "");
    EXPECT_EQ(codeOf([&] { open(96); }), serverLimitsExceeded);
    EXPECT_EQ(open(96, 96), "") << "nothing is held";
    EXPECT_EQ(pull(first, 1), "1 ");
    EXPECT_NE(open(96), "");
}

TEST_F(PulledEnumerations, AreGivenUpWhenTheirClientLeavesThem)
{
    const std::string context = open(3);
    now += std::chrono::seconds(59);
    EXPECT_EQ(pull(context, 1), "0 ");
    now += std::chrono::seconds(60);
    EXPECT_EQ(pull(context, 1), "1 ") << "each piece starts the time anew";
    now += std::chrono::seconds(61);
    EXPECT_EQ(pullCode(context), invalidEnumerationContext);
}

TEST_F(PulledEnumerations, MakeRoomWhenTheyAreGivenUp)
{
    open(2);
    open(2);
    now += std::chrono::seconds(61);
    EXPECT_NE(open(2), "");
}

TEST_F(PulledEnumerations, WaitAsLongAsTheirClientSays)
{
    Question question = about(Step::open);
    question.timeout = 300;
    const std::string context = enumerations.open(question, answerOf(1)).context;
    now += std::chrono::seconds(299);
    EXPECT_EQ(pullCode(context), 0);
    for (const std::uint32_t timeout : {0U, 301U, 4294967295U}) {
        question.timeout = timeout;
        EXPECT_EQ(codeOf([&] { enumerations.checkOpening(question); }), invalidOperationTimeout) << timeout;
    }
}

/// Run under the thread sanitizer too.
TEST(PulledEnumerationsOnThreads, GiveEachItemOnce)
{
    Enumerations enumerations;
    Question question;
    question.items = Items::paths;
    cim::Answer answer;
    for (int number = 0; number < 400; ++number)
        answer.paths.push_back({"", "", std::to_string(number), {}});
    question.context = enumerations.open(question, answer).context;
    question.mostItems = 1;
    std::vector<std::vector<std::string>> taken(4);
    std::vector<std::thread> threads;
    threads.reserve(taken.size());
    for (std::vector<std::string>& mine : taken)
        threads.emplace_back([&] {
            for (int pieces = 0; pieces < 100; ++pieces)
                mine.push_back(enumerations.pull(question).answer.paths.at(0).className);
        });
    for (std::thread& thread : threads)
        thread.join();
    std::set<std::string> all;
    for (const std::vector<std::string>& mine : taken)
        all.insert(mine.begin(), mine.end());
    EXPECT_EQ(all.size(), 400U);
}

} // namespace
