// The capabilities instances and paths that the factory builds.

#include "GlimmarkFactory.h"
#include "testing/ProviderFixture.h"

#include <Tavro/Common.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace CapabilitiesObjectsTests {

using Tavro::GlimmarkProvider::GlimmarkCapabilities;
using Tavro::GlimmarkProvider::GlimmarkFactory;
using ::testing::ElementsAre;
using ::testing::EndsWith;
using ::testing::IsEmpty;
using ::testing::IsNull;
using ::testing::NotNull;
using ::testing::SizeIs;
using ::testing::StartsWith;

namespace cim = cimhost::cim;

namespace {

constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";
constexpr auto identifier = "TAVRO:GlimmarkCapabilities1";
constexpr auto module = "GlimmarkObjFactory";
constexpr auto makeOne = "makeGlimmarkCapabilitiesInstance";
constexpr auto allInstances = "getAllGlimmarkCapabilitiesCMPIInstances";
constexpr auto oneInstance = "getOneGlimmarkCapabilitiesCMPIInstance";
constexpr auto allPaths = "getAllGlimmarkCapabilitiesCMPIObjPaths";
constexpr auto noInstanceTrace =
    R"(trace(2, "GlimmarkCapabilitiesProvider", "***No instance found***", null))";

// "array" for who asked, "Array" for the trace.
const std::string arrayStatusText =
    "Creating array for Property" + std::string(25, ' ') + "RequestedAlarmStatesSupported failed.";
const std::string arrayTraceText =
    "Creating Array for Property" + std::string(25, ' ') + "RequestedAlarmStatesSupported failed.";
// No full stop for who asked.
const std::string pathStatusText = "Create CMPIObjectPath failed";
const std::string pathTraceText =
    "Create CMPIObjectPath failed for" + std::string(21, ' ') + "GlimmarkCapabilities class";

/// The broker's trace of a failure, as the recording writes it.
std::string warning(const std::string& text)
{
    return R"(trace(2, "GlimmarkCapabilitiesProvider", ")" + text + "\", null)";
}

class CapabilitiesObjectsTest : public ProviderFixture
{
protected:
    CMPIInstance* make(const char** properties = nullptr, bool isObjPath = false)
    {
        return GlimmarkFactory().makeGlimmarkCapabilitiesInstance(
            host.cmpiBroker(), ref(capabilities), GlimmarkCapabilities(), properties, isObjPath, &rc);
    }

    std::vector<std::string> namesOfMade(const char** properties, bool isObjPath = false)
    {
        return namesOf(cimhost::read(make(properties, isObjPath)).value());
    }

    int getInstances(const char** properties = nullptr, bool isObjPath = false)
    {
        return factory.getAllGlimmarkCapabilitiesCMPIInstances(host.cmpiBroker(), ref(capabilities),
                                                               properties, isObjPath, instances, &rc);
    }

    CMPIString* string(const char* text) const
    {
        return host.cmpiBroker()->eft->newString(host.cmpiBroker(), text, nullptr);
    }

    int getOne(CMPIString* key, const char** properties = nullptr)
    {
        return factory.getOneGlimmarkCapabilitiesCMPIInstance(host.cmpiBroker(), ref(capabilities), key,
                                                              properties, instances, &rc);
    }

    int getPaths()
    {
        return factory.getAllGlimmarkCapabilitiesCMPIObjPaths(host.cmpiBroker(), ref(capabilities), paths,
                                                              &rc);
    }

    const GlimmarkFactory factory{false, true};
    CMPIStatus rc = {CMPI_RC_OK, nullptr};
    std::vector<CMPIInstance*> instances;
    std::vector<CMPIObjectPath*> paths;
    const std::string hostName = '"' + Tavro::getSystemName() + '"';
};

/// Their factory holds the alarm devices and no capabilities.
class NoCapabilitiesTest : public CapabilitiesObjectsTest
{
protected:
    NoCapabilitiesTest() { clearRecords(); }

    const GlimmarkFactory empty{true, false};
};

} // namespace

// makeGlimmarkCapabilitiesInstance

