// The provider of TAVRO_Glimmark, driven through its function table.

#include "EntryPoints.h"
#include "testing/ProviderFixture.h"

#include <Tavro/Common.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace GlimmarkProviderTests {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::IsSupersetOf;
using ::testing::SizeIs;

namespace {

constexpr auto glimmark = "TAVRO_Glimmark";

class GlimmarkProviderTest : public ProviderFixture
{
protected:
    GlimmarkProviderTest() { MadeInventory::set({{"b", "2"}, {"c", "3"}, {"a", "1"}}); }

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
    /// All keys but the DeviceID of an indicator, which is what leads to the search among all.
    CMPIObjectPath* refWithoutDeviceID()
    {
        return ref(glimmark, {{"CreationClassName", glimmark}, {"SystemName", "any"}});
    }
    /// The path of an instance that this system returned.
    CMPIObjectPath* refTo(const cimhost::cim::ObjectPath& path)
    {
        CMPIObjectPath* const handle = request->path(path);
        broker.name(handle, "ref");
        return handle;
    }

    CMPIInstanceMI* mi = GlimmarkProfileProvider_Create_InstanceMI(host.cmpiBroker(), nullptr, nullptr);
    const std::vector<std::string> resultServices{"returnObjectPath", "returnInstance", "returnDone"};
};

} // namespace

// EnumInstanceNames

TEST_F(GlimmarkProviderTest, NamesAreSortedAndInTheRequestsNamespace)
{
    const CMPIStatus status = enumerateNames(ref(glimmark));
    const auto paths = answer(status).paths;
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(valuesOf(paths, "DeviceID"), ElementsAre("a:/1", "b:/2", "c:/3"));
    for (const auto& path : paths) {
        EXPECT_EQ(path.nameSpace, "root/test");
        EXPECT_EQ(path.className, glimmark);
    }
    EXPECT_THAT(broker.calls(resultServices),
                ElementsAre("returnObjectPath(path1)", "returnObjectPath(path2)", "returnObjectPath(path3)",
                            "returnDone()"));
}

TEST_F(GlimmarkProviderTest, NamesGetTheNamespaceAgainBeforeTheyAreReturned)
{
    MadeInventory::set({{"a", "1"}});
    enumerateNames(ref(glimmark));
    const auto calls = broker.calls();
    ASSERT_GE(calls.size(), 6U);
    EXPECT_THAT(std::vector<std::string>(calls.end() - 6, calls.end()),
                ElementsAre("addKey(path1, \"SystemName\", \"" + Tavro::getSystemName() + "\", chars)",
                            "getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                            "setNameSpace(path1, \"root/test\")", "returnObjectPath(path1)", "returnDone()"));
}

TEST_F(GlimmarkProviderTest, NamesAreTraced)
{
    const CMPIObjectPath* const path = ref(glimmark);
    enumerateNames(path);
    const std::string function = "Glimmark_EnumInstanceNames";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line("GlimmarkProvider", "ENTERING", function, parameters),
                            Logged::line("GlimmarkProvider", "EXITING", function, parameters)));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + function, "ENTERING setVector", "EXITING setVector",
                                            "ENTERING getAllGlimmarkCMPIObjPaths",
                                            "EXITING getAllGlimmarkCMPIObjPaths", "EXITING " + function));
}

TEST_F(GlimmarkProviderTest, NamesOfAnEmptyInventoryEndWithoutDoneAndExit)
{
    MadeInventory::set({});
    const CMPIStatus status = enumerateNames(ref(glimmark));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(),
                ElementsAre("trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)"));
    EXPECT_THAT(Logged::flow(),
                ElementsAre("ENTERING Glimmark_EnumInstanceNames", "ENTERING getAllGlimmarkCMPIObjPaths"));
}

TEST_F(GlimmarkProviderTest, NamesEndAtAPathThatCannotBeMade)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        broker.clear();
        RecordedLog::clear();
        broker.fail("newObjectPath", 2, failure);
        const CMPIStatus status = enumerateNames(ref(glimmark));
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), "Create CMPIObjectPath failed.");
        EXPECT_THAT(broker.calls(resultServices), IsEmpty());
        EXPECT_THAT(Logged::linesOf("Glimmark_EnumInstanceNames"), SizeIs(1));
    }
}

TEST_F(GlimmarkProviderTest, NamesKeepTheStatusThatTheBrokersCallsLeave)
{
    MadeInventory::set({{"a", "1"}});
    // The last call that gets the status: reading the namespace for the returned path.
    broker.fail("getNameSpace", 3, Failure::errorStatus);
    const CMPIStatus status = enumerateNames(ref(glimmark));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnObjectPath(path1)", "returnDone()"));
}

// EnumInstances

