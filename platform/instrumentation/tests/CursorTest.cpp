#include <Tavro/Instrumentation.h>

#include "testing/Allocations.h"
#include "testing/Environment.h"
#include "testing/ForkUnderLoad.h"
#include "testing/RecordedLog.h"
#include "testing/TemporaryDirectory.h"

#include <string>
#include <thread>
#include <type_traits>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using Tavro::Instrumentation;
using testing::ElementsAre;
using Testing::Environment;
using testing::IsEmpty;
using Testing::TemporaryDirectory;
namespace NodeLexicon = Tavro::NodeLexicon;

static_assert(sizeof(Instrumentation) == sizeof(void*));
static_assert(!std::is_polymorphic_v<Instrumentation>);
static_assert(!std::is_copy_constructible_v<Instrumentation> && !std::is_copy_assignable_v<Instrumentation>);
static_assert(!std::is_move_constructible_v<Instrumentation> && !std::is_move_assignable_v<Instrumentation>);
static_assert(std::is_same_v<std::underlying_type_t<NodeLexicon::NodeType>, unsigned int>);
static_assert(std::is_same_v<std::underlying_type_t<NodeLexicon::Properties>, unsigned int>);
static_assert(std::is_convertible_v<NodeLexicon::NodeType, unsigned int>, "unscoped");
static_assert(NodeLexicon::DiagnosticIndicator == 36 && NodeLexicon::AlarmState == 1);

constexpr const char* threeIndicators = R"({ "nodes": [
    { "kind": 6, "description": "Fan", "path": "/fan", "status": 1 },
    { "kind": 36, "description": "First", "path": "/1", "status": 1, "alarmState": 3 },
    { "kind": "diagnostic indicator", "description": " Second ", "path": " /2 ", "status": 4294967295 },
    { "kind": "fan", "description": "Fan 2", "path": "/fan2", "status": 20, "alarmState": 2 },
    { "alarmState": 0, "status": 0, "path": "", "description": ":", "kind": 36 },
    { "kind": 4294967295, "description": "Other", "path": "/other", "status": 2 }
] })";

class Cursor : public testing::Test
{
protected:
    Cursor() { use(threeIndicators); }
    ~Cursor() override { EXPECT_THAT(RecordedLog::take(), IsEmpty()); }

    void use(const std::string& json) { inventory.set(directory.file("inventory.json", json)); }

    TemporaryDirectory directory;
    Environment inventory{"TAVRO_INVENTORY", std::nullopt};
};

std::vector<std::string> descriptions(Instrumentation& cursor)
{
    std::vector<std::string> found;
    for (; cursor; ++cursor)
        found.push_back(cursor.getNodeDescription());
    return found;
}

std::vector<std::string> descriptionsOf(unsigned int kind)
{
    Instrumentation cursor;
    cursor.selectNode(static_cast<NodeLexicon::NodeType>(kind));
    return descriptions(cursor);
}

TEST_F(Cursor, standsOnNoNodeAtFirst)
{
    const Instrumentation cursor;
    EXPECT_FALSE(cursor);
}

TEST_F(Cursor, standsOnTheFirstNodeOfTheSelectedKind)
{
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    ASSERT_TRUE(cursor);
    EXPECT_EQ(cursor.getNodeDescription(), "First");
    EXPECT_EQ(cursor.getPathToNode(), "/1");
    EXPECT_EQ(cursor.getNodeStatus(), 1U);
}

TEST_F(Cursor, visitsTheNodesOfItsKindInTheOrderOfTheFile)
{
    EXPECT_THAT(descriptionsOf(36), ElementsAre("First", " Second ", ":"));
    EXPECT_THAT(descriptionsOf(6), ElementsAre("Fan", "Fan 2"));
    EXPECT_THAT(descriptionsOf(4294967295), ElementsAre("Other"));
}

TEST_F(Cursor, standsOnNoneWhereThereIsNoneOfTheKind)
{
    EXPECT_THAT(descriptionsOf(35), IsEmpty());
    EXPECT_THAT(descriptionsOf(0), IsEmpty());
}

TEST_F(Cursor, givesTextsAndNumbersAsTheyStandInTheFile)
{
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    ++cursor;
    EXPECT_EQ(cursor.getNodeDescription(), " Second ");
    EXPECT_EQ(cursor.getPathToNode(), " /2 ");
    EXPECT_EQ(cursor.getNodeStatus(), 4294967295U);
    ++cursor;
    EXPECT_TRUE(cursor);
    EXPECT_EQ(cursor.getNodeDescription(), ":");
    EXPECT_EQ(cursor.getPathToNode(), "");
    EXPECT_EQ(cursor.getNodeStatus(), 0U);
}