TEST_F(CapabilitiesObjectsTest, InstanceHasTheIdentifierAndTheSupportedStates)
{
    const cim::Instance instance = cimhost::read(make()).value();
    EXPECT_THAT(namesOf(instance), ElementsAre("InstanceID", "RequestedAlarmStatesSupported"));
    EXPECT_EQ(valueOf(instance, "InstanceID"), identifier);
    EXPECT_EQ(valueOf(instance, "RequestedAlarmStatesSupported"), "[1, 2, 3]");
    EXPECT_EQ(instance.properties.at(0).value.type, CMPI_string);
    EXPECT_EQ(instance.properties.at(1).value.type, CMPI_uint16A);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_THAT(rc.msg, IsNull());
}

TEST_F(CapabilitiesObjectsTest, InstanceLiesInTheRequestsNamespaceOnThisHost)
{
    const cim::Instance instance = cimhost::read(make()).value();
    EXPECT_EQ(instance.path.nameSpace, "root/test");
    EXPECT_EQ(instance.path.host, Tavro::getSystemName());
    EXPECT_EQ(instance.path.className, capabilities);
}

TEST_F(CapabilitiesObjectsTest, InstanceIsMadeByTheseCallsInThisOrder)
{
    clearRecords();
    make();
    EXPECT_THAT(timeline(),
                ElementsAre("ENTERING makeGlimmarkCapabilitiesInstance", "getNameSpace(ref, rc)",
                            "getCharPtr(\"root/test\", rc)",
                            "newObjectPath(\"root/test\", \"TAVRO_GlimmarkCapabilities\", null)",
                            "getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                            "setNameSpace(path1, \"root/test\")", "setHostname(path1, " + hostName + ")",
                            "newInstance(path1, null)", "setPropertyFilter(instance1, null, [InstanceID])",
                            "setProperty(instance1, \"InstanceID\", \"TAVRO:GlimmarkCapabilities1\", chars)",
                            "newArray(3, uint16, rc)", "setElementAt(array1, 0, 1, uint16)",
                            "setElementAt(array1, 1, 2, uint16)", "setElementAt(array1, 2, 3, uint16)",
                            "setProperty(instance1, \"RequestedAlarmStatesSupported\", array1, uint16A)",
                            "EXITING makeGlimmarkCapabilitiesInstance"));
}

TEST_F(CapabilitiesObjectsTest, InstanceCarriesAllStatesOfItsRecord)
{
    GlimmarkCapabilities record;
    record.getAlarmStatesSupported(); // each time it is asked, a record's list grows
    const CMPIInstance* const instance = GlimmarkFactory().makeGlimmarkCapabilitiesInstance(
        host.cmpiBroker(), ref(capabilities), record, nullptr, false, &rc);
    EXPECT_EQ(valueOf(cimhost::read(instance).value(), "RequestedAlarmStatesSupported"),
              "[1, 2, 3, 1, 2, 3]");
    EXPECT_EQ(record.getAlarmStatesSupported().size(), 6U) << "the caller's record is left alone";
}

TEST_F(CapabilitiesObjectsTest, WithoutAListAPathIsMadeOfTheKeyOnly)
{
    EXPECT_THAT(namesOfMade(nullptr, true), ElementsAre("InstanceID"));
    EXPECT_THAT(broker.calls({"setPropertyFilter", "setProperty", "newArray"}), SizeIs(2))
        << "what is not asked for is not made";
}

TEST_F(CapabilitiesObjectsTest, AListAsksForTheNamesInItByTheirExactSpelling)
{
    PropertyNames none{};
    PropertyNames key{"InstanceID"};
    PropertyNames otherCase{"requestedAlarmStatesSupported", "ElementName"};
    PropertyNames states{"Caption", "RequestedAlarmStatesSupported"};
    for (const bool isObjPath : {false, true}) {
        EXPECT_THAT(namesOfMade(none, isObjPath), ElementsAre("InstanceID"));
        EXPECT_THAT(namesOfMade(key, isObjPath), ElementsAre("InstanceID"));
        EXPECT_THAT(namesOfMade(otherCase, isObjPath), ElementsAre("InstanceID"));
        EXPECT_THAT(broker.calls({"newArray"}), IsEmpty());
        EXPECT_THAT(namesOfMade(states, isObjPath),
                    ElementsAre("InstanceID", "RequestedAlarmStatesSupported"));
        broker.clear();
    }
}

TEST_F(CapabilitiesObjectsTest, TheListIsTheInstancesFilter)
{
    PropertyNames none{};
    PropertyNames key{"InstanceID"};
    PropertyNames others{"Caption", "RequestedAlarmStatesSupported"};
    make(nullptr, true);
    make(none);
    make(key);
    make(others, true);
    EXPECT_THAT(
        broker.calls({"setPropertyFilter"}),
        ElementsAre("setPropertyFilter(instance1, null, [InstanceID])",
                    "setPropertyFilter(instance2, [], [InstanceID])",
                    "setPropertyFilter(instance3, [InstanceID], [InstanceID])",
                    "setPropertyFilter(instance4, [Caption RequestedAlarmStatesSupported], [InstanceID])"));
}

TEST_F(CapabilitiesObjectsTest, InstanceIsTraced)
{
    const CMPIObjectPath* const path = ref(capabilities);
    PropertyNames list{"InstanceID"};
    const char** const properties = list;
    for (const bool isObjPath : {false, true}) {
        RecordedLog::clear();
        factory.makeGlimmarkCapabilitiesInstance(host.cmpiBroker(), path, GlimmarkCapabilities(), properties,
                                                 isObjPath, &rc);
        const auto lines = Logged::lines();
        ASSERT_THAT(lines, SizeIs(2));
        // The address of the record's copy is known to the function alone.
        const std::string before =
            Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path, " glimmarkCap=") + "0x";
        const std::string after =
            Logged::parameters(" properties=", properties, " IsObjPath=", isObjPath, " rc=", &rc);
        EXPECT_THAT(lines[0], StartsWith(Logged::line(module, "ENTERING", makeOne, before)));
        EXPECT_THAT(lines[0], EndsWith(after));
        EXPECT_THAT(lines[1], StartsWith(Logged::line(module, "EXITING", makeOne, before)));
        EXPECT_THAT(lines[1], EndsWith(after));
    }
}