TEST_F(GlimmarkProviderTest, InstancesAreSorted)
{
    const CMPIStatus status = enumerate(ref(glimmark));
    const auto instances = answer(status).instances;
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(valuesOf(instances, "DeviceID"), ElementsAre("a:/1", "b:/2", "c:/3"));
    EXPECT_THAT(namesOf(instances.at(0)), IsSupersetOf({"DeviceID", "AlarmState"})) << "a full instance";
    EXPECT_THAT(broker.calls(resultServices),
                ElementsAre("returnInstance(instance1)", "returnInstance(instance2)",
                            "returnInstance(instance3)", "returnDone()"));
}

TEST_F(GlimmarkProviderTest, InstancesCarryTheKeysAndThePropertiesAskedFor)
{
    PropertyNames properties{"AlarmState", "caption", "NoSuchProperty"};
    const auto instances = answer(enumerate(ref(glimmark), properties)).instances;
    ASSERT_THAT(instances, SizeIs(3));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("CreationClassName", "DeviceID", "SystemCreationClassName",
                                                   "SystemName", "AlarmState"));
}

TEST_F(GlimmarkProviderTest, InstancesAreTraced)
{
    MadeInventory::set({{"a", "1"}});
    const CMPIObjectPath* const path = ref(glimmark);
    PropertyNames properties{"Name"};
    const char** const list = properties;
    enumerate(path, list);
    const std::string function = "Glimmark_EnumInstances";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                                               " properties=", list);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line("GlimmarkProvider", "ENTERING", function, parameters),
                            Logged::line("GlimmarkProvider", "EXITING", function, parameters)));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + function, "ENTERING setVector", "EXITING setVector",
                                            "ENTERING getAllGlimmarkCMPIInstances",
                                            "ENTERING makeGlimmarkInstance", "EXITING makeGlimmarkInstance",
                                            "EXITING getAllGlimmarkCMPIInstances", "EXITING " + function));
}

TEST_F(GlimmarkProviderTest, InstancesOfAnEmptyInventoryAreNoneAndDone)
{
    MadeInventory::set({});
    const CMPIStatus status = enumerate(ref(glimmark));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(), ElementsAre("returnDone()"));
    EXPECT_EQ(Logged::flow().back(), "EXITING Glimmark_EnumInstances");
}

TEST_F(GlimmarkProviderTest, InstancesThatCouldNotBeMadeAreHandedOn)
{
    broker.fail("newInstance", 2, Failure::nullResult);
    const CMPIStatus status = enumerate(ref(glimmark));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(instance1)", "returnInstance(null)",
                                                          "returnInstance(instance2)", "returnDone()"));
}

// GetInstance

TEST_F(GlimmarkProviderTest, GetNeedsAKey)
{
    const CMPIStatus status = get(ref(glimmark));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "At least one key should be passed");
    EXPECT_THAT(
        broker.calls(),
        ElementsAre("getKeyCount(ref, rc)", "newString(\"At least one key should be passed\", null)",
                    "trace(2, \"GlimmarkProfileProvider\", \"At least one key should be passed\", null)",
                    "returnDone()"));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING Glimmark_GetInstance", "EXITING Glimmark_GetInstance"));
}

TEST_F(GlimmarkProviderTest, GetByDeviceIDAnswersTheOneInstance)
{
    const CMPIStatus status = get(ref(glimmark, {{"DeviceID", "b:/2"}}));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(valuesOf(answer(status).instances, "DeviceID"), ElementsAre("b:/2"));
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(instance1)", "returnDone()"));
    EXPECT_THAT(broker.calls({"getKeyCount", "getKey"}),
                ElementsAre("getKeyCount(ref, rc)", "getKey(ref, \"DeviceID\", rc)"));
}

TEST_F(GlimmarkProviderTest, GetByDeviceIDLooksAtNoOtherKey)
{
    const CMPIStatus status = get(ref("CIM_Anything", {{"DeviceID", "b:/2"}, {"SystemName", "elsewhere"}}));
    EXPECT_THAT(valuesOf(answer(status).instances, "DeviceID"), ElementsAre("b:/2"));
}

TEST_F(GlimmarkProviderTest, GetTakesThePropertyList)
{
    PropertyNames properties{"HealthState"};
    const auto instances = answer(get(ref(glimmark, {{"DeviceID", "b:/2"}}), properties)).instances;
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("CreationClassName", "DeviceID", "SystemCreationClassName",
                                                   "SystemName", "HealthState"));
}

