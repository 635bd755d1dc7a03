// The provider of TAVRO_GlimmarkCapabilities, driven through its function table.

#include "EntryPoints.h"
#include "testing/ProviderFixture.h"

#include <Tavro/Common.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace GlimmarkCapabilitiesProviderTests {

using ::testing::AllOf;
using ::testing::Contains;
using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::SizeIs;

namespace {

constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";
constexpr auto identifier = "TAVRO:GlimmarkCapabilities1";
constexpr auto module = "GlimmarkCapabilitiesProvider";

class GlimmarkCapabilitiesProviderTest : public ProviderFixture
{
protected:
    // An indicator, to show where it takes no part.
    GlimmarkCapabilitiesProviderTest() { MadeInventory::set({{"a", "1"}}); }

    CMPIStatus enumerateNames(const CMPIObjectPath* path)
    {
        return mi->ft->enumerateInstanceNames(mi, ctx(), rslt(), path);
    }
    CMPIStatus enumerate(const CMPIObjectPath* path, const char** properties = nullptr)
    {
        return mi->ft->enumerateInstances(mi, ctx(), rslt(), path, properties);
    }
    CMPIStatus get(const CMPIObjectPath* path, const char** properties = nullptr)
    {
        return mi->ft->getInstance(mi, ctx(), rslt(), path, properties);
    }
    CMPIObjectPath* refTo(const char* instanceID) { return ref(capabilities, {{"InstanceID", instanceID}}); }

    /// That a GetInstance went the search way, which finds nothing.
    void expectFruitlessSearch()
    {
        EXPECT_THAT(timeline(),
                    ElementsAre("ENTERING GlimmarkCapabilities_GetInstance", "getKeyCount(ref, rc)",
                                "getKey(ref, \"InstanceID\", rc)", "ENTERING setVector", "EXITING setVector",
                                "ENTERING getAllGlimmarkCapabilitiesCMPIInstances",
                                "EXITING getAllGlimmarkCapabilitiesCMPIInstances", "returnDone()",
                                "EXITING GlimmarkCapabilities_GetInstance"));
    }

    CMPIInstanceMI* mi = GlimmarkCapabilitiesProvider_Create_InstanceMI(host.cmpiBroker(), nullptr, nullptr);
    const std::vector<std::string> resultServices{"returnObjectPath", "returnInstance", "returnDone"};
};

} // namespace

// EnumInstanceNames

TEST_F(GlimmarkCapabilitiesProviderTest, NamesAreTheOneInTheRequestsNamespace)
{
    const CMPIStatus status = enumerateNames(ref(capabilities));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    const auto paths = answer(status).paths;
    EXPECT_THAT(valuesOf(paths, "InstanceID"), ElementsAre(identifier));
    EXPECT_EQ(paths.at(0).nameSpace, "root/test");
    EXPECT_EQ(paths.at(0).className, capabilities);
    EXPECT_EQ(paths.at(0).host, Tavro::getSystemName());
}

TEST_F(GlimmarkCapabilitiesProviderTest, NamesComeAboutByTheseStepsInThisOrder)
{
    enumerateNames(ref(capabilities));
    EXPECT_THAT(
        timeline(),
        ElementsAre(
            "ENTERING GlimmarkCapabilities_EnumInstanceNames", "ENTERING getGlimmarkCapabilitiesInstances",
            "EXITING getGlimmarkCapabilitiesInstances", "ENTERING getAllGlimmarkCapabilitiesCMPIObjPaths",
            "getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
            "newObjectPath(\"root/test\", \"TAVRO_GlimmarkCapabilities\", rc)", "getNameSpace(ref, rc)",
            "getCharPtr(\"root/test\", rc)", "setNameSpace(path1, \"root/test\")",
            "setHostname(path1, \"" + Tavro::getSystemName() + "\")",
            "addKey(path1, \"InstanceID\", \"TAVRO:GlimmarkCapabilities1\", chars)",
            "EXITING getAllGlimmarkCapabilitiesCMPIObjPaths", "getNameSpace(ref, rc)",
            "getCharPtr(\"root/test\", rc)", "setNameSpace(path1, \"root/test\")", "returnObjectPath(path1)",
            "returnDone()", "EXITING GlimmarkCapabilities_EnumInstanceNames"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, NamesAreTraced)
{
    const CMPIObjectPath* const path = ref(capabilities);
    enumerateNames(path);
    const std::string function = "GlimmarkCapabilities_EnumInstanceNames";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
}

TEST_F(GlimmarkCapabilitiesProviderTest, NamesWithoutAPathEndWithoutDoneAndExit)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        clearRecords();
        broker.fail("newObjectPath", 1, failure);
        const CMPIStatus status = enumerateNames(ref(capabilities));
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), "Create CMPIObjectPath failed");
        EXPECT_THAT(broker.calls(resultServices), IsEmpty());
        EXPECT_THAT(broker.calls({"trace"}), SizeIs(1)) << "the factory's, none of the operation's own";
        EXPECT_THAT(Logged::linesOf("GlimmarkCapabilities_EnumInstanceNames"), SizeIs(1));
    }
}