TEST_F(CapabilitiesObjectsTest, WithoutAPathThereIsNoInstanceAndNoStatus)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        clearRecords();
        broker.fail("newObjectPath", 1, failure);
        EXPECT_THAT(make(), IsNull());
        EXPECT_EQ(rc.rc, CMPI_RC_OK);
        EXPECT_THAT(rc.msg, IsNull());
        EXPECT_EQ(timeline().back(), "EXITING makeGlimmarkCapabilitiesInstance");
        EXPECT_THAT(broker.calls(), SizeIs(3)) << "nothing after the path";
    }
}

TEST_F(CapabilitiesObjectsTest, AnInstanceThatCouldNotBeMadeIsHandedBack)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        clearRecords();
        broker.fail("newInstance", 1, failure);
        CMPIInstance* const instance = make();
        if (failure == Failure::nullResult) {
            EXPECT_THAT(instance, IsNull());
        } else {
            ASSERT_THAT(instance, NotNull());
            EXPECT_THAT(instance->hdl, IsNull());
        }
        EXPECT_EQ(rc.rc, CMPI_RC_OK);
        const auto all = timeline();
        ASSERT_GE(all.size(), 2U);
        EXPECT_EQ(all[all.size() - 2], "newInstance(path1, null)") << "nothing is set on it";
        EXPECT_EQ(all.back(), "EXITING makeGlimmarkCapabilitiesInstance");
    }
}

TEST_F(CapabilitiesObjectsTest, WithoutTheArrayTheInstanceCarriesItsKeyAndTheFailureIsReported)
{
    for (const Failure failure : {Failure::nullResult, Failure::errorStatus}) {
        clearRecords();
        rc = {CMPI_RC_OK, nullptr};
        broker.fail("newArray", 1, failure);
        const CMPIInstance* const instance = make();
        EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(rc), arrayStatusText);
        EXPECT_THAT(namesOf(cimhost::read(instance).value()), ElementsAre("InstanceID"));
        const auto all = timeline();
        ASSERT_GE(all.size(), 4U);
        EXPECT_THAT(std::vector<std::string>(all.end() - 4, all.end()),
                    ElementsAre("newArray(3, uint16, rc)", "newString(\"" + arrayStatusText + "\", null)",
                                warning(arrayTraceText), "EXITING makeGlimmarkCapabilitiesInstance"));
    }
}

TEST_F(CapabilitiesObjectsTest, WithoutTheArrayAndWithoutAStatusOnlyTheTraceIsMade)
{
    broker.fail("newArray", 1, Failure::nullResult);
    factory.makeGlimmarkCapabilitiesInstance(host.cmpiBroker(), ref(capabilities), GlimmarkCapabilities(),
                                             nullptr, false, nullptr);
    EXPECT_THAT(broker.calls({"newString", "trace"}), ElementsAre(warning(arrayTraceText)));
    EXPECT_THAT(
        broker.calls({"newArray", "getNameSpace"}),
        ElementsAre("getNameSpace(ref, null)", "getNameSpace(ref, null)", "newArray(3, uint16, null)"));
}

