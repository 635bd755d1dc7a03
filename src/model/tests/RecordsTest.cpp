// The records, their translation of node status, and the exception class.

#include "Glimmark.h"
#include "GlimmarkCapabilities.h"
#include "ProviderException.h"

#include <cstdint>
#include <limits>
#include <ostream>
#include <type_traits>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace RecordsTests {

using Tavro::ProviderException;
using Tavro::GlimmarkProvider::Glimmark;
using Tavro::GlimmarkProvider::GlimmarkCapabilities;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

using States = std::vector<std::uint16_t>;

TEST(Glimmark, IsEmptyFromTheStart)
{
    const Glimmark record;
    EXPECT_EQ(record.getDeviceID(), "");
    EXPECT_EQ(record.getElementName(), "");
    EXPECT_EQ(record.getRequestedState(), 0U);
    EXPECT_EQ(record.getHealthState(), 0U);
    EXPECT_THAT(record.getOperationalStatus(), IsEmpty());
    EXPECT_FALSE(record.getAudibleAlarm());
    EXPECT_FALSE(record.getVisibleAlarm());
    EXPECT_FALSE(record.getMotionAlarm());
    EXPECT_EQ(record.getAlarmState(), 0U);
}

TEST(Glimmark, TextsAreStrippedWhenReadAndNotWhenStored)
{
    Glimmark record;
    EXPECT_TRUE(record.setDeviceID("  Fan 1:/a b  "));
    EXPECT_TRUE(record.setElementName(" Fan 1 "));
    EXPECT_EQ(record.getDeviceID(), "Fan 1:/a b");
    EXPECT_EQ(record.getElementName(), "Fan 1");
    EXPECT_TRUE(record.setElementName(" ")) << "blanks alone are not empty while they are stored";
    EXPECT_EQ(record.getElementName(), "");
}

TEST(Glimmark, EmptyTextsAreRefusedAndStored)
{
    Glimmark record;
    record.setDeviceID("id");
    record.setElementName("name");
    EXPECT_FALSE(record.setDeviceID(""));
    EXPECT_FALSE(record.setElementName(""));
    EXPECT_EQ(record.getDeviceID(), "");
    EXPECT_EQ(record.getElementName(), "");
}

struct Translation
{
    unsigned int nodeStatus;
    unsigned int requestedState;
    unsigned int healthState;
    States operationalStatus;
};

void PrintTo(const Translation& row, std::ostream* stream)
{
    *stream << "node status " << row.nodeStatus;
}

class NodeStatus : public ::testing::TestWithParam<Translation>
{};

TEST_P(NodeStatus, IsTranslatedIntoTheThreeStates)
{
    const Translation& expected = GetParam();
    Glimmark record;
    EXPECT_TRUE(record.setRequestedState(expected.nodeStatus));
    EXPECT_TRUE(record.setHealthState(expected.nodeStatus));
    EXPECT_TRUE(record.setOperationalStatus(expected.nodeStatus));
    EXPECT_EQ(record.getRequestedState(), expected.requestedState);
    EXPECT_EQ(record.getHealthState(), expected.healthState);
    EXPECT_EQ(record.getOperationalStatus(), expected.operationalStatus);
}

std::vector<Translation> allTranslations()
{
    std::vector<Translation> all;
    for (unsigned int status = 0; status <= 70; ++status) {
        if (status == 1)
            all.push_back({status, 2, 5, {2, 11}});
        else if (status == 20)
            all.push_back({status, 2, 10, {3, 5}});
        else if (status > 20 && status < 27)
            all.push_back({status, 2, 10, {3}});
        else
            all.push_back({status, 3, 0, {0}});
    }
    // As a signed number negative, and what a shift or a cut by 32 or 16 bits would make of valid ones.
    for (const unsigned int status : {0x80000000U, 0xFFFFFFFFU, 32U + 1U, 0x10001U, 0x10014U})
        all.push_back({status, 3, 0, {0}});
    return all;
}

INSTANTIATE_TEST_SUITE_P(Every, NodeStatus, ::testing::ValuesIn(allTranslations()));

TEST(Glimmark, OperationalStatusIsReplacedAndNotExtended)
{
    Glimmark record;
    record.setOperationalStatus(1);
    record.setOperationalStatus(1);
    EXPECT_THAT(record.getOperationalStatus(), ElementsAre(2, 11));
}

