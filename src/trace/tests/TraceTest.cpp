// The formats of the trace lines, and their way into the logging library.

#include "Trace.h"
#include "testing/ProviderFixture.h"
#include "testing/RecordedLog.h"

#include <cstring>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace TraceTests {

using Tavro::FunctionTrace;
using Tavro::MessageType;
using Tavro::parameterList;
using Tavro::trace;
using Tavro::TraceModule;
using Tavro::tracepara;
using ::testing::ElementsAre;

namespace {

const std::string category("Mavrel.Example");
const TraceModule module{"Example.cpp", category};

std::string noParameters()
{
    return "";
}

class FunctionTraceTest : public ::testing::Test
{
protected:
    FunctionTraceTest() { RecordedLog::clear(); }
};

} // namespace

TEST(MessageType, HasTheNumbersThatCallersPass)
{
    EXPECT_EQ(static_cast<unsigned int>(MessageType::Entering), 0U);
    EXPECT_EQ(static_cast<unsigned int>(MessageType::Exiting), 1U);
    EXPECT_EQ(static_cast<unsigned int>(MessageType::Method), 2U);
    EXPECT_EQ(static_cast<unsigned int>(MessageType::Message), 3U);
}

TEST(TracePara, FormatsByType)
{
    EXPECT_STREQ(tracepara("T", "F", 5, "P", MessageType::Entering),
                 "ENTERING: T() in F [Line: 5],Parameters List: P");
    EXPECT_STREQ(tracepara("T", "F", 5, "P", MessageType::Exiting),
                 "EXITING: T() in F [Line: 5],Parameters List: P");
    EXPECT_STREQ(tracepara("T", "F", 5, "P", MessageType::Method),
                 "METHOD: T() was invoked in F [Line: 5],Parameters List: P");
    EXPECT_STREQ(tracepara("T", "F", 5, "P", MessageType::Message),
                 "MESSAGE [File: F, Line: 5]: T,Parameters List: P");
}

TEST(TracePara, FormatsUnknownTypesAsEntering)
{
    for (const unsigned int type : {4U, 9U, 0xFFFFFFFFU})
        EXPECT_STREQ(tracepara("T", "F", 5, "P", static_cast<MessageType>(type)),
                     "ENTERING: T() in F [Line: 5],Parameters List: P");
}

TEST(Trace, FormatsAMessageWhateverTheType)
{
    for (const unsigned int type : {0U, 1U, 2U, 3U, 9U})
        EXPECT_STREQ(trace("T", "F", 5, static_cast<MessageType>(type)), "MESSAGE [File: F, Line: 5]: T");
}

TEST(TracePara, CutsWhatIsLongerThanItsBuffer)
{
    const std::string longText(2000, 'x');
    for (const unsigned int type : {0U, 1U, 2U, 3U}) {
        const char* const line =
            tracepara(longText.c_str(), "F", 1, longText.c_str(), static_cast<MessageType>(type));
        EXPECT_EQ(std::strlen(line), 511U);
    }
    EXPECT_EQ(std::strlen(trace(longText.c_str(), "F", 1, MessageType::Message)), 511U);
}

TEST(TracePara, FillsABufferOf511CharactersToItsEnd)
{
    const std::string around = tracepara("", "", 1, "", MessageType::Entering);
    for (const std::size_t length : {510U, 511U, 512U}) {
        const std::string parameters(length - around.size(), 'p');
        const std::string line = tracepara("", "", 1, parameters.c_str(), MessageType::Entering);
        EXPECT_EQ(line, (around + parameters).substr(0, 511));
    }
}

TEST(TracePara, ClearsItsBufferBeforeEachLine)
{
    const std::string longText(400, 'x');
    tracepara(longText.c_str(), "F", 1, "", MessageType::Entering);
    const char* const line = tracepara("T", "F", 1, "P", MessageType::Entering);
    for (std::size_t i = std::strlen(line); i < 512; ++i)
        ASSERT_EQ(line[i], '\0') << i;
    trace(longText.c_str(), "F", 1, MessageType::Message);
    const char* const message = trace("T", "F", 1, MessageType::Message);
    for (std::size_t i = std::strlen(message); i < 512; ++i)
        ASSERT_EQ(message[i], '\0') << i;
}

TEST(TracePara, HasABufferApartFromThatOfTrace)
{
    const char* const line = tracepara("T", "F", 5, "P", MessageType::Entering);
    const char* const message = trace("T", "F", 5, MessageType::Message);
    EXPECT_NE(line, message);
    EXPECT_STREQ(line, "ENTERING: T() in F [Line: 5],Parameters List: P");
    EXPECT_EQ(tracepara("U", "F", 5, "P", MessageType::Exiting), line);
    EXPECT_EQ(trace("U", "F", 5, MessageType::Message), message);
}

TEST(TracePara, FollowsNoNullPointer)
{
    EXPECT_STREQ(tracepara(nullptr, nullptr, 5, nullptr, MessageType::Exiting),
                 "EXITING: (null)() in (null) [Line: 5],Parameters List: (null)");
    EXPECT_STREQ(trace(nullptr, nullptr, 5, MessageType::Message), "MESSAGE [File: (null), Line: 5]: (null)");
}