TEST_F(Cursor, stepsByReference)
{
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    EXPECT_EQ(&++cursor, &cursor);
}

TEST_F(Cursor, staysOffTheEnd)
{
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::Fan);
    ++ ++ ++ ++cursor;
    EXPECT_FALSE(cursor);
}

TEST_F(Cursor, staysOnNoNodeUntilAKindIsSelected)
{
    Instrumentation cursor;
    ++cursor;
    EXPECT_FALSE(cursor);
}

TEST_F(Cursor, startsAnewWithEachSelection)
{
    Instrumentation cursor;
    for (int round = 0; round < 2; ++round) {
        cursor.selectNode(NodeLexicon::DiagnosticIndicator);
        EXPECT_THAT(descriptions(cursor), ElementsAre("First", " Second ", ":"));
    }
    cursor.selectNode(NodeLexicon::Fan);
    EXPECT_EQ(cursor.getNodeDescription(), "Fan");
    cursor.selectNode(NodeLexicon::Chassis);
    EXPECT_FALSE(cursor);
}

TEST_F(Cursor, answersEmptyWhileOnNoNode)
{
    const Instrumentation cursor;
    unsigned int value = 17;
    EXPECT_EQ(cursor.getNodeDescription(), "");
    EXPECT_EQ(cursor.getPathToNode(), "");
    EXPECT_EQ(cursor.getNodeStatus(), 0U);
    EXPECT_FALSE(cursor.getProperty(NodeLexicon::AlarmState, value));
    EXPECT_EQ(value, 17U);
}

TEST_F(Cursor, readsTheAlarmStateWhereThereIsOne)
{
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    unsigned int value = 17;
    EXPECT_TRUE(cursor.getProperty(NodeLexicon::AlarmState, value));
    EXPECT_EQ(value, 3U);
    ++cursor;
    value = 17;
    EXPECT_FALSE(cursor.getProperty(NodeLexicon::AlarmState, value));
    EXPECT_EQ(value, 17U);
    ++cursor;
    EXPECT_TRUE(cursor.getProperty(NodeLexicon::AlarmState, value));
    EXPECT_EQ(value, 0U);
}

TEST_F(Cursor, hasNoOtherProperty)
{
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    for (const unsigned int property : {0U, 2U, 4294967295U}) {
        unsigned int value = 17;
        EXPECT_FALSE(cursor.getProperty(static_cast<NodeLexicon::Properties>(property), value));
        EXPECT_EQ(value, 17U);
    }
}

TEST_F(Cursor, showsPathsAsTheyStandInTheFile)
{
    const Instrumentation cursor;
    for (const std::string path : {"", " /a b ", "anything at all \xFF"})
        EXPECT_EQ(cursor.convertPathToString(path), path);
}

TEST_F(Cursor, seesTheFileAsItWasWhenTheCursorWasMade)
{
    Instrumentation before;
    use(R"({"nodes":[{"kind":36,"description":"New","path":"/new","status":1}]})");
    Instrumentation after;
    before.selectNode(NodeLexicon::DiagnosticIndicator);
    EXPECT_THAT(descriptions(before), ElementsAre("First", " Second ", ":"));
    after.selectNode(NodeLexicon::DiagnosticIndicator);
    EXPECT_THAT(descriptions(after), ElementsAre("New"));
}

TEST_F(Cursor, saysOnceThatIndicatorsWithoutADescriptionCostAllOthers)
{
    use(R"({"nodes":[{"kind":36,"description":"D","path":"/1","status":1},
                     {"kind":6,"description":"","path":"/fan","status":1},
                     {"kind":36,"description":"","path":"/2","status":1},
                     {"kind":36,"description":"","path":"/3","status":1}]})");
    EXPECT_THAT(descriptionsOf(6), ElementsAre(""));
    EXPECT_THAT(RecordedLog::take(), IsEmpty()) << "nobody has asked for the indicators";
    EXPECT_THAT(descriptionsOf(36), ElementsAre("D", "", "")) << "they are there all the same";
    const std::vector<RecordedLog::Line> lines = RecordedLog::take();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(lines[0].channel, RecordedLog::Channel::log);
    EXPECT_EQ(lines[0].level, 6000);
    EXPECT_EQ(lines[0].category, "Mavrel.Instrumentation");
    EXPECT_EQ(lines[0].text,
              "the diagnostic indicator /2 has no description: the provider answers without indicators");
}