TEST_F(CapabilitiesObjectsTest, StatusesOfSettersAreIgnored)
{
    for (const char* setter :
         {"setNameSpace", "setHostname", "setPropertyFilter", "setProperty", "setElementAt"})
        broker.fail(setter, 1, Failure::errorStatus);
    EXPECT_THAT(namesOfMade(nullptr), ElementsAre("RequestedAlarmStatesSupported"));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(CapabilitiesObjectsTest, WithoutABrokerNothingIsMade)
{
    clearRecords();
    EXPECT_THAT(factory.makeGlimmarkCapabilitiesInstance(nullptr, ref(capabilities), GlimmarkCapabilities(),
                                                         nullptr, false, &rc),
                IsNull());
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(factory.getAllGlimmarkCapabilitiesCMPIObjPaths(nullptr, ref(capabilities), paths, &rc), 2);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(rc.msg, IsNull());
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING makeGlimmarkCapabilitiesInstance",
                                            "EXITING makeGlimmarkCapabilitiesInstance",
                                            "ENTERING getAllGlimmarkCapabilitiesCMPIObjPaths"));
}

// getAllGlimmarkCapabilitiesCMPIInstances

TEST_F(CapabilitiesObjectsTest, AllInstancesAreTheOne)
{
    EXPECT_EQ(getInstances(), 0);
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_EQ(valueOf(cimhost::read(instances[0]).value(), "InstanceID"), identifier);
    EXPECT_EQ(getInstances(), 0);
    ASSERT_THAT(instances, SizeIs(2)) << "appended, not replaced";
    EXPECT_EQ(valueOf(cimhost::read(instances[1]).value(), "RequestedAlarmStatesSupported"), "[1, 2, 3]")
        << "the factory's record is not changed by being answered from";
}

TEST_F(CapabilitiesObjectsTest, AllInstancesTakeTheListAndTheFlag)
{
    PropertyNames list{"RequestedAlarmStatesSupported"};
    getInstances(nullptr, true);
    getInstances(nullptr, false);
    getInstances(list, true);
    ASSERT_THAT(instances, SizeIs(3));
    EXPECT_THAT(namesOf(cimhost::read(instances[0]).value()), SizeIs(1));
    EXPECT_THAT(namesOf(cimhost::read(instances[1]).value()), SizeIs(2));
    EXPECT_THAT(namesOf(cimhost::read(instances[2]).value()), SizeIs(2));
}

TEST_F(CapabilitiesObjectsTest, AllInstancesIncludeTheOneThatCouldNotBeMade)
{
    broker.fail("newInstance", 1, Failure::nullResult);
    EXPECT_EQ(getInstances(), 0);
    EXPECT_THAT(instances, ElementsAre(IsNull()));
}

TEST_F(CapabilitiesObjectsTest, AllInstancesSucceedWithoutTheArrayAndLeaveItsStatus)
{
    broker.fail("newArray", 1, Failure::nullResult);
    EXPECT_EQ(getInstances(), 0);
    EXPECT_THAT(instances, ElementsAre(NotNull()));
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(rc), arrayStatusText);
}

TEST_F(CapabilitiesObjectsTest, AllInstancesAreTraced)
{
    const CMPIObjectPath* const path = ref(capabilities);
    PropertyNames list{"InstanceID"};
    const char** const properties = list;
    for (const bool isObjPath : {false, true}) {
        clearRecords();
        factory.getAllGlimmarkCapabilitiesCMPIInstances(host.cmpiBroker(), path, properties, isObjPath,
                                                        instances, &rc);
        const auto parameters =
            Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path, " properties=", properties,
                               " isObjPath=", isObjPath, " instances=", &instances, " rc=", &rc);
        EXPECT_THAT(Logged::linesOf(allInstances),
                    ElementsAre(Logged::line(module, "ENTERING", allInstances, parameters),
                                Logged::line(module, "EXITING", allInstances, parameters)));
        EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING getAllGlimmarkCapabilitiesCMPIInstances",
                                                "ENTERING makeGlimmarkCapabilitiesInstance",
                                                "EXITING makeGlimmarkCapabilitiesInstance",
                                                "EXITING getAllGlimmarkCapabilitiesCMPIInstances"));
        EXPECT_THAT(Logged::linesOf(makeOne).at(0), EndsWith(Logged::parameters(" rc=", &rc)));
    }
}