TEST(TracePara, PrintsEveryLineNumberInFull)
{
    EXPECT_STREQ(tracepara("T", "F", 0, "P", MessageType::Entering),
                 "ENTERING: T() in F [Line: 0],Parameters List: P");
    EXPECT_STREQ(tracepara("T", "F", 2147483647, "P", MessageType::Entering),
                 "ENTERING: T() in F [Line: 2147483647],Parameters List: P");
    EXPECT_STREQ(tracepara("T", "F", 2147483648U, "P", MessageType::Entering),
                 "ENTERING: T() in F [Line: -2147483648],Parameters List: P");
}

TEST(ParameterList, StreamsTextsFlagsAndAddresses)
{
    const int object = 0;
    std::ostringstream expected;
    expected << " ref=" << static_cast<const void*>(&object) << " role="
             << "Antecedent"
             << " isObjPath=" << true;
    EXPECT_EQ(parameterList(" ref=", &object, " role=", "Antecedent", " isObjPath=", true), expected.str());
}

TEST(ParameterList, PrintsANullAddressAsTheStreamDoes)
{
    const CMPIObjectPath* const nothing = nullptr;
    std::ostringstream expected;
    expected << " ref=" << static_cast<const void*>(nullptr) << " rc=" << static_cast<const void*>(nullptr);
    EXPECT_EQ(parameterList(" ref=", nothing, " rc=", nothing), expected.str());
}

TEST(ParameterList, EndsAtANullText)
{
    const char* const nothing = nullptr;
    EXPECT_EQ(parameterList(" resultClass=", nothing, " role=", "Antecedent"), " resultClass=");
}

TEST_F(FunctionTraceTest, GivesEachLineToTheLogAndThenToTheTrace)
{
    int lists = 0;
    const FunctionTrace flow(
        module, "exampleFunction", [&] { return " a=" + std::to_string(++lists); }, 11);
    flow.exiting(12);
    flow.error("It failed.", 13);
    flow.exiting(" b=2", 14);
    EXPECT_THAT(Logged::lines(),
                ElementsAre("3000 Mavrel.Example ENTERING: exampleFunction() in Example.cpp [Line],"
                            "Parameters List:  a=1",
                            "3000 Mavrel.Example EXITING: exampleFunction() in Example.cpp [Line],"
                            "Parameters List:  a=2",
                            "6000 Mavrel.Example MESSAGE [File: Example.cpp, Line]: It failed.",
                            "3000 Mavrel.Example EXITING: exampleFunction() in Example.cpp [Line],"
                            "Parameters List:  b=2"));
    const std::vector<RecordedLog::Line> lines = RecordedLog::lines();
    ASSERT_EQ(lines.size(), 8U);
    EXPECT_EQ(lines[0].line, 11);
    EXPECT_EQ(lines[2].line, 12);
    EXPECT_EQ(lines[4].line, 13);
    EXPECT_EQ(lines[6].line, 14);
}

TEST_F(FunctionTraceTest, ReadsEachTextBackFromAMessageBuffer)
{
    const FunctionTrace flow(module, "f", noParameters, 1);
    const std::string line = "ENTERING: f() in Example.cpp [Line: 1],Parameters List: ";
    EXPECT_THAT(RecordedLog::insertions(), ElementsAre(line, line));
}

TEST_F(FunctionTraceTest, TakesTheLineOfTheStatementThatTraces)
{
    const FunctionTrace flow(module, "f", noParameters);
    const int line = __LINE__ - 1;
    flow.exiting();
    EXPECT_EQ(RecordedLog::lines().at(0).line, line);
    EXPECT_EQ(RecordedLog::lines().at(2).line, line + 2);
}

TEST_F(FunctionTraceTest, LeavesTheSharedBuffersAlone)
{
    const char* const withParameters = tracepara("T", "F", 5, "P", MessageType::Entering);
    const char* const message = trace("T", "F", 5, MessageType::Message);
    const FunctionTrace flow(module, "f", noParameters);
    flow.error("It failed.");
    EXPECT_STREQ(withParameters, "ENTERING: T() in F [Line: 5],Parameters List: P");
    EXPECT_STREQ(message, "MESSAGE [File: F, Line: 5]: T");
}

TEST_F(FunctionTraceTest, KeepsTheLinesOfThreadsApart)
{
    constexpr int threads = 8;
    constexpr int rounds = 200;
    std::vector<std::thread> running;
    running.reserve(threads);
    for (int i = 0; i < threads; ++i) {
        running.emplace_back([i] {
            const std::string name(static_cast<std::size_t>(20 * (i + 1)), static_cast<char>('a' + i));
            for (int round = 0; round < rounds; ++round) {
                const FunctionTrace flow(
                    module, name.c_str(), [&]() -> const std::string& { return name; }, 1);
                flow.error(name.c_str(), 1);
            }
        });
    }
    for (std::thread& thread : running)
        thread.join();

    const std::vector<RecordedLog::Line> lines = RecordedLog::lines();
    EXPECT_EQ(lines.size(), 4U * threads * rounds);
    for (const RecordedLog::Line& line : lines) {
        const std::string& name = line.function;
        std::string expected = "MESSAGE [File: Example.cpp, Line: 1]: ";
        if (line.level != 6000)
            expected = "ENTERING: " + name + "() in Example.cpp [Line: 1],Parameters List: ";
        expected += name;
        ASSERT_EQ(line.text, expected);
    }
}

} // namespace TraceTests
