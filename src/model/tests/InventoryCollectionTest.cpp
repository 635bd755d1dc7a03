// From the inventory's nodes to records.

#include "InventoryCollection.h"
#include "ProviderException.h"
#include "testing/Allocations.h"
#include "testing/MadeInventory.h"
#include "testing/ProviderFixture.h"
#include "testing/RecordedLog.h"

#include <Tavro/Instrumentation.h>

#include <new>
#include <stdexcept>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace InventoryCollectionTests {

using MadeInventory::Node;
using Tavro::Instrumentation;
using Tavro::ProviderException;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using namespace Tavro::GlimmarkProvider;

namespace {

constexpr auto indicators = static_cast<Tavro::NodeLexicon::NodeType>(36);

class InventoryCollection : public ::testing::Test
{
protected:
    InventoryCollection()
    {
        MadeInventory::set({});
        RecordedLog::clear();
    }
    ~InventoryCollection() override { EXPECT_EQ(MadeInventory::openCursors(), 0); }

    static std::vector<Glimmark> collect(std::vector<Node> nodes, int expectedResult)
    {
        MadeInventory::set(std::move(nodes));
        std::vector<Glimmark> records;
        EXPECT_EQ(getGlimmarkInstances(records), expectedResult);
        return records;
    }

    static Glimmark collectOne(Node node)
    {
        const std::vector<Glimmark> records = collect({std::move(node)}, 0);
        return records.at(0);
    }

    std::vector<Glimmark> records;
    std::vector<GlimmarkCapabilities> capabilities;
};

std::vector<std::string> namesOf(const std::vector<Glimmark>& records)
{
    std::vector<std::string> names;
    names.reserve(records.size());
    for (const Glimmark& record : records)
        names.push_back(record.getElementName());
    return names;
}

/// What the cursor of setVector throws for the second node.
void expectFailure(const Node& second, const char* message)
{
    MadeInventory::set({{"first", "a"}, second});
    std::vector<Glimmark> records;
    Instrumentation cursor;
    cursor.selectNode(indicators);
    try {
        setVector(records, cursor);
        FAIL() << "expected: " << message;
    } catch (const ProviderException& exception) {
        EXPECT_STREQ(exception.what(), message);
    }
    EXPECT_THAT(records, SizeIs(1));
}

} // namespace

TEST_F(InventoryCollection, IdentifierIsDescriptionColonPathText)
{
    // The made inventory's path text is the path behind a slash.
    const Glimmark record = collectOne({"Fan 1", "sys/fan1"});
    EXPECT_EQ(record.getDeviceID(), "Fan 1:/sys/fan1");
    EXPECT_EQ(record.getElementName(), "Fan 1");
}

TEST_F(InventoryCollection, BlanksInsideTheIdentifierStay)
{
    const Glimmark record = collectOne({" Fan 1 ", "p "});
    EXPECT_EQ(record.getDeviceID(), "Fan 1 :/p");
    EXPECT_EQ(record.getElementName(), "Fan 1");
}

TEST_F(InventoryCollection, StatusOfTheNodeIsTranslated)
{
    const Glimmark ok = collectOne({"n", "p", 1});
    EXPECT_THAT(ok.getOperationalStatus(), ElementsAre(2, 11));
    EXPECT_EQ(ok.getHealthState(), 5U);
    const Glimmark failing = collectOne({"n", "p", 20});
    EXPECT_THAT(failing.getOperationalStatus(), ElementsAre(3, 5));
    EXPECT_EQ(failing.getHealthState(), 10U);
    const Glimmark other = collectOne({"n", "p", 2});
    EXPECT_THAT(other.getOperationalStatus(), ElementsAre(0));
    EXPECT_EQ(other.getHealthState(), 0U);
}

TEST_F(InventoryCollection, StatusZeroLeavesTheDefaults)
{
    const Glimmark record = collectOne({"n", "p", 0});
    EXPECT_THAT(record.getOperationalStatus(), IsEmpty());
    EXPECT_EQ(record.getHealthState(), 0U);
    EXPECT_EQ(record.getRequestedState(), 2U);
}