TEST_F(NoCapabilitiesTest, AllInstancesAreNone)
{
    EXPECT_EQ(empty.getAllGlimmarkCapabilitiesCMPIInstances(host.cmpiBroker(), ref(capabilities), nullptr,
                                                            false, instances, &rc),
              0);
    EXPECT_THAT(instances, IsEmpty());
    EXPECT_THAT(timeline(), ElementsAre("ENTERING getAllGlimmarkCapabilitiesCMPIInstances",
                                        "EXITING getAllGlimmarkCapabilitiesCMPIInstances"));
}

// getOneGlimmarkCapabilitiesCMPIInstance

TEST_F(CapabilitiesObjectsTest, OneInstanceIsFoundByItsIdentifier)
{
    EXPECT_EQ(getOne(string(identifier)), 0);
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(cimhost::read(instances[0]).value()),
                ElementsAre("InstanceID", "RequestedAlarmStatesSupported"));
}

TEST_F(CapabilitiesObjectsTest, OneInstanceIsNotFoundByAnythingElse)
{
    rc = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    for (const char* key : {"tavro:glimmarkcapabilities1", "TAVRO:GlimmarkCapabilities",
                            "TAVRO:GlimmarkCapabilities10", " TAVRO:GlimmarkCapabilities1", ""}) {
        CMPIString* const text = string(key);
        clearRecords();
        EXPECT_EQ(getOne(text), 1) << key;
        EXPECT_THAT(timeline(), ElementsAre("ENTERING getOneGlimmarkCapabilitiesCMPIInstance",
                                            "getCharPtr(\"" + std::string(key) + "\", rc)"));
    }
    EXPECT_THAT(instances, IsEmpty());
}

TEST_F(CapabilitiesObjectsTest, OneInstanceOfANullKeyIsNotFound)
{
    EXPECT_EQ(getOne(nullptr), 1);
    broker.fail("getCharPtr", 1, Failure::nullResult);
    EXPECT_EQ(getOne(string(identifier)), 1);
    EXPECT_THAT(instances, IsEmpty());
}

TEST_F(CapabilitiesObjectsTest, OneInstanceIsAppendedEvenWhenItCouldNotBeMade)
{
    broker.fail("newInstance", 1, Failure::nullResult);
    EXPECT_EQ(getOne(string(identifier)), 0);
    EXPECT_THAT(instances, ElementsAre(IsNull()));
}

TEST_F(CapabilitiesObjectsTest, OneInstanceTakesTheListAndReportsThroughTheStatus)
{
    PropertyNames list{"InstanceID"};
    getOne(string(identifier), list);
    EXPECT_THAT(namesOf(cimhost::read(instances.at(0)).value()), ElementsAre("InstanceID"));
    broker.fail("newArray", 1, Failure::nullResult);
    EXPECT_EQ(getOne(string(identifier)), 0);
    EXPECT_EQ(message(rc), arrayStatusText);
}

TEST_F(CapabilitiesObjectsTest, OneInstanceIsTraced)
{
    const CMPIObjectPath* const path = ref(capabilities);
    CMPIString* const key = string(identifier);
    PropertyNames list{"InstanceID"};
    const char** const properties = list;
    clearRecords();
    factory.getOneGlimmarkCapabilitiesCMPIInstance(host.cmpiBroker(), path, key, properties, instances, &rc);
    const auto parameters =
        Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path, " key=", key,
                           " properties=", properties, " instances=", &instances, " rc=", &rc);
    EXPECT_THAT(Logged::linesOf(oneInstance),
                ElementsAre(Logged::line(module, "ENTERING", oneInstance, parameters),
                            Logged::line(module, "EXITING", oneInstance, parameters)));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING getOneGlimmarkCapabilitiesCMPIInstance",
                                            "ENTERING makeGlimmarkCapabilitiesInstance",
                                            "EXITING makeGlimmarkCapabilitiesInstance",
                                            "EXITING getOneGlimmarkCapabilitiesCMPIInstance"));
    EXPECT_THAT(Logged::linesOf(makeOne).at(0), EndsWith(Logged::parameters(" IsObjPath=0 rc=", &rc)));
}

