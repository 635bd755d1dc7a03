#include <Tavro/Instrumentation.h>

#include "testing/Environment.h"
#include "testing/RecordedLog.h"

#include <algorithm>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using Tavro::Instrumentation;
using testing::Contains;
namespace NodeLexicon = Tavro::NodeLexicon;

struct SampleIndicator
{
    std::string description;
    std::string path;
    unsigned int status;
    std::optional<unsigned int> alarmState;
};

std::vector<SampleIndicator> indicatorsOf(const std::string& sample)
{
    const Testing::Environment inventory("TAVRO_INVENTORY", INVENTORIES "/" + sample);
    std::vector<SampleIndicator> indicators;
    Instrumentation cursor;
    for (cursor.selectNode(NodeLexicon::DiagnosticIndicator); cursor; ++cursor) {
        SampleIndicator indicator{
            cursor.getNodeDescription(), cursor.getPathToNode(), cursor.getNodeStatus(), {}};
        if (unsigned int value = 0; cursor.getProperty(NodeLexicon::AlarmState, value))
            indicator.alarmState = value;
        indicators.push_back(indicator);
    }
    const bool allAreDescribed =
        std::none_of(indicators.begin(), indicators.end(),
                     [](const SampleIndicator& each) { return each.description.empty(); });
    EXPECT_EQ(RecordedLog::take().size(), allAreDescribed ? 0U : 1U);
    return indicators;
}

bool hasOtherKinds(const std::string& sample)
{
    const Testing::Environment inventory("TAVRO_INVENTORY", INVENTORIES "/" + sample);
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::Fan);
    return cursor;
}

TEST(Samples, theSmallServerHasEveryStatusAndAlarmState)
{
    const std::vector<SampleIndicator> indicators = indicatorsOf("small-server.json");
    EXPECT_GE(indicators.size(), 12U);
    std::set<unsigned int> statuses;
    std::set<std::optional<unsigned int>> alarmStates;
    std::set<std::string> paths;
    for (const SampleIndicator& indicator : indicators) {
        statuses.insert(indicator.status);
        alarmStates.insert(indicator.alarmState);
        paths.insert(indicator.path);
        EXPECT_NE(indicator.description, "");
    }
    EXPECT_EQ(paths.size(), indicators.size());
    for (const unsigned int status : {0U, 1U, 2U, 19U, 20U, 21U, 26U, 27U})
        EXPECT_THAT(statuses, Contains(status));
    for (const std::optional<unsigned int> state :
         {std::optional<unsigned int>(), {0U}, {1U}, {2U}, {3U}, {4U}})
        EXPECT_THAT(alarmStates, Contains(state));
    EXPECT_TRUE(hasOtherKinds("small-server.json"));
}

std::string identifierOf(const SampleIndicator& indicator)
{
    const std::string text = indicator.description + ":" + indicator.path;
    return text.substr(text.find_first_not_of(' '),
                       text.find_last_not_of(' ') - text.find_first_not_of(' ') + 1);
}

TEST(Samples, theEdgeCasesHoldWhatTheirNameSays)
{
    const std::vector<SampleIndicator> indicators = indicatorsOf("edge-cases-readable.json");
    std::map<std::string, int> identifiers;
    std::string all;
    for (const SampleIndicator& indicator : indicators) {
        ++identifiers[identifierOf(indicator)];
        all += indicator.description + indicator.path;
        EXPECT_NE(indicator.description, "");
    }
    EXPECT_EQ(identifiers["System Health LED:/chassis-1/front-panel/indicator-1"], 2);
    for (const char* const piece : {"\"", "\\", ",", "\xC3\xBC", "\xF0\x9F\x9A\xA8"})
        EXPECT_THAT(all, testing::HasSubstr(piece));
    EXPECT_TRUE(hasOtherKinds("edge-cases-readable.json"));
}

TEST(Samples, theFullEdgeCasesHaveAnIndicatorWithoutDescriptionInTheMiddle)
{
    const std::vector<SampleIndicator> readable = indicatorsOf("edge-cases-readable.json");
    std::vector<SampleIndicator> full = indicatorsOf("edge-cases.json");
    const auto empty = std::find_if(full.begin(), full.end(),
                                    [](const SampleIndicator& each) { return each.description.empty(); });
    ASSERT_NE(empty, full.end());
    EXPECT_NE(empty, full.begin());
    EXPECT_NE(empty + 1, full.end());
    full.erase(empty);
    EXPECT_TRUE(std::equal(full.begin(), full.end(), readable.begin(), readable.end(),
                           [](const SampleIndicator& a, const SampleIndicator& b) {
                               return a.description == b.description && a.path == b.path &&
                                      a.status == b.status && a.alarmState == b.alarmState;
                           }));
}

} // namespace