TEST_F(GlimmarkCapabilitiesProviderTest, NamesPassOverAPathWithoutAnObjectBehindIt)
{
    broker.fail("addKey", 1, Failure::lostHandle);
    const CMPIStatus status = enumerateNames(ref(capabilities));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    const auto all = timeline();
    ASSERT_GE(all.size(), 3U);
    EXPECT_THAT(std::vector<std::string>(all.end() - 3, all.end()),
                ElementsAre("EXITING getAllGlimmarkCapabilitiesCMPIObjPaths", "returnDone()",
                            "EXITING GlimmarkCapabilities_EnumInstanceNames"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, NamesKeepTheStatusThatTheBrokersCallsLeave)
{
    // The last call that gets the status: reading the namespace for the returned path.
    broker.fail("getNameSpace", 3, Failure::errorStatus);
    const CMPIStatus status = enumerateNames(ref(capabilities));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnObjectPath(path1)", "returnDone()"));
}

// EnumInstances

TEST_F(GlimmarkCapabilitiesProviderTest, InstancesAreTheOne)
{
    const CMPIStatus status = enumerate(ref(capabilities));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    const auto instances = answer(status).instances;
    EXPECT_THAT(valuesOf(instances, "InstanceID"), ElementsAre(identifier));
    EXPECT_THAT(valuesOf(instances, "RequestedAlarmStatesSupported"), ElementsAre("[1, 2, 3]"));
    EXPECT_THAT(Logged::flow(), Not(Contains("ENTERING setVector"))) << "no indicator is collected";
}

TEST_F(GlimmarkCapabilitiesProviderTest, InstancesAreReturnedAndDoneBeforeTheExit)
{
    enumerate(ref(capabilities));
    const auto all = timeline();
    ASSERT_GE(all.size(), 4U);
    EXPECT_THAT(std::vector<std::string>(all.end() - 4, all.end()),
                ElementsAre("EXITING getAllGlimmarkCapabilitiesCMPIInstances", "returnInstance(instance1)",
                            "returnDone()", "EXITING GlimmarkCapabilities_EnumInstances"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, InstancesCarryThePropertiesAskedFor)
{
    PropertyNames properties{"Caption"};
    const auto instances = answer(enumerate(ref(capabilities), properties)).instances;
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("InstanceID"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, InstancesAreTraced)
{
    const CMPIObjectPath* const path = ref(capabilities);
    PropertyNames properties{"InstanceID"};
    const char** const list = properties;
    enumerate(path, list);
    const std::string function = "GlimmarkCapabilities_EnumInstances";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                                               " properties=", list);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
}

TEST_F(GlimmarkCapabilitiesProviderTest, AnInstanceThatCouldNotBeMadeIsHandedOn)
{
    broker.fail("newInstance", 1, Failure::nullResult);
    const CMPIStatus status = enumerate(ref(capabilities));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(null)", "returnDone()"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, InstancesWithoutTheArrayAreReturnedBesideTheFailure)
{
    broker.fail("newArray", 1, Failure::nullResult);
    const CMPIStatus status = enumerate(ref(capabilities));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status),
              "Creating array for Property" + std::string(25, ' ') + "RequestedAlarmStatesSupported failed.");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(instance1)", "returnDone()"));
    EXPECT_EQ(timeline().back(), "EXITING GlimmarkCapabilities_EnumInstances");
}

// GetInstance

TEST_F(GlimmarkCapabilitiesProviderTest, GetNeedsAKey)
{
    const CMPIStatus status = get(ref(capabilities));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "At least one key should be passed");
    EXPECT_THAT(
        timeline(),
        ElementsAre("ENTERING GlimmarkCapabilities_GetInstance", "getKeyCount(ref, rc)",
                    "newString(\"At least one key should be passed\", null)",
                    "trace(2, \"GlimmarkCapabilitiesProvider\", \"At least one key should be passed\", null)",
                    "returnDone()", "EXITING GlimmarkCapabilities_GetInstance"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetReportsTheMissingKeyOverWhatTheBrokerLeft)
{
    broker.fail("getKeyCount", 1, Failure::errorStatus);
    const CMPIStatus status = get(refTo(identifier));
    EXPECT_EQ(message(status), "At least one key should be passed");
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetByInstanceIDAnswersTheInstance)
{
    const CMPIStatus status = get(refTo(identifier));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    const auto instances = answer(status).instances;
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_EQ(valueOf(instances[0], "InstanceID"), identifier);
    EXPECT_THAT(namesOf(instances[0]), SizeIs(2));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetByInstanceIDTakesTheseSteps)
{
    get(refTo(identifier));
    const auto all = timeline();
    ASSERT_GE(all.size(), 12U);
    EXPECT_THAT(std::vector<std::string>(all.begin(), all.begin() + 8),
                ElementsAre("ENTERING GlimmarkCapabilities_GetInstance", "getKeyCount(ref, rc)",
                            "getKey(ref, \"InstanceID\", rc)", "ENTERING getGlimmarkCapabilitiesInstances",
                            "EXITING getGlimmarkCapabilitiesInstances",
                            "ENTERING getOneGlimmarkCapabilitiesCMPIInstance",
                            "getCharPtr(\"TAVRO:GlimmarkCapabilities1\", rc)",
                            "ENTERING makeGlimmarkCapabilitiesInstance"));
    EXPECT_THAT(std::vector<std::string>(all.end() - 4, all.end()),
                ElementsAre("EXITING getOneGlimmarkCapabilitiesCMPIInstance", "returnInstance(instance1)",
                            "returnDone()", "EXITING GlimmarkCapabilities_GetInstance"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetByInstanceIDLooksAtNothingElse)
{
    const CMPIStatus status = get(ref("CIM_Anything", {{"Other", "x"}, {"InstanceID", identifier}}));
    EXPECT_THAT(answer(status).instances, SizeIs(1));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetTakesThePropertyList)
{
    PropertyNames properties{"InstanceID"};
    const auto instances = answer(get(refTo(identifier), properties)).instances;
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("InstanceID"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetHandsOnAnInstanceThatCouldNotBeMade)
{
    broker.fail("newInstance", 1, Failure::nullResult);
    EXPECT_EQ(get(refTo(identifier)).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(null)", "returnDone()"));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetIsTraced)
{
    const CMPIObjectPath* const path = refTo(identifier);
    PropertyNames properties{"InstanceID"};
    const char** const list = properties;
    get(path, list);
    const std::string function = "GlimmarkCapabilities_GetInstance";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " cop=", path,
                                               " properties=", list);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetOfAnUnknownInstanceIDEndsWithoutDoneAndExit)
{
    for (const char* unknown : {"TAVRO:GlimmarkCapabilities2", "tavro:glimmarkcapabilities1", ""}) {
        clearRecords();
        const CMPIStatus status = get(refTo(unknown));
        EXPECT_EQ(status.rc, CMPI_RC_OK) << unknown;
        EXPECT_EQ(message(status), std::nullopt);
        EXPECT_THAT(broker.calls({"returnInstance", "returnDone", "trace", "newString"}), IsEmpty());
        EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING GlimmarkCapabilities_GetInstance",
                                                "ENTERING getGlimmarkCapabilitiesInstances",
                                                "EXITING getGlimmarkCapabilitiesInstances",
                                                "ENTERING getOneGlimmarkCapabilitiesCMPIInstance"));
    }
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetWithoutAnInstanceIDFindsNothingAndLeavesTheStatusOfGetKey)
{
    const CMPIStatus status = get(ref(capabilities, {{"CreationClassName", capabilities}}));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND) << "what the broker's getKey wrote for a missing key";
    expectFruitlessSearch();
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetFindsNothingEvenAtTheCapabilitiesOwnPath)
{
    // On the way of the search the indicators are collected instead.
    for (const Failure failure : {Failure::nullResult, Failure::errorStatus, Failure::wrongValue}) {
        clearRecords();
        broker.fail("getKey", 1, failure);
        const CMPIStatus status = get(refTo(identifier));
        EXPECT_EQ(status.rc, failure == Failure::errorStatus ? CMPI_RC_ERR_FAILED : CMPI_RC_OK);
        expectFruitlessSearch();
    }
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetWithoutAnInstanceIDSearchesWholeInstances)
{
    get(ref(capabilities, {{"CreationClassName", capabilities}}));
    EXPECT_THAT(Logged::linesOf("getAllGlimmarkCapabilitiesCMPIInstances"),
                AllOf(SizeIs(2), Each(HasSubstr(" isObjPath=0 "))));
}

TEST_F(GlimmarkCapabilitiesProviderTest, GetTakesAStringWithoutAnObjectBehindItForNoInstanceID)
{
    static decltype(CMPIObjectPathFT::getKey) getKey;
    getKey = host.tables().objectPath.getKey;
    static CMPIString withoutHandle;
    withoutHandle = CMPIString{nullptr, &host.tables().string};
    host.tables().objectPath.getKey = [](const CMPIObjectPath* path, const char* name, CMPIStatus* rc) {
        CMPIData data = getKey(path, name, rc);
        data.value.string = &withoutHandle;
        return data;
    };
    get(refTo(identifier));
    expectFruitlessSearch();
}

} // namespace GlimmarkCapabilitiesProviderTests
