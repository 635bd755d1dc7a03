// The factory's collections, and the alarm device instances and paths that it builds.

#include "GlimmarkFactory.h"
#include "testing/ProviderFixture.h"

#include <Tavro/Common.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace GlimmarkFactoryTests {

using Tavro::GlimmarkProvider::Glimmark;
using Tavro::GlimmarkProvider::GlimmarkFactory;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::IsNull;
using ::testing::NotNull;
using ::testing::SizeIs;

namespace cim = cimhost::cim;

namespace {

constexpr auto glimmark = "TAVRO_Glimmark";
constexpr auto module = "GlimmarkObjFactory";
const std::string arrayStatusText =
    "Create Array for Property" + std::string(25, ' ') + "OperationalStatus failed.";
const std::string arrayTraceText =
    "Create Array for Property Operat" + std::string(24, ' ') + "ionalStatus failed.";

class GlimmarkFactoryTest : public ProviderFixture
{
protected:
    /// A record as the collection makes it of a node.
    static Glimmark record(const MadeInventory::Node& node)
    {
        Glimmark glimmarkRecord;
        glimmarkRecord.setDeviceID(node.description + ":/" + node.path);
        glimmarkRecord.setElementName(node.description);
        if (node.status != 0) {
            glimmarkRecord.setOperationalStatus(node.status);
            glimmarkRecord.setHealthState(node.status);
        }
        glimmarkRecord.setRequestedState(1);
        glimmarkRecord.setVisibleAlarm(true);
        glimmarkRecord.setAlarmState(static_cast<std::uint16_t>(node.alarmState.value_or(0)));
        return glimmarkRecord;
    }

    CMPIInstance* make(const Glimmark& glimmarkRecord, const char** properties = nullptr,
                       bool isObjPath = false)
    {
        return GlimmarkFactory().makeGlimmarkInstance(host.cmpiBroker(), ref(glimmark), glimmarkRecord,
                                                      properties, isObjPath, &rc);
    }

    CMPIString* string(const char* text) const
    {
        return host.cmpiBroker()->eft->newString(host.cmpiBroker(), text, nullptr);
    }

    int getOne(const char* key, const char** properties = nullptr)
    {
        return GlimmarkFactory(true, false)
            .getOneGlimmarkCMPIInstance(host.cmpiBroker(), ref(glimmark), string(key), properties, instances,
                                        &rc);
    }

    int getPaths()
    {
        return GlimmarkFactory(true, false)
            .getAllGlimmarkCMPIObjPaths(host.cmpiBroker(), ref(glimmark), paths, &rc);
    }

    int getInstances(const char** properties = nullptr, bool isObjPath = false)
    {
        return GlimmarkFactory(true, false)
            .getAllGlimmarkCMPIInstances(host.cmpiBroker(), ref(glimmark), properties, isObjPath, instances,
                                         &rc);
    }

    /// The identifiers of the instances or paths so far.
    std::vector<std::string> identifiers() const
    {
        std::vector<std::string> texts;
        for (const CMPIInstance* instance : instances)
            texts.push_back(valueOf(*cimhost::read(instance), "DeviceID"));
        for (const CMPIObjectPath* path : paths)
            texts.push_back(valueOf(*cimhost::read(path), "DeviceID"));
        return texts;
    }

    CMPIStatus rc = {CMPI_RC_OK, nullptr};
    std::vector<CMPIInstance*> instances;
    std::vector<CMPIObjectPath*> paths;
    const std::vector<std::string> keyNames{"CreationClassName", "DeviceID", "SystemCreationClassName",
                                            "SystemName"};
};

} // namespace

// Collections