TEST_F(Cursor, takesAnInventoryWithoutNodes)
{
    use(R"({"nodes":[]})");
    EXPECT_THAT(descriptionsOf(36), IsEmpty());
}

TEST_F(Cursor, takesAReferenceToASchema)
{
    use(R"({"nodes":[{"kind":36,"description":"D","path":"P","status":1}],"$schema":"./inventory.schema.json"})");
    EXPECT_THAT(descriptionsOf(36), ElementsAre("D"));
}

TEST_F(Cursor, takesAByteOrderMarkAndEscapes)
{
    for (const char* const mark : {"", "\xEF\xBB\xBF"}) {
        use(mark + std::string(R"({"nodes":[{"k\u0069nd":36,"status":1,"path":"",)") +
            R"("description":"\u00fc \ud83d\udea8 \" \\ \n"}]})");
        EXPECT_THAT(descriptionsOf(36), ElementsAre("\xC3\xBC \xF0\x9F\x9A\xA8 \" \\ \n")) << mark;
    }
}

TEST_F(Cursor, takesEscapesInLongTexts)
{
    const std::string piece(3000, 'x');
    use(R"({"nodes":[{"kind":36,"status":1,"path":"a\/b","description":")" + piece + R"(\u0041)" + piece +
        R"(\")" + piece + R"("},{"kind":36,"status":1,"path":"","description":"B"}]})");
    EXPECT_THAT(descriptionsOf(36), ElementsAre(piece + 'A' + piece + '"' + piece, "B"));
}

TEST_F(Cursor, knowsTheKindsByTheirNames)
{
    const std::vector<std::pair<std::string, unsigned int>> kinds = {{"chassis", 1},
                                                                     {"system board", 2},
                                                                     {"processor", 3},
                                                                     {"memory module", 4},
                                                                     {"drive", 5},
                                                                     {"fan", 6},
                                                                     {"power supply", 7},
                                                                     {"temperature sensor", 8},
                                                                     {"diagnostic indicator", 36}};
    for (const auto& [name, number] : kinds) {
        use(R"({"nodes":[{"kind":")" + name + R"(","description":"D","path":"","status":1}]})");
        EXPECT_THAT(descriptionsOf(number), ElementsAre("D")) << name;
    }
}

TEST_F(Cursor, takesMoreNodesThanSixteenBitsCount)
{
    constexpr std::size_t count = 70000;
    std::string json = R"({"nodes":[)";
    for (std::size_t index = 0; index < count; ++index)
        json += (index == 0 ? "" : ",") +
                (R"({"kind":36,"description":"D","path":")" + std::to_string(index)) + R"(","status":1})";
    use(json + "]}");
    EXPECT_EQ(descriptionsOf(36).size(), count);
}

TEST_F(Cursor, holdsAtMostTwoAndAHalfTimesTheFile)
{
    for (const int count : {1000, 65535}) {
        std::string json = R"({"nodes":[)";
        for (int number = 0; number < count; ++number) {
            const std::string text = std::to_string(number);
            json.append(number == 0 ? "" : ",")
                .append(R"({"alarmState":1,"description":"Drive )")
                .append(text);
            json.append(R"( Fault LED","kind":36,"path":"/chassis-1/drive-bay-)").append(text);
            json.append(R"(/indicator-1","status":1})");
        }
        use(json += "]}");
        Allocations::startCounting();
        {
            const Instrumentation cursor;
        }
        const Allocations::Use used = Allocations::stopCounting();
        EXPECT_LE(static_cast<double>(used.peak), 2.5 * static_cast<double>(json.size())) << count;
        EXPECT_EQ(used.held, 0) << count;
    }
}

TEST_F(Cursor, cursorsOfSeveralThreadsDoNotMeet)
{
    constexpr int threadCount = 4;
    std::vector<std::thread> threads;
    threads.reserve(threadCount);
    for (int number = 0; number < threadCount; ++number)
        threads.emplace_back([] {
            for (int round = 0; round < 20; ++round)
                EXPECT_THAT(descriptionsOf(36), ElementsAre("First", " Second ", ":"));
        });
    for (std::thread& thread : threads)
        thread.join();
}

TEST_F(Cursor, childrenForkedAmongThemReadToo)
{
    if (!Testing::childrenMayAllocate)
        GTEST_SKIP() << "the sanitizer's allocator is not made for it";
    constexpr int children = 300;
    EXPECT_EQ(Testing::childrenThatReturn(children, [] { descriptionsOf(36); }), children);
}

} // namespace