TEST(Glimmark, OperationalStatusIsAnsweredAsACopy)
{
    Glimmark record;
    record.setOperationalStatus(1);
    record.getOperationalStatus().clear();
    EXPECT_THAT(record.getOperationalStatus(), ElementsAre(2, 11));
}

TEST(Glimmark, AlarmsAreStoredAsGiven)
{
    Glimmark record;
    for (const bool flag : {true, false}) {
        EXPECT_TRUE(record.setAudibleAlarm(flag));
        EXPECT_TRUE(record.setVisibleAlarm(!flag));
        EXPECT_TRUE(record.setMotionAlarm(flag));
        EXPECT_EQ(record.getAudibleAlarm(), flag);
        EXPECT_EQ(record.getVisibleAlarm(), !flag);
        EXPECT_EQ(record.getMotionAlarm(), flag);
    }
}

TEST(Glimmark, AlarmStateIsOneOfFour)
{
    Glimmark record;
    for (unsigned int state = 0; state <= std::numeric_limits<std::uint16_t>::max(); ++state) {
        ASSERT_TRUE(record.setAlarmState(static_cast<std::uint16_t>(state)));
        ASSERT_EQ(record.getAlarmState(), state <= 3 ? state : 0) << state;
    }
}

TEST(Glimmark, CopiesAreIndependent)
{
    Glimmark record;
    record.setDeviceID("a");
    record.setOperationalStatus(20);
    Glimmark copy = record;
    record.setDeviceID("b");
    record.setOperationalStatus(1);
    EXPECT_EQ(copy.getDeviceID(), "a");
    EXPECT_THAT(copy.getOperationalStatus(), ElementsAre(3, 5));
    copy = record;
    EXPECT_EQ(copy.getDeviceID(), "b");
    EXPECT_THAT(copy.getOperationalStatus(), ElementsAre(2, 11));
}

TEST(GlimmarkCapabilities, EveryRecordHasTheOneIdentifier)
{
    GlimmarkCapabilities first;
    GlimmarkCapabilities second;
    EXPECT_EQ(first.getInstanceID(), "TAVRO:GlimmarkCapabilities1");
    EXPECT_EQ(second.getInstanceID(), "TAVRO:GlimmarkCapabilities1");
    GlimmarkCapabilities copy = first;
    EXPECT_EQ(copy.getInstanceID(), "TAVRO:GlimmarkCapabilities1");
}

TEST(GlimmarkCapabilities, NamesCannotBeEdited)
{
    GlimmarkCapabilities record;
    EXPECT_FALSE(record.getElementNameEditSupported());
}

TEST(GlimmarkCapabilities, EachCallAppendsTheAlarmStates)
{
    GlimmarkCapabilities record;
    EXPECT_THAT(record.getAlarmStatesSupported(), ElementsAre(1, 2, 3));
    EXPECT_THAT(record.getAlarmStatesSupported(), ElementsAre(1, 2, 3, 1, 2, 3));
    GlimmarkCapabilities copy = record;
    EXPECT_THAT(copy.getAlarmStatesSupported(), ElementsAre(1, 2, 3, 1, 2, 3, 1, 2, 3));
    EXPECT_THAT(record.getAlarmStatesSupported(), ElementsAre(1, 2, 3, 1, 2, 3, 1, 2, 3));
}

TEST(ProviderException, CarriesItsMessage)
{
    std::string text = "Failed while setting Device ID";
    const ProviderException exception(text.c_str());
    text = "something else";
    EXPECT_STREQ(exception.what(), "Failed while setting Device ID");
    const ProviderException copy(exception); // NOLINT(performance-unnecessary-copy-initialization)
    EXPECT_STREQ(copy.what(), "Failed while setting Device ID");
    EXPECT_NE(copy.what(), exception.what()) << "a copy has a text of its own";
}

TEST(ProviderException, IsAStandardException)
{
    static_assert(std::is_base_of_v<std::exception, ProviderException>);
    try {
        throw ProviderException("text");
    } catch (const std::exception& caught) {
        EXPECT_STREQ(caught.what(), "text");
    }
}

} // namespace RecordsTests