TEST_F(GlimmarkFactoryTest, WithoutArgumentsCollectsNothing)
{
    MadeInventory::set({{"a", "1"}});
    const GlimmarkFactory factory;
    EXPECT_EQ(factory.getNumberOfInstances(), 0);
    EXPECT_EQ(factory.getAllGlimmarkCapabilitiesCMPIInstances(host.cmpiBroker(), ref(glimmark), nullptr,
                                                              false, instances, &rc),
              0);
    EXPECT_THAT(instances, IsEmpty());
    EXPECT_THAT(Logged::flow(), ::testing::Not(Contains("ENTERING setVector")));
}

TEST_F(GlimmarkFactoryTest, CollectsTheKindsAskedFor)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    for (const bool devices : {false, true}) {
        for (const bool capabilities : {false, true}) {
            instances.clear();
            const GlimmarkFactory factory(devices, capabilities);
            EXPECT_EQ(factory.getNumberOfInstances(), devices ? 2 : 0);
            factory.getAllGlimmarkCapabilitiesCMPIInstances(host.cmpiBroker(), ref(glimmark), nullptr, false,
                                                            instances, &rc);
            EXPECT_THAT(instances, SizeIs(capabilities ? 1 : 0));
        }
    }
}

TEST_F(GlimmarkFactoryTest, CollectsDevicesBeforeCapabilitiesAndDoesNotTraceItself)
{
    MadeInventory::set({{"a", "1"}});
    const GlimmarkFactory factory(true, true);
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING setVector", "EXITING setVector",
                                            "ENTERING getGlimmarkCapabilitiesInstances",
                                            "EXITING getGlimmarkCapabilitiesInstances"));
    EXPECT_THAT(broker.calls(), IsEmpty());
}

TEST_F(GlimmarkFactoryTest, OfEqualIdentifiersTheLastOneWins)
{
    // Blanks around the whole identifier are stripped; those inside belong to it.
    MadeInventory::set({{"a", "1", 1, 1}, {"b", "2"}, {" a", "1 ", 20, 3}});
    EXPECT_EQ(GlimmarkFactory(true, false).getNumberOfInstances(), 2);
    getInstances();
    EXPECT_THAT(identifiers(), ElementsAre("a:/1", "b:/2"));
    EXPECT_EQ(valueOf(*cimhost::read(instances.at(0)), "AlarmState"), "3");
    EXPECT_EQ(valueOf(*cimhost::read(instances.at(0)), "OperationalStatus"), "[3, 5]");
}

TEST_F(GlimmarkFactoryTest, AnInventoryWithoutIndicatorsIsEmpty)
{
    EXPECT_EQ(GlimmarkFactory(true, false).getNumberOfInstances(), 0);
}

TEST_F(GlimmarkFactoryTest, AFailedCollectionIsEmptyAltogether)
{
    MadeInventory::set({{"a", "1"}, {"", "2"}, {"c", "3"}});
    const GlimmarkFactory factory(true, true);
    EXPECT_EQ(factory.getNumberOfInstances(), 0);
    // The capabilities are collected all the same.
    factory.getAllGlimmarkCapabilitiesCMPIInstances(host.cmpiBroker(), ref(glimmark), nullptr, false,
                                                    instances, &rc);
    EXPECT_THAT(instances, SizeIs(1));
}

class ListLengths : public GlimmarkFactoryTest,
                    public ::testing::WithParamInterface<std::pair<std::size_t, int>>
{};

TEST_P(ListLengths, AreMappedModulo65536)
{
    const auto [nodes, mapped] = GetParam();
    std::vector<MadeInventory::Node> inventory;
    for (std::size_t i = 0; i < nodes; ++i)
        inventory.push_back({"n" + std::to_string(i), "p"});
    MadeInventory::set(std::move(inventory));
    EXPECT_EQ(GlimmarkFactory(true, false).getNumberOfInstances(), mapped);
}

INSTANTIATE_TEST_SUITE_P(Some, ListLengths,
                         ::testing::Values(std::pair{std::size_t{65535}, 65535},
                                           std::pair{std::size_t{65536}, 0},
                                           std::pair{std::size_t{65538}, 2}));

// makeGlimmarkInstance