TEST_F(InventoryCollection, EveryIndicatorIsEnabledAndVisibleOnly)
{
    for (const unsigned int status : {0U, 1U, 2U, 19U, 20U, 26U, 27U, 0xFFFFFFFFU}) {
        const Glimmark record = collectOne({"n", "p", status});
        EXPECT_EQ(record.getRequestedState(), 2U) << status;
        EXPECT_FALSE(record.getAudibleAlarm());
        EXPECT_TRUE(record.getVisibleAlarm());
        EXPECT_FALSE(record.getMotionAlarm());
    }
}

TEST_F(InventoryCollection, AlarmStateIsReadFromTheNode)
{
    EXPECT_EQ(collectOne({"n", "p", 1, 0}).getAlarmState(), 0U);
    EXPECT_EQ(collectOne({"n", "p", 1, 1}).getAlarmState(), 1U);
    EXPECT_EQ(collectOne({"n", "p", 1, 2}).getAlarmState(), 2U);
    EXPECT_EQ(collectOne({"n", "p", 1, 3}).getAlarmState(), 3U);
    EXPECT_EQ(collectOne({"n", "p", 1, 4}).getAlarmState(), 0U);
}

TEST_F(InventoryCollection, AlarmStateIsCutTo16Bits)
{
    EXPECT_EQ(collectOne({"n", "p", 1, 0x10003U}).getAlarmState(), 3U);
    EXPECT_EQ(collectOne({"n", "p", 1, 0xFFFF0002U}).getAlarmState(), 2U);
}

TEST_F(InventoryCollection, MissingAlarmStateStaysUnknown)
{
    EXPECT_EQ(collectOne({"n", "p", 1, std::nullopt}).getAlarmState(), 0U);
}

TEST_F(InventoryCollection, TheAlarmStateHoldsOneBeforeItIsRead)
{
    collectOne({"n", "p", 1, 3});
    EXPECT_EQ(MadeInventory::valueBeforeGetProperty(), 1U);
}

TEST_F(InventoryCollection, OnlyIndicatorsAreCollectedInTheInventorysOrder)
{
    const auto collected = collect({{"z", "1", 1, {}, 35},
                                    {"c", "2"},
                                    {"y", "3", 1, {}, 37},
                                    {"a", "4"},
                                    {"b", "5"},
                                    {"x", "6", 1, {}, 0}},
                                   0);
    EXPECT_THAT(namesOf(collected), ElementsAre("c", "a", "b"));
}

TEST_F(InventoryCollection, SelectsTheIndicatorsOnce)
{
    const int before = MadeInventory::selections();
    collect({{"a", "1"}, {"b", "2"}}, 0);
    EXPECT_EQ(MadeInventory::selections(), before + 1);
}

TEST_F(InventoryCollection, DuplicatesAreKept)
{
    EXPECT_THAT(collect({{"a", "p"}, {"a", "p"}}, 0), SizeIs(2));
}

TEST_F(InventoryCollection, AppendsToWhatIsThere)
{
    records.resize(2);
    MadeInventory::set({{"a", "p"}});
    EXPECT_EQ(getGlimmarkInstances(records), 0);
    EXPECT_THAT(records, SizeIs(3));
}

TEST_F(InventoryCollection, WithoutIndicatorAnswersOneAndLeavesTheListAlone)
{
    records.resize(2);
    MadeInventory::set({{"a", "p", 1, {}, 35}});
    EXPECT_EQ(getGlimmarkInstances(records), 1);
    EXPECT_THAT(records, SizeIs(2));
    EXPECT_THAT(Logged::lines(), IsEmpty());
}

TEST_F(InventoryCollection, EmptyDescriptionEndsTheWalkAndKeepsWhatCameBefore)
{
    const auto collected = collect({{"a", "1"}, {"b", "2"}, {"", "3"}, {"d", "4"}, {"e", "5"}}, 1);
    EXPECT_THAT(namesOf(collected), ElementsAre("a", "b"));
    // The failing walk has no EXITING line.
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING setVector"));
}