TEST_F(GlimmarkProviderTest, GetIsTraced)
{
    const CMPIObjectPath* const path = ref(glimmark, {{"DeviceID", "b:/2"}});
    get(path);
    const std::string function = "Glimmark_GetInstance";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " cop=", path,
                                               " properties=", static_cast<const char**>(nullptr));
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line("GlimmarkProvider", "ENTERING", function, parameters),
                            Logged::line("GlimmarkProvider", "EXITING", function, parameters)));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + function, "ENTERING setVector", "EXITING setVector",
                                            "ENTERING getOneGlimmarkCMPIInstance",
                                            "ENTERING makeGlimmarkInstance", "EXITING makeGlimmarkInstance",
                                            "EXITING getOneGlimmarkCMPIInstance", "EXITING " + function));
}

TEST_F(GlimmarkProviderTest, GetOfAnUnknownDeviceIDEndsWithoutDoneAndExit)
{
    for (const char* unknown : {"d:/4", "B:/2", "b:/2 ", " b:/2", ""}) {
        broker.clear();
        RecordedLog::clear();
        const CMPIStatus status = get(ref(glimmark, {{"DeviceID", unknown}}));
        EXPECT_EQ(status.rc, CMPI_RC_OK) << unknown;
        EXPECT_EQ(message(status), std::nullopt);
        EXPECT_THAT(broker.calls({"returnObjectPath", "returnInstance", "returnDone", "trace"}), IsEmpty());
        EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING Glimmark_GetInstance", "ENTERING setVector",
                                                "EXITING setVector", "ENTERING getOneGlimmarkCMPIInstance"));
    }
}

TEST_F(GlimmarkProviderTest, GetWithoutDeviceIDComparesWholePaths)
{
    const CMPIStatus status = get(refWithoutDeviceID());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls({"getObjectPath"}),
                ElementsAre("getObjectPath(instance1, rc)", "getObjectPath(instance2, rc)",
                            "getObjectPath(instance3, rc)"));
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnDone()"));
    EXPECT_EQ(Logged::flow().back(), "EXITING Glimmark_GetInstance");
}

TEST_F(GlimmarkProviderTest, GetWithANullDeviceIDSearchesAndStopsAtTheFirstMatch)
{
    // A null DeviceID beside otherwise equal keys would never be equal; let the broker answer no key only
    // when the operation asks for it.
    cimhost::cim::ObjectPath wanted = answer(enumerate(ref(glimmark))).instances.at(1).path;
    ASSERT_EQ(valueOf(wanted, "DeviceID"), "b:/2");
    newRequest();
    for (const Failure failure : {Failure::nullResult, Failure::errorStatus, Failure::wrongValue}) {
        broker.clear();
        broker.fail("getKey", 1, failure);
        get(refTo(wanted));
        EXPECT_THAT(broker.calls({"getObjectPath"}),
                    ElementsAre("getObjectPath(instance1, rc)", "getObjectPath(instance2, rc)"));
        EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(instance2)", "returnDone()"));
    }
    const auto found = answer({CMPI_RC_OK, nullptr}).instances;
    ASSERT_THAT(valuesOf(found, "DeviceID"), ElementsAre("b:/2"));
    EXPECT_THAT(namesOf(found[0]), IsSupersetOf({"DeviceID", "AlarmState"})) << "a full instance";
}

TEST_F(GlimmarkProviderTest, GetOnTheSearchWayPassesOverWhatCouldNotBeMade)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        broker.clear();
        broker.fail("newInstance", 1, failure);
        get(refWithoutDeviceID());
        EXPECT_THAT(broker.calls({"getObjectPath"}), SizeIs(2));
        EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnDone()"));
    }
}

TEST_F(GlimmarkProviderTest, GetOnTheSearchWayInAnEmptyInventoryLeavesTheStatusOfGetKey)
{
    MadeInventory::set({});
    const CMPIStatus status = get(refWithoutDeviceID());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND) << "what the broker's getKey wrote for a missing key";
    EXPECT_THAT(broker.calls({"trace", "newString"}), IsEmpty());
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnDone()"));
    EXPECT_EQ(Logged::flow().back(), "EXITING Glimmark_GetInstance");
}

TEST_F(GlimmarkProviderTest, GetTakesAKeyForWhatItsTypeAndItsValueSayWhateverItsState)
{
    // Brokers differ in the state that a good value has.
    for (const int state : {CMPI_goodValue, CMPI_keyValue, CMPI_nullValue, CMPI_notFound, CMPI_badValue}) {
        static CMPIData key;
        key = CMPIData();
        key.type = CMPI_string;
        key.state = static_cast<CMPIValueState>(state);
        key.value.string = host.cmpiBroker()->eft->newString(host.cmpiBroker(), "b:/2", nullptr);
        host.tables().objectPath.getKey = [](const CMPIObjectPath*, const char*, CMPIStatus*) { return key; };
        get(ref(glimmark, {{"DeviceID", "b:/2"}}));
        EXPECT_THAT(Logged::flow(), ::testing::Contains("ENTERING getOneGlimmarkCMPIInstance")) << state;
        RecordedLog::clear();
    }
}