TEST_F(NoCapabilitiesTest, OneInstanceIsNotFound)
{
    EXPECT_EQ(empty.getOneGlimmarkCapabilitiesCMPIInstance(host.cmpiBroker(), ref(capabilities),
                                                           string(identifier), nullptr, instances, &rc),
              1);
    EXPECT_THAT(instances, IsEmpty());
}

// getAllGlimmarkCapabilitiesCMPIObjPaths

TEST_F(CapabilitiesObjectsTest, AllPathsAreTheOne)
{
    EXPECT_EQ(getPaths(), 0);
    ASSERT_THAT(paths, SizeIs(1));
    const cim::ObjectPath path = cimhost::read(paths[0]).value();
    EXPECT_EQ(path.nameSpace, "root/test");
    EXPECT_EQ(path.host, Tavro::getSystemName());
    EXPECT_EQ(path.className, capabilities);
    ASSERT_THAT(path.keys, SizeIs(1));
    EXPECT_EQ(valueOf(path, "InstanceID"), identifier);
    EXPECT_EQ(getPaths(), 0);
    EXPECT_THAT(paths, SizeIs(2)) << "appended, not replaced";
}

TEST_F(CapabilitiesObjectsTest, PathIsMadeByTheseCallsInThisOrder)
{
    clearRecords();
    getPaths();
    EXPECT_THAT(timeline(),
                ElementsAre("ENTERING getAllGlimmarkCapabilitiesCMPIObjPaths", "getNameSpace(ref, rc)",
                            "getCharPtr(\"root/test\", rc)",
                            "newObjectPath(\"root/test\", \"TAVRO_GlimmarkCapabilities\", rc)",
                            "getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                            "setNameSpace(path1, \"root/test\")", "setHostname(path1, " + hostName + ")",
                            "addKey(path1, \"InstanceID\", \"TAVRO:GlimmarkCapabilities1\", chars)",
                            "EXITING getAllGlimmarkCapabilitiesCMPIObjPaths"));
}

TEST_F(NoCapabilitiesTest, PathsAreReportedAsAWarning)
{
    rc = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    EXPECT_EQ(empty.getAllGlimmarkCapabilitiesCMPIObjPaths(host.cmpiBroker(), ref(capabilities), paths, &rc),
              1);
    EXPECT_THAT(paths, IsEmpty());
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_ACCESS_DENIED) << "untouched";
    EXPECT_THAT(timeline(), ElementsAre("ENTERING getAllGlimmarkCapabilitiesCMPIObjPaths", noInstanceTrace));
}

TEST_F(CapabilitiesObjectsTest, APathThatCannotBeMadeIsReported)
{
    getPaths();
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        clearRecords();
        rc = {CMPI_RC_OK, nullptr};
        broker.fail("newObjectPath", 1, failure);
        EXPECT_EQ(getPaths(), 2);
        EXPECT_THAT(paths, SizeIs(1)) << "what was in the list stays";
        EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(rc), pathStatusText);
        EXPECT_THAT(timeline(),
                    ElementsAre("ENTERING getAllGlimmarkCapabilitiesCMPIObjPaths", "getNameSpace(ref, rc)",
                                "getCharPtr(\"root/test\", rc)",
                                "newObjectPath(\"root/test\", \"TAVRO_GlimmarkCapabilities\", rc)",
                                "newString(\"" + pathStatusText + "\", null)", warning(pathTraceText)));
    }
}

TEST_F(CapabilitiesObjectsTest, APathThatCannotBeMadeIsTracedWithoutAStatusToo)
{
    broker.fail("newObjectPath", 1, Failure::nullResult);
    EXPECT_EQ(
        factory.getAllGlimmarkCapabilitiesCMPIObjPaths(host.cmpiBroker(), ref(capabilities), paths, nullptr),
        2);
    EXPECT_THAT(broker.calls({"newString", "trace"}), ElementsAre(warning(pathTraceText)));
}

TEST_F(CapabilitiesObjectsTest, PathsAreTraced)
{
    const CMPIObjectPath* const path = ref(capabilities);
    clearRecords();
    factory.getAllGlimmarkCapabilitiesCMPIObjPaths(host.cmpiBroker(), path, paths, &rc);
    const auto parameters = Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path,
                                               " objectPaths=", &paths, " status=", &rc);
    EXPECT_THAT(Logged::lines(), ElementsAre(Logged::line(module, "ENTERING", allPaths, parameters),
                                             Logged::line(module, "EXITING", allPaths, parameters)));
}

} // namespace CapabilitiesObjectsTests