TEST_F(InventoryCollection, EmptyDescriptionIsAnElementNameThatCannotBeSet)
{
    expectFailure({"", "p"}, "Failed while setting Element Name");
    expectFailure({"", ""}, "Failed while setting Element Name");
}

TEST_F(InventoryCollection, StandardExceptionsEndTheWalk)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    MadeInventory::throwAt(1, std::make_exception_ptr(std::bad_alloc()));
    EXPECT_EQ(getGlimmarkInstances(records), 1);
    EXPECT_THAT(namesOf(records), ElementsAre("a"));
    EXPECT_EQ(MadeInventory::openCursors(), 0);
}

TEST_F(InventoryCollection, OtherExceptionsPassOn)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    MadeInventory::throwAt(1, std::make_exception_ptr(7));
    EXPECT_THROW(getGlimmarkInstances(records), int);
    EXPECT_EQ(MadeInventory::openCursors(), 0);
}

TEST_F(InventoryCollection, TracesTheWalkOnce)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    Instrumentation cursor;
    cursor.selectNode(indicators);
    EXPECT_EQ(setVector(records, cursor), 0);
    const std::string parameters =
        Logged::parameters(" vectGlimmark=", &records, " instrumentation=", &cursor);
    EXPECT_THAT(Logged::lines(), ElementsAre(Logged::line("Glimmark", "ENTERING", "setVector", parameters),
                                             Logged::line("Glimmark", "EXITING", "setVector", parameters)));
}

TEST_F(InventoryCollection, TheCallerOfTheWalkDoesNotTrace)
{
    MadeInventory::set({{"a", "1"}});
    EXPECT_EQ(getGlimmarkInstances(records), 0);
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING setVector", "EXITING setVector"));
}

TEST_F(InventoryCollection, CapabilitiesAreOneRecordForEachCall)
{
    EXPECT_EQ(getGlimmarkCapabilitiesInstances(capabilities), 0);
    ASSERT_THAT(capabilities, SizeIs(1));
    EXPECT_EQ(capabilities[0].getInstanceID(), "TAVRO:GlimmarkCapabilities1");
    EXPECT_EQ(getGlimmarkCapabilitiesInstances(capabilities), 0);
    EXPECT_THAT(capabilities, SizeIs(2));
}

TEST_F(InventoryCollection, CapabilitiesNeedNoInventory)
{
    MadeInventory::throwAt(0, std::make_exception_ptr(std::runtime_error("not to be read")));
    EXPECT_EQ(getGlimmarkCapabilitiesInstances(capabilities), 0);
    EXPECT_THAT(capabilities, SizeIs(1));
}

TEST_F(InventoryCollection, CapabilitiesWithoutMemoryAreReportedOnStandardError)
{
    // Long enough that no other allocation of the function is as large as the list's next one.
    capabilities.resize(1000);
    capabilities.shrink_to_fit();
    testing::internal::CaptureStderr();
    Allocations::failFrom(sizeof(GlimmarkCapabilities) * 1001);
    EXPECT_EQ(getGlimmarkCapabilitiesInstances(capabilities), 1);
    EXPECT_TRUE(Allocations::stop());
    EXPECT_EQ(testing::internal::GetCapturedStderr(), std::string(std::bad_alloc().what()) + "\n");
    EXPECT_THAT(capabilities, SizeIs(1000));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING getGlimmarkCapabilitiesInstances"));
}

TEST_F(InventoryCollection, CapabilitiesAreTraced)
{
    getGlimmarkCapabilitiesInstances(capabilities);
    const std::string parameters = Logged::parameters(" vectGlimmarkCapabilities=", &capabilities);
    EXPECT_THAT(
        Logged::lines(),
        ElementsAre(Logged::line("Glimmark", "ENTERING", "getGlimmarkCapabilitiesInstances", parameters),
                    Logged::line("Glimmark", "EXITING", "getGlimmarkCapabilitiesInstances", parameters)));
}

} // namespace InventoryCollectionTests