TEST_F(GlimmarkFactoryTest, InstanceHasAllPropertiesInOrder)
{
    const CMPIInstance* const made = make(record({"Fan 1", "f", 20, 3}));
    const cim::Instance instance = cimhost::read(made).value();
    EXPECT_THAT(namesOf(instance), ElementsAre("CreationClassName", "DeviceID", "SystemCreationClassName",
                                               "SystemName", "Caption", "Description", "Name", "ElementName",
                                               "RequestedState", "HealthState", "OperationalStatus",
                                               "AudibleAlarm", "VisibleAlarm", "MotionAlarm", "AlarmState"));
    const std::string hostName = Tavro::getSystemName();
    std::vector<std::string> values;
    for (const cim::Property& property : instance.properties)
        values.push_back(valueOf(instance, property.name));
    EXPECT_THAT(values, ElementsAre("TAVRO_Glimmark", "Fan 1:/f", "TAVRO_ComputerSystem", hostName,
                                    "Diagnostic Indicator", "Fan 1", "Fan 1", "Fan 1", "2", "10", "[3, 5]",
                                    "false", "true", "false", "3"));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(GlimmarkFactoryTest, InstanceIsMadeByTheseCallsInThisOrder)
{
    make(record({"Fan 1", "f", 1, 2}));
    const std::string hostName = '"' + Tavro::getSystemName() + '"';
    EXPECT_THAT(
        broker.calls(),
        ElementsAre("getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                    "newObjectPath(\"root/test\", \"TAVRO_Glimmark\", null)", "getNameSpace(ref, rc)",
                    "getCharPtr(\"root/test\", rc)", "setNameSpace(path1, \"root/test\")",
                    "setHostname(path1, " + hostName + ")", "newInstance(path1, null)",
                    "setPropertyFilter(instance1, null, [CreationClassName DeviceID SystemCreationClassName "
                    "SystemName])",
                    "setProperty(instance1, \"CreationClassName\", \"TAVRO_Glimmark\", chars)",
                    "setProperty(instance1, \"DeviceID\", \"Fan 1:/f\", chars)",
                    "setProperty(instance1, \"SystemCreationClassName\", \"TAVRO_ComputerSystem\", chars)",
                    "setProperty(instance1, \"SystemName\", " + hostName + ", chars)",
                    "setProperty(instance1, \"Caption\", \"Diagnostic Indicator\", chars)",
                    "setProperty(instance1, \"Description\", \"Fan 1\", chars)",
                    "setProperty(instance1, \"Name\", \"Fan 1\", chars)",
                    "setProperty(instance1, \"ElementName\", \"Fan 1\", chars)",
                    "setProperty(instance1, \"RequestedState\", 2, uint16)",
                    "setProperty(instance1, \"HealthState\", 5, uint16)", "newArray(2, uint16, rc)",
                    "setElementAt(array1, 0, 2, uint16)", "setElementAt(array1, 1, 11, uint16)",
                    "setProperty(instance1, \"OperationalStatus\", array1, uint16A)",
                    "setProperty(instance1, \"AudibleAlarm\", 0, boolean)",
                    "setProperty(instance1, \"VisibleAlarm\", 1, boolean)",
                    "setProperty(instance1, \"MotionAlarm\", 0, boolean)",
                    "setProperty(instance1, \"AlarmState\", 2, uint16)"));
}

TEST_F(GlimmarkFactoryTest, InstanceLiesInTheRequestsNamespaceOnThisHost)
{
    const cim::Instance instance = cimhost::read(make(record({"a", "1"}))).value();
    EXPECT_EQ(instance.path.nameSpace, "root/test");
    EXPECT_EQ(instance.path.host, Tavro::getSystemName());
    EXPECT_EQ(instance.path.className, glimmark);
}

TEST_F(GlimmarkFactoryTest, StatesAreOfTheTypesOfTheClass)
{
    const cim::Instance instance = cimhost::read(make(record({"a", "1", 0}))).value();
    for (const cim::Property& property : instance.properties) {
        if (property.name == "OperationalStatus") {
            EXPECT_EQ(property.value.type, CMPI_uint16A);
            EXPECT_FALSE(property.value.isNull) << "an empty array, not a missing one";
            EXPECT_THAT(property.value.items, IsEmpty());
        }
        if (property.name == "AlarmState" || property.name == "HealthState" ||
            property.name == "RequestedState") {
            EXPECT_EQ(property.value.type, CMPI_uint16);
        }
    }
    EXPECT_THAT(namesOf(instance), Contains("OperationalStatus"));
    EXPECT_THAT(broker.calls({"newArray"}), ElementsAre("newArray(0, uint16, rc)"));
}

TEST_F(GlimmarkFactoryTest, KeysOnlyWithoutAListAndWhenAskedForAPath)
{
    EXPECT_EQ(namesOf(cimhost::read(make(record({"a", "1"}), nullptr, true)).value()), keyNames);
}

TEST_F(GlimmarkFactoryTest, AnEmptyListAsksForKeysOnly)
{
    PropertyNames none{};
    for (const bool isObjPath : {false, true})
        EXPECT_EQ(namesOf(cimhost::read(make(record({"a", "1"}), none, isObjPath)).value()), keyNames);
}

TEST_F(GlimmarkFactoryTest, AListAsksForTheNamesInItByTheirExactSpelling)
{
    PropertyNames list{"AlarmState", "caption", "AlarmState"};
    for (const bool isObjPath : {false, true}) {
        broker.clear();
        std::vector<std::string> expected = keyNames;
        expected.emplace_back("AlarmState");
        EXPECT_EQ(namesOf(cimhost::read(make(record({"a", "1"}), list, isObjPath)).value()), expected);
        EXPECT_THAT(broker.calls({"setPropertyFilter"}),
                    ElementsAre("setPropertyFilter(instance1, [AlarmState caption AlarmState], "
                                "[CreationClassName DeviceID SystemCreationClassName SystemName])"));
        EXPECT_THAT(broker.calls({"setProperty"}), SizeIs(5)) << "what is not asked for is not set";
    }
}

class SingleProperties : public GlimmarkFactoryTest, public ::testing::WithParamInterface<const char*>
{};

TEST_P(SingleProperties, CanBeAskedForAlone)
{
    PropertyNames list{GetParam()};
    std::vector<std::string> expected = keyNames;
    expected.emplace_back(GetParam());
    EXPECT_EQ(namesOf(cimhost::read(make(record({"a", "1"}), list)).value()), expected);
}

INSTANTIATE_TEST_SUITE_P(Every, SingleProperties,
                         ::testing::Values("Caption", "Description", "Name", "ElementName", "RequestedState",
                                           "HealthState", "OperationalStatus", "AudibleAlarm", "VisibleAlarm",
                                           "MotionAlarm", "AlarmState"));

TEST_F(GlimmarkFactoryTest, AListIsReadUpToIts65536thName)
{
    std::vector<const char*> names(65536, "Nothing");
    names.back() = "Name";
    names.push_back("HealthState");
    names.push_back(nullptr);
    std::vector<std::string> expected = keyNames;
    expected.emplace_back("Name");
    broker.clear();
    make(record({"a", "1"}), names.data());
    EXPECT_THAT(broker.calls({"setProperty"}), SizeIs(5));
    EXPECT_THAT(broker.calls({"setProperty"}), Contains("setProperty(instance1, \"Name\", \"a\", chars)"));
}

TEST_F(GlimmarkFactoryTest, InstanceIsTraced)
{
    const CMPIObjectPath* const path = ref(glimmark);
    const Glimmark glimmarkRecord = record({"a", "1"});
    PropertyNames list{"Name"};
    const char** const properties = list;
    for (const bool isObjPath : {false, true}) {
        RecordedLog::clear();
        GlimmarkFactory().makeGlimmarkInstance(host.cmpiBroker(), path, glimmarkRecord, properties, isObjPath,
                                               &rc);
        const auto lines = Logged::linesOf("makeGlimmarkInstance");
        ASSERT_THAT(lines, SizeIs(2));
        // The address of the record's copy is known to the function alone.
        const std::string before =
            Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path, " glimmark=");
        const std::string after =
            Logged::parameters(" properties=", properties, " isObjPath=", isObjPath, " rc=", &rc);
        for (const auto& [line, kind] : {std::pair{lines[0], "ENTERING"}, std::pair{lines[1], "EXITING"}}) {
            EXPECT_THAT(line,
                        ::testing::StartsWith(Logged::line(module, kind, "makeGlimmarkInstance", before)));
            EXPECT_THAT(line, ::testing::EndsWith(after));
        }
    }
}

TEST_F(GlimmarkFactoryTest, WithoutAPathThereIsNoInstanceAndNoStatus)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        broker.clear();
        RecordedLog::clear();
        broker.fail("newObjectPath", 1, failure);
        EXPECT_THAT(make(record({"a", "1"})), IsNull());
        EXPECT_EQ(rc.rc, CMPI_RC_OK);
        EXPECT_THAT(broker.calls({"trace", "newString", "setNameSpace", "newInstance"}), IsEmpty());
        EXPECT_THAT(Logged::flow(),
                    ElementsAre("ENTERING makeGlimmarkInstance", "EXITING makeGlimmarkInstance"));
    }
}