TEST_F(GlimmarkProviderTest, TheStatusOfAFailureInTheFactoryIsTheOperations)
{
    const std::string text = "Create Array for Property" + std::string(25, ' ') + "OperationalStatus failed.";
    for (int operation = 0; operation < 3; ++operation) {
        broker.clear();
        broker.fail("newArray", 1, Failure::nullResult);
        const CMPIStatus status = operation == 0   ? enumerate(ref(glimmark))
                                  : operation == 1 ? get(ref(glimmark, {{"DeviceID", "b:/2"}}))
                                                   : get(refWithoutDeviceID());
        // Later calls of the broker write their own status over that of the first of three instances.
        EXPECT_EQ(status.rc, operation == 1 ? CMPI_RC_ERR_FAILED : CMPI_RC_OK) << operation;
        EXPECT_EQ(message(status), operation == 1 ? std::optional(text) : std::nullopt) << operation;
        EXPECT_THAT(broker.calls({"newString"}), ElementsAre("newString(\"" + text + "\", null)"))
            << operation;
    }
}

TEST_F(GlimmarkProviderTest, DoneComesBeforeTheExitLineInEveryOperation)
{
    const auto lastTwo = [this] {
        const std::vector<std::string> all = timeline();
        return std::vector<std::string>(all.end() - 2, all.end());
    };
    enumerateNames(ref(glimmark));
    EXPECT_THAT(lastTwo(), ElementsAre("returnDone()", "EXITING Glimmark_EnumInstanceNames"));
    enumerate(ref(glimmark));
    EXPECT_THAT(lastTwo(), ElementsAre("returnDone()", "EXITING Glimmark_EnumInstances"));
    for (const CMPIObjectPath* path :
         {ref(glimmark), ref(glimmark, {{"DeviceID", "b:/2"}}), refWithoutDeviceID()}) {
        clearRecords();
        get(path);
        EXPECT_THAT(lastTwo(), ElementsAre("returnDone()", "EXITING Glimmark_GetInstance"));
    }
}

TEST_F(GlimmarkProviderTest, AMissingKeyIsReportedBetweenEntryAndExit)
{
    const std::string text = "At least one key should be passed";
    get(ref(glimmark));
    EXPECT_THAT(timeline(), ElementsAre("ENTERING Glimmark_GetInstance", "getKeyCount(ref, rc)",
                                        "newString(\"" + text + "\", null)",
                                        "trace(2, \"GlimmarkProfileProvider\", \"" + text + "\", null)",
                                        "returnDone()", "EXITING Glimmark_GetInstance"));
}

TEST_F(GlimmarkProviderTest, InstancesAreReturnedAsTheFactoryMadeThem)
{
    MadeInventory::set({{"a", "1"}});
    enumerate(ref(glimmark));
    const auto calls = broker.calls();
    ASSERT_GE(calls.size(), 3U);
    EXPECT_THAT(std::vector<std::string>(calls.end() - 3, calls.end()),
                ElementsAre("setProperty(instance1, \"AlarmState\", 0, uint16)", "returnInstance(instance1)",
                            "returnDone()"));
}

TEST_F(GlimmarkProviderTest, GetHandsOnAnInstanceThatCouldNotBeMade)
{
    broker.fail("newInstance", 1, Failure::nullResult);
    get(ref(glimmark, {{"DeviceID", "b:/2"}}));
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(null)", "returnDone()"));
}

TEST_F(GlimmarkProviderTest, GetReadsNoKeyWithoutAString)
{
    static CMPIString withoutHandle;
    withoutHandle = {nullptr, &host.tables().string};
    static CMPIData key;
    for (CMPIString* const string : {static_cast<CMPIString*>(nullptr), &withoutHandle}) {
        key = CMPIData();
        key.type = CMPI_string;
        key.value.string = string;
        host.tables().objectPath.getKey = [](const CMPIObjectPath*, const char*, CMPIStatus*) { return key; };
        RecordedLog::clear();
        get(ref(glimmark, {{"DeviceID", "b:/2"}}));
        EXPECT_THAT(Logged::flow(), ::testing::Contains("ENTERING getAllGlimmarkCMPIInstances"));
    }
}

TEST_F(GlimmarkProviderTest, NothingIsKeptBetweenRequests)
{
    EXPECT_THAT(answer(enumerateNames(ref(glimmark))).paths, SizeIs(3));
    MadeInventory::set({{"new", "9"}});
    newRequest();
    EXPECT_THAT(valuesOf(answer(enumerateNames(ref(glimmark))).paths, "DeviceID"), ElementsAre("new:/9"));
}

} // namespace GlimmarkProviderTests