TEST_F(GlimmarkFactoryTest, AnInstanceThatCouldNotBeMadeIsHandedBack)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        broker.clear();
        RecordedLog::clear();
        broker.fail("newInstance", 1, failure);
        CMPIInstance* const instance = make(record({"a", "1"}));
        if (failure == Failure::nullResult) {
            EXPECT_THAT(instance, IsNull());
        } else {
            ASSERT_THAT(instance, NotNull());
            EXPECT_THAT(instance->hdl, IsNull());
        }
        EXPECT_EQ(rc.rc, CMPI_RC_OK);
        EXPECT_THAT(broker.calls({"trace", "newString", "setPropertyFilter", "setProperty"}), IsEmpty());
        EXPECT_THAT(Logged::flow(),
                    ElementsAre("ENTERING makeGlimmarkInstance", "EXITING makeGlimmarkInstance"));
    }
}

TEST_F(GlimmarkFactoryTest, WithoutTheArrayTheInstanceIsHandedBackHalfFilledAndTheFailureReported)
{
    broker.fail("newArray", 1, Failure::nullResult);
    const CMPIInstance* const instance = make(record({"a", "1"}));
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(rc), arrayStatusText);
    EXPECT_THAT(broker.calls({"newString", "trace"}),
                ElementsAre("newString(\"" + arrayStatusText + "\", null)",
                            "trace(2, \"GlimmarkProfileProvider\", \"" + arrayTraceText + "\", null)"));
    EXPECT_EQ(namesOf(cimhost::read(instance).value()).back(), "HealthState");
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING makeGlimmarkInstance"));
}

TEST_F(GlimmarkFactoryTest, WithoutTheArrayAndWithoutAStatusOnlyTheTraceIsMade)
{
    broker.fail("newArray", 1, Failure::nullResult);
    GlimmarkFactory().makeGlimmarkInstance(host.cmpiBroker(), ref(glimmark), record({"a", "1"}), nullptr,
                                           false, nullptr);
    EXPECT_THAT(broker.calls({"newString", "trace"}),
                ElementsAre("trace(2, \"GlimmarkProfileProvider\", \"" + arrayTraceText + "\", null)"));
}

TEST_F(GlimmarkFactoryTest, AnArrayIsNotMadeWhenTheOperationalStatusIsNotAskedFor)
{
    PropertyNames list{"AudibleAlarm"};
    make(record({"a", "1"}), list);
    EXPECT_THAT(broker.calls({"newArray"}), IsEmpty());
}

TEST_F(GlimmarkFactoryTest, StatusesOfSettersAreIgnored)
{
    broker.fail("setNameSpace", 1, Failure::errorStatus);
    broker.fail("setHostname", 1, Failure::errorStatus);
    broker.fail("setPropertyFilter", 1, Failure::errorStatus);
    broker.fail("setProperty", 1, Failure::errorStatus);
    EXPECT_THAT(namesOf(cimhost::read(make(record({"a", "1"}))).value()), SizeIs(14));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

// getAllGlimmarkCMPIInstances

TEST_F(GlimmarkFactoryTest, AllInstancesAreAppendedInTheOrderOfTheirIdentifiers)
{
    MadeInventory::set({{"b", "2"}, {"\xC3\xA4", "5"}, {"B", "4"}, {"a", "1"}, {"b", "10"}});
    getInstances();
    // Byte by byte: capitals before small letters, "10" before "2", letters beyond ASCII last.
    EXPECT_THAT(identifiers(), ElementsAre("B:/4", "a:/1", "b:/10", "b:/2", "\xC3\xA4:/5"));
    EXPECT_EQ(getInstances(), 0);
    EXPECT_THAT(instances, SizeIs(10)) << "appended, not replaced";
}

TEST_F(GlimmarkFactoryTest, AllInstancesOfNothingAreNone)
{
    EXPECT_EQ(getInstances(), 0);
    EXPECT_THAT(instances, IsEmpty());
    EXPECT_THAT(broker.calls(), IsEmpty());
    EXPECT_THAT(Logged::flow(),
                ElementsAre("ENTERING getAllGlimmarkCMPIInstances", "EXITING getAllGlimmarkCMPIInstances"));
}

TEST_F(GlimmarkFactoryTest, AllInstancesTakeTheListAndTheFlag)
{
    MadeInventory::set({{"a", "1"}});
    getInstances(nullptr, true);
    PropertyNames list{"Name"};
    getInstances(list, false);
    EXPECT_EQ(namesOf(cimhost::read(instances.at(0)).value()), keyNames);
    EXPECT_THAT(namesOf(cimhost::read(instances.at(1)).value()), SizeIs(5));
}

TEST_F(GlimmarkFactoryTest, AFailureDoesNotStopTheWalkAndItsStatusStays)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}, {"c", "3"}});
    broker.fail("newObjectPath", 1, Failure::nullResult);
    broker.fail("newArray", 2, Failure::nullResult);
    EXPECT_EQ(getInstances(), 0);
    ASSERT_THAT(instances, SizeIs(3));
    EXPECT_THAT(instances[0], IsNull());
    EXPECT_EQ(message(rc), arrayStatusText);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(Logged::flow().back(), "EXITING getAllGlimmarkCMPIInstances");
}

TEST_F(GlimmarkFactoryTest, AllInstancesAreTraced)
{
    const CMPIObjectPath* const path = ref(glimmark);
    PropertyNames list{"Name"};
    const char** const properties = list;
    for (const bool isObjPath : {false, true}) {
        RecordedLog::clear();
        GlimmarkFactory().getAllGlimmarkCMPIInstances(host.cmpiBroker(), path, properties, isObjPath,
                                                      instances, &rc);
        const auto parameters =
            Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path, " properties=", properties,
                               " isObjPath=", isObjPath, " instances=", &instances, " rc=", &rc);
        EXPECT_THAT(Logged::lines(),
                    ElementsAre(Logged::line(module, "ENTERING", "getAllGlimmarkCMPIInstances", parameters),
                                Logged::line(module, "EXITING", "getAllGlimmarkCMPIInstances", parameters)));
    }
}

// getOneGlimmarkCMPIInstance

TEST_F(GlimmarkFactoryTest, OneInstanceIsFoundByItsIdentifier)
{
    MadeInventory::set({{"a", "1"}, {" b", "2 "}, {"c", "3"}});
    EXPECT_EQ(getOne("b:/2"), 0);
    EXPECT_THAT(identifiers(), ElementsAre("b:/2"));
    EXPECT_EQ(namesOf(cimhost::read(instances.at(0)).value()).size(), 15U) << "a full instance";
}

TEST_F(GlimmarkFactoryTest, OneInstanceIsNotFoundByAnythingElse)
{
    MadeInventory::set({{"a", "1"}, {" b", "2 "}});
    rc = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    for (const char* key : {"B:/2", "b:/2 ", " b:/2", "b", ""}) {
        RecordedLog::clear();
        EXPECT_EQ(getOne(key), 1) << key;
        EXPECT_THAT(Logged::linesOf("getOneGlimmarkCMPIInstance"), SizeIs(1)) << "ENTERING only";
    }
    EXPECT_THAT(instances, IsEmpty());
    EXPECT_THAT(broker.calls({"trace"}), IsEmpty());
}

TEST_F(GlimmarkFactoryTest, OneInstanceOfANullKeyIsNotFound)
{
    MadeInventory::set({{"a", "1"}});
    const GlimmarkFactory factory(true, false);
    const auto getOneOf = [&](CMPIString* key) {
        return factory.getOneGlimmarkCMPIInstance(host.cmpiBroker(), ref(glimmark), key, nullptr, instances,
                                                  &rc);
    };
    EXPECT_EQ(getOneOf(nullptr), 1);
    broker.fail("getCharPtr", 1, Failure::nullResult);
    EXPECT_EQ(getOneOf(string("a:/1")), 1);
    EXPECT_THAT(instances, IsEmpty());
}

TEST_F(GlimmarkFactoryTest, OneInstanceReadsItsKeyWithTheStatus)
{
    MadeInventory::set({{"a", "1"}});
    getOne("a:/1");
    EXPECT_EQ(broker.calls({"getCharPtr"}).front(), "getCharPtr(\"a:/1\", rc)");
}

TEST_F(GlimmarkFactoryTest, OneInstanceTakesTheList)
{
    MadeInventory::set({{"a", "1"}});
    PropertyNames list{"Name"};
    getOne("a:/1", list);
    EXPECT_THAT(namesOf(cimhost::read(instances.at(0)).value()), SizeIs(5));
}

TEST_F(GlimmarkFactoryTest, OneInstanceIsAppendedEvenWhenItCouldNotBeMade)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("newInstance", 1, Failure::nullResult);
    EXPECT_EQ(getOne("a:/1"), 0);
    EXPECT_THAT(instances, ElementsAre(IsNull()));
}

TEST_F(GlimmarkFactoryTest, OneInstanceIsTraced)
{
    MadeInventory::set({{"a", "1"}});
    const GlimmarkFactory factory(true, false);
    const CMPIObjectPath* const path = ref(glimmark);
    CMPIString* const key = string("a:/1");
    PropertyNames list{"Name"};
    const char** const properties = list;
    factory.getOneGlimmarkCMPIInstance(host.cmpiBroker(), path, key, properties, instances, &rc);
    const std::string function = "getOneGlimmarkCMPIInstance";
    const auto parameters =
        Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path, " key=", key,
                           " properties=", properties, " instances=", &instances, " rc=", &rc);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
    EXPECT_THAT(Logged::linesOf("makeGlimmarkInstance").at(0), ::testing::HasSubstr(" isObjPath=0 "));
}

// getAllGlimmarkCMPIObjPaths

TEST_F(GlimmarkFactoryTest, AllPathsAreAppendedInTheOrderOfTheirIdentifiers)
{
    MadeInventory::set({{"b", "2"}, {"a", "1"}});
    EXPECT_EQ(getPaths(), 0);
    EXPECT_THAT(identifiers(), ElementsAre("a:/1", "b:/2"));
    EXPECT_EQ(getPaths(), 0);
    EXPECT_THAT(paths, SizeIs(4)) << "appended, not replaced";
    const cim::ObjectPath path = cimhost::read(paths[0]).value();
    EXPECT_EQ(path.nameSpace, "root/test");
    EXPECT_EQ(path.host, Tavro::getSystemName());
    EXPECT_EQ(path.className, glimmark);
}

TEST_F(GlimmarkFactoryTest, PathIsMadeByTheseCallsInThisOrder)
{
    MadeInventory::set({{"a", "1"}});
    getPaths();
    const std::string hostName = '"' + Tavro::getSystemName() + '"';
    EXPECT_THAT(broker.calls(),
                ElementsAre("getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                            "newObjectPath(\"root/test\", \"TAVRO_Glimmark\", rc)", "getNameSpace(ref, rc)",
                            "getCharPtr(\"root/test\", rc)", "setNameSpace(path1, \"root/test\")",
                            "setHostname(path1, " + hostName + ")",
                            "addKey(path1, \"CreationClassName\", \"TAVRO_Glimmark\", chars)",
                            "addKey(path1, \"DeviceID\", \"a:/1\", chars)",
                            "addKey(path1, \"SystemCreationClassName\", \"TAVRO_ComputerSystem\", chars)",
                            "addKey(path1, \"SystemName\", " + hostName + ", chars)"));
}

TEST_F(GlimmarkFactoryTest, PathsOfNothingAreReportedForInformation)
{
    rc = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    EXPECT_EQ(getPaths(), 1);
    EXPECT_THAT(paths, IsEmpty());
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_ACCESS_DENIED) << "untouched";
    EXPECT_THAT(broker.calls(),
                ElementsAre("trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)"));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING getAllGlimmarkCMPIObjPaths"));
}

TEST_F(GlimmarkFactoryTest, PathsEndAtTheFirstThatCannotBeMade)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}, {"c", "3"}});
    const std::string traceText =
        "Create CMPIObjectPath" + std::string(21, ' ') + "failed for RecordLogClass.";
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        broker.clear();
        RecordedLog::clear();
        paths.clear();
        broker.fail("newObjectPath", 2, failure);
        EXPECT_EQ(getPaths(), 2);
        EXPECT_THAT(identifiers(), ElementsAre("a:/1")) << "those before it stay";
        EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(rc), "Create CMPIObjectPath failed.");
        EXPECT_THAT(broker.calls({"newString", "trace"}),
                    ElementsAre("newString(\"Create CMPIObjectPath failed.\", null)",
                                "trace(2, \"GlimmarkProfileProvider\", \"" + traceText + "\", null)"));
        EXPECT_THAT(Logged::linesOf("getAllGlimmarkCMPIObjPaths"), SizeIs(1));
    }
}

TEST_F(GlimmarkFactoryTest, PathsThatCannotBeMadeAreTracedWithoutAStatusToo)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("newObjectPath", 1, Failure::nullResult);
    const GlimmarkFactory factory(true, false);
    EXPECT_EQ(factory.getAllGlimmarkCMPIObjPaths(host.cmpiBroker(), ref(glimmark), paths, nullptr), 2);
    EXPECT_THAT(broker.calls({"newString"}), IsEmpty());
    EXPECT_THAT(broker.calls({"trace"}), SizeIs(1));
}

TEST_F(GlimmarkFactoryTest, PathsAreTraced)
{
    MadeInventory::set({{"a", "1"}});
    const GlimmarkFactory factory(true, false);
    const CMPIObjectPath* const path = ref(glimmark);
    factory.getAllGlimmarkCMPIObjPaths(host.cmpiBroker(), path, paths, &rc);
    const std::string function = "getAllGlimmarkCMPIObjPaths";
    const auto parameters = Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path,
                                               " objectPaths=", &paths, " status=", &rc);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
}

} // namespace GlimmarkFactoryTests
