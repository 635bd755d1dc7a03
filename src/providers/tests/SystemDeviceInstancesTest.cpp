// The instances of TAVRO_GlimmarkSystemDevice, driven through the provider's function table.

#include "testing/SystemDeviceFixture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace SystemDeviceInstancesTests {

using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::ElementsAreArray;
using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using ::testing::StartsWith;

namespace cim = cimhost::cim;

using SystemDevice::association;
using SystemDevice::enumerationFailed;
using SystemDevice::joined;
using SystemDevice::module;
using SystemDevice::pairsOf;
using SystemDevice::statusText;
using SystemDevice::warning;

namespace {

const std::string forNames = "GlimmarkSystemDevice_EnumInstanceNames";
const std::string forInstances = "GlimmarkSystemDevice_EnumInstances";
const std::string forOne = "GlimmarkSystemDevice_GetInstance";
const std::string forBuilder = "glimmarkSystemDeviceCMPIInstances";
const std::string forPaths = "getAllGlimmarkCMPIObjPaths";
const std::string noKeys = "At least one key should be passed";

// Runs of blanks that are parts of texts.
const std::string twelveBlanks(12, ' ');
const std::string thirteenBlanks(13, ' ');
const std::string twentyOneBlanks(21, ' ');

class SystemDeviceInstances : public SystemDevice::Fixture
{
protected:
    using Fixture::Fixture;

    CMPIStatus enumerateNames()
    {
        return mi->ft->enumerateInstanceNames(mi, ctx(), rslt(), ref(association));
    }
    CMPIStatus enumerate(const char** properties = nullptr)
    {
        return mi->ft->enumerateInstances(mi, ctx(), rslt(), ref(association), properties);
    }
    CMPIStatus get(const CMPIObjectPath* path, const char** properties = nullptr)
    {
        return mi->ft->getInstance(mi, ctx(), rslt(), path, properties);
    }

    /// A path as the association's instances have it, without hosts.
    static cim::ObjectPath pathOf(const std::string& system, const std::string& device)
    {
        return {"",
                "root/test",
                association,
                {{"GroupComponent",
                  reference("TAVRO_ComputerSystem",
                            {{"CreationClassName", text("TAVRO_ComputerSystem")}, {"Name", text(system)}})},
                 {"PartComponent",
                  reference("TAVRO_Glimmark", {{"CreationClassName", text("TAVRO_Glimmark")},
                                               {"DeviceID", text(device)},
                                               {"SystemCreationClassName", text("TAVRO_ComputerSystem")},
                                               {"SystemName", text(Tavro::getSystemName())}})}}};
    }
    static cim::Value text(const std::string& value) { return {CMPI_string, false, {value}}; }
    static cim::Value reference(const std::string& className, const std::vector<cim::Key>& keys)
    {
        return {CMPI_ref,
                false,
                {std::make_shared<const cim::ObjectPath>(cim::ObjectPath{"", "root/test", className, keys})}};
    }
    /// The same as a request's path, which the recording calls "ref".
    CMPIObjectPath* refTo(const cim::ObjectPath& path)
    {
        CMPIObjectPath* const handle = request->path(path);
        broker.name(handle, "ref");
        return handle;
    }
    CMPIObjectPath* refTo(const std::string& system, const std::string& device)
    {
        return refTo(pathOf(system, device));
    }

    /// Expects that an operation returned nothing, but done, and a good status without a message.
    void expectEmptyAnswer(const CMPIStatus& status)
    {
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(message(status), std::nullopt);
        EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnDone()"));
    }

    CMPIInstanceMI* mi = GlimmarkSystemDeviceProvider_Create_InstanceMI(host.cmpiBroker(), nullptr, nullptr);
    /// What EnumInstanceNames and the builder begin with.
    const Texts askingForTheSystems =
        joined(readingOfTheNamespace, Texts{R"(newObjectPath("root/test", "TAVRO_ComputerSystem", rc))",
                                            "enumerateInstanceNames(ctx, path1, rc)"});
    /// What they do to the second path, the indicator's, and the third, the association's.
    const Texts makingOfTheAssociationPath =
        joined(settingOfTheNamespace("path2"), makingOfAPath(association, "path3"));
};

// How many computer systems there are.

struct Pairing
{
    std::vector<std::string> systems;
    std::vector<std::string> instances;
    std::vector<std::string> names; ///< of the instances
};

void PrintTo(const Pairing& pairing, std::ostream* stream)
{
    *stream << pairing.systems.size() << " systems";
}

class Pairings : public SystemDeviceInstances, public ::testing::WithParamInterface<Pairing>
{
protected:
    Pairings() { setComputerSystems(GetParam().systems); }
};

INSTANTIATE_TEST_SUITE_P(
    Systems, Pairings,
    ::testing::Values(Pairing{{}, {}, {}},
                      Pairing{{"one"}, {"one a:/1", "one b:/2"}, {"one a:/1", "one b:/2"}},
                      Pairing{{"two", "one"},
                              {"two a:/1", "two b:/2", "one a:/1", "one b:/2"},
                              {"two a:/1", "two b:/2", "one a:/1", "one b:/2", "one a:/1", "one b:/2"}},
                      Pairing{{"x", "z", "y"},
                              {"x a:/1", "x b:/2", "z a:/1", "z b:/2", "y a:/1", "y b:/2"},
                              {"x a:/1", "x b:/2",                     //
                               "z a:/1", "z b:/2", "z a:/1", "z b:/2", //
                               "y a:/1", "y b:/2", "y a:/1", "y b:/2", "y a:/1", "y b:/2"}}),
    [](const auto& test) { return std::to_string(test.param.systems.size()); });

// Nobody who serves the computer systems.

struct Absence
{
    const char* name;
    cimhost::Registration (*registration)();
    CMPIrc code;
};

void PrintTo(const Absence& absence, std::ostream* stream)
{
    *stream << absence.name;
}

class WithoutSystemProvider : public SystemDeviceInstances, public ::testing::WithParamInterface<Absence>
{
protected:
    WithoutSystemProvider() : SystemDeviceInstances(GetParam().registration()) {}
};

INSTANTIATE_TEST_SUITE_P(
    , WithoutSystemProvider,
    ::testing::Values(Absence{"NotRegistered", &SystemDevice::nobody, CMPI_RC_ERR_INVALID_NAMESPACE},
                      Absence{"NotLoadable", &SystemDevice::unloadable, CMPI_RC_ERR_FAILED}),
    [](const auto& test) { return test.param.name; });

} // namespace

// EnumInstanceNames

TEST_P(Pairings, NamesPairEachSystemWithTheDevicesOfAllSystemsSoFar)
{
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(pairsOf(answer(status).paths), ElementsAreArray(GetParam().names));
    EXPECT_EQ(broker.calls().back(), "returnDone()");
    EXPECT_EQ(request->doneCount(), 1);
}

TEST_F(SystemDeviceInstances, NamesAreAssociationPathsInTheRequestsTerms)
{
    MadeInventory::set({{"b", "2"}, {"c", "3"}, {"a", "1"}});
    const CMPIStatus status = enumerateNames();
    const auto paths = answer(status).paths;
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(pairsOf(paths), ElementsAre("alpha a:/1", "alpha b:/2", "alpha c:/3"));
    for (const auto& path : paths) {
        EXPECT_EQ(path.className, "TAVRO_GlimmarkSystemDevice");
        EXPECT_EQ(path.nameSpace, "root/test");
        EXPECT_EQ(path.host, Tavro::getSystemName());
        ASSERT_THAT(path.keys, SizeIs(2));
        EXPECT_EQ(path.keys[0].name, "GroupComponent");
        EXPECT_EQ(path.keys[1].name, "PartComponent");
        const auto device = SystemDevice::referenceAmong(path.keys, "PartComponent");
        EXPECT_EQ(device.className, "TAVRO_Glimmark");
        EXPECT_EQ(device.nameSpace, "root/test");
        EXPECT_EQ(device.host, Tavro::getSystemName());
        const auto system = SystemDevice::referenceAmong(path.keys, "GroupComponent");
        EXPECT_EQ(system.className, "TAVRO_ComputerSystem");
        EXPECT_THAT(system.keys, SizeIs(2)) << "as the broker returned it";
    }
}

TEST_F(SystemDeviceInstances, NamesAreMadeOneAfterTheOtherAndReturnedAtOnce)
{
    MadeInventory::set({{"a", "1"}});
    enumerateNames();
    EXPECT_THAT(timeline(),
                ElementsAreArray(joined(
                    {"ENTERING " + forNames, "ENTERING setVector", "EXITING setVector"}, askingForTheSystems,
                    Texts{"hasNext(enumeration1, null)", "getNext(enumeration1, null)"},
                    makingOfTheDevicePath("path2"), makingOfTheAssociationPath,
                    Texts{"addKey(path3, \"GroupComponent\", path4, ref)",
                          "addKey(path3, \"PartComponent\", path2, ref)", "returnObjectPath(path3)",
                          "hasNext(enumeration1, null)", "EXITING " + forNames, "returnDone()"})));
}

TEST_F(SystemDeviceInstances, NamesAreTraced)
{
    const CMPIObjectPath* const path = ref(association);
    mi->ft->enumerateInstanceNames(mi, ctx(), rslt(), path);
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path);
    EXPECT_THAT(Logged::linesOf(forNames),
                ElementsAre(Logged::line(module, "ENTERING", forNames, parameters),
                            Logged::line(module, "EXITING", forNames, parameters)));
}

TEST_F(SystemDeviceInstances, NamesKeepTheStatusThatTheBrokersCallsLeave)
{
    MadeInventory::set({{"a", "1"}});
    // The last one that gets the status: for the namespace of the association path.
    broker.fail("getNameSpace", 6, Failure::errorStatus);
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnObjectPath(path3)", "returnDone()"));
}

TEST_F(SystemDeviceInstances, NamesDoNotLookAtTheClassOfTheRequest)
{
    const CMPIStatus status = mi->ft->enumerateInstanceNames(mi, ctx(), rslt(), ref("CIM_SystemDevice"));
    EXPECT_THAT(answer(status).paths, SizeIs(2));
}

TEST_F(SystemDeviceInstances, NamesWithoutDevicesEndAtTheFirstSystemWithoutDoneAndExit)
{
    MadeInventory::set({});
    setComputerSystems({"one", "two"});
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls({"getNext", "trace", "returnObjectPath", "returnDone"}),
                ElementsAre("getNext(enumeration1, null)",
                            "trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)"));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + forNames, "ENTERING " + forPaths));
}

TEST_F(SystemDeviceInstances, NamesWithoutDevicesAndSystemsAreNoneAndDone)
{
    MadeInventory::set({});
    setComputerSystems({});
    expectEmptyAnswer(enumerateNames());
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + forNames, "EXITING " + forNames));
    EXPECT_THAT(broker.calls({"trace"}), IsEmpty());
}

TEST_F(SystemDeviceInstances, NamesNeedTheClassPathOfTheSystems)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        clearRecords();
        broker.fail("newObjectPath", 1, failure);
        const CMPIStatus status = enumerateNames();
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), "Create CMPIObjectPath failed.");
        EXPECT_THAT(timeline(),
                    ElementsAre("ENTERING " + forNames, "ENTERING setVector", "EXITING setVector",
                                "getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                                "newObjectPath(\"root/test\", \"TAVRO_ComputerSystem\", rc)",
                                statusText("Create CMPIObjectPath failed."),
                                warning("Create CMPIObjectPath failed for ComputerSystemClass.")));
    }
}

TEST_F(SystemDeviceInstances, NamesEndWithTheStatusOfAFailedEnumeration)
{
    broker.fail("enumerateInstanceNames", 1, Failure::errorStatus);
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_EQ(broker.calls().back(), "enumerateInstanceNames(ctx, path1, rc)");
    EXPECT_THAT(Logged::linesOf(forNames), ElementsAre(StartsWith("3000 "), enumerationFailed));
}

TEST_P(WithoutSystemProvider, NamesEndWithTheBrokersStatus)
{
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, GetParam().code);
    EXPECT_NE(message(status), std::nullopt) << "the broker says why";
    EXPECT_EQ(broker.calls().back(), "enumerateInstanceNames(ctx, path1, rc)");
    EXPECT_THAT(Logged::linesOf(forNames), ElementsAre(StartsWith("3000 "), enumerationFailed));
}

TEST_F(SystemDeviceInstances, NamesOfNoEnumerationAreNone)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        newRequest();
        broker.fail("enumerateInstanceNames", 1, failure);
        expectEmptyAnswer(enumerateNames());
        EXPECT_EQ(Logged::flow().back(), "EXITING " + forNames);
    }
}

TEST_F(SystemDeviceInstances, ASystemIsWhatItsTypeAndItsValueSayWhateverItsState)
{
    setComputerSystems({"one"});
    broker.fail("getNext", 1, Failure::nullState);
    EXPECT_THAT(pairsOf(answer(enumerateNames()).paths), ElementsAre("one a:/1", "one b:/2"));
    newRequest();
    broker.fail("getNext", 1, Failure::nullState);
    EXPECT_THAT(pairsOf(answer(enumerate()).instances), ElementsAre("one a:/1", "one b:/2"));
}

TEST_F(SystemDeviceInstances, NamesSkipASystemThatIsNone)
{
    for (const Failure failure : {Failure::nullResult, Failure::wrongValue}) {
        newRequest();
        setComputerSystems({"two"});
        broker.fail("getNext", 1, failure);
        const CMPIStatus status = enumerateNames();
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_THAT(pairsOf(answer(status).paths), ElementsAre("two a:/1", "two b:/2"))
            << "the item that is none is not taken from the enumeration";
        EXPECT_EQ(broker.calls().back(), "returnDone()");
    }
}

TEST_F(SystemDeviceInstances, NamesEndWhereTheFactoryCannotMakeADevicePath)
{
    setComputerSystems({"one", "two"});
    // The class path, two devices and their associations, and then the first device again.
    broker.fail("newObjectPath", 6, Failure::nullResult);
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "Create CMPIObjectPath failed.");
    EXPECT_THAT(broker.calls(resultServices),
                ElementsAre(StartsWith("returnObjectPath("), StartsWith("returnObjectPath(")));
    EXPECT_THAT(broker.calls({"trace"}), ElementsAre(StartsWith("trace(2, \"GlimmarkProfileProvider\"")));
    EXPECT_THAT(Logged::linesOf(forNames), SizeIs(1));
}

TEST_F(SystemDeviceInstances, NamesEndAtADevicePathWithoutAHandle)
{
    broker.fail("addKey", 8, Failure::lostHandle); // the last one of the second device
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "CMPIObjectPath is NULL for Glimmark");
    EXPECT_THAT(broker.calls({"newString", "trace", "returnObjectPath", "returnDone"}),
                ElementsAre(StartsWith("returnObjectPath("),
                            statusText("CMPIObjectPath is NULL for Glimmark"),
                            warning("CMPIObjectPath is NULL for Glimmark Class")));
    EXPECT_EQ(timeline().back(), warning("CMPIObjectPath is NULL for Glimmark Class"));
    EXPECT_THAT(Logged::linesOf(forNames), SizeIs(1));
}

TEST_F(SystemDeviceInstances, NamesEndAtAnAssociationPathThatCannotBeMade)
{
    const std::string text =
        "Create CMPIObjectPath failed" + twentyOneBlanks + "for GlimmarkSystemDeviceProvider.";
    const std::string traceText =
        "Create CMPIObjectPath failed for" + twentyOneBlanks + "GlimmarkSystemDeviceClass.";
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        clearRecords();
        broker.fail("newObjectPath", 5, failure); // the second association's
        const CMPIStatus status = enumerateNames();
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), text);
        EXPECT_THAT(broker.calls({"newString", "trace", "returnObjectPath", "returnDone"}),
                    ElementsAre(StartsWith("returnObjectPath("), statusText(text), warning(traceText)));
        EXPECT_EQ(timeline().back(), warning(traceText));
        EXPECT_THAT(Logged::linesOf(forNames), SizeIs(1));
    }
}

TEST_F(SystemDeviceInstances, NamesWithoutABrokerFailWithoutAMessage)
{
    mi = GlimmarkSystemDeviceProvider_Create_InstanceMI(nullptr, nullptr, nullptr);
    const CMPIStatus status = enumerateNames();
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls({"newString", "trace", "returnObjectPath", "returnDone"}), IsEmpty());
}

// EnumInstances

TEST_P(Pairings, InstancesPairEachSystemWithEachDeviceOnce)
{
    const CMPIStatus status = enumerate();
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(pairsOf(answer(status).instances), ElementsAreArray(GetParam().instances));
    EXPECT_EQ(request->doneCount(), 1);
}

TEST_F(SystemDeviceInstances, InstancesHaveTwoReferencesInTheRequestsTerms)
{
    const auto instances = answer(enumerate()).instances;
    ASSERT_THAT(instances, SizeIs(2));
    for (const auto& instance : instances) {
        EXPECT_EQ(instance.path.className, "TAVRO_GlimmarkSystemDevice");
        EXPECT_EQ(instance.path.nameSpace, "root/test");
        EXPECT_EQ(instance.path.host, Tavro::getSystemName());
        EXPECT_THAT(namesOf(instance), ElementsAre("GroupComponent", "PartComponent"));
        const auto device = SystemDevice::referenceAmong(instance.properties, "PartComponent");
        EXPECT_EQ(device.className, "TAVRO_Glimmark");
        EXPECT_EQ(device.nameSpace, "root/test");
        EXPECT_EQ(device.host, Tavro::getSystemName());
        const auto system = SystemDevice::referenceAmong(instance.properties, "GroupComponent");
        EXPECT_EQ(system.className, "TAVRO_ComputerSystem");
        EXPECT_THAT(system.keys, SizeIs(2));
    }
}

TEST_F(SystemDeviceInstances, InstancesAreBuiltFirstAndThenReturned)
{
    MadeInventory::set({{"a", "1"}});
    enumerate();
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            {"ENTERING " + forInstances, "ENTERING " + forBuilder, "ENTERING setVector", "EXITING setVector"},
            askingForTheSystems, Texts{"hasNext(enumeration1, null)", "getNext(enumeration1, null)"},
            makingOfTheDevicePath("path2"), makingOfTheAssociationPath,
            Texts{"newInstance(path3, null)",
                  "setPropertyFilter(instance1, null, [GroupComponent PartComponent])",
                  "setProperty(instance1, \"GroupComponent\", path4, ref)",
                  "setProperty(instance1, \"PartComponent\", path2, ref)", "hasNext(enumeration1, null)",
                  "EXITING " + forBuilder, "returnInstance(instance1)", "EXITING " + forInstances,
                  "returnDone()"})));
}

TEST_F(SystemDeviceInstances, InstancesAreFilteredByTheBroker)
{
    MadeInventory::set({{"a", "1"}});
    PropertyNames properties{"GroupComponent", "Name"};
    const auto instances = answer(enumerate(properties)).instances;
    EXPECT_THAT(
        broker.calls({"setPropertyFilter", "setProperty"}),
        ElementsAre("setPropertyFilter(instance1, [GroupComponent Name], [GroupComponent PartComponent])",
                    "setProperty(instance1, \"GroupComponent\", path4, ref)",
                    "setProperty(instance1, \"PartComponent\", path2, ref)"));
    EXPECT_THAT(pairsOf(instances), ElementsAre("alpha a:/1")) << "keys are never left out";
}

TEST_F(SystemDeviceInstances, InstancesAreTraced)
{
    const CMPIObjectPath* const path = ref(association);
    PropertyNames properties{"PartComponent"};
    const char** const list = properties;
    mi->ft->enumerateInstances(mi, ctx(), rslt(), path, list);
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                                               " properties=", list);
    EXPECT_THAT(Logged::linesOf(forInstances),
                ElementsAre(Logged::line(module, "ENTERING", forInstances, parameters),
                            Logged::line(module, "EXITING", forInstances, parameters)));

    // Where its list of instances is, only the builder knows.
    const auto known =
        Logged::parameters(" ref=", path, " properties=", list, " ctx=", ctx(), " instances=0x");
    const auto lines = Logged::linesOf(forBuilder);
    ASSERT_THAT(lines, SizeIs(2));
    EXPECT_THAT(lines[0], StartsWith(Logged::line(module, "ENTERING", forBuilder, known)));
    EXPECT_THAT(lines[1], StartsWith(Logged::line(module, "EXITING", forBuilder, known)));
    EXPECT_EQ(lines[0].substr(lines[0].find(" ref=")), lines[1].substr(lines[1].find(" ref=")));
}

TEST_F(SystemDeviceInstances, InstancesWithoutDevicesAreNoneAndTheBuildFails)
{
    MadeInventory::set({});
    expectEmptyAnswer(enumerate());
    EXPECT_THAT(broker.calls({"trace"}),
                ElementsAre("trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)"));
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + forInstances, "ENTERING " + forBuilder,
                                            "ENTERING " + forPaths, "EXITING " + forInstances));
}

TEST_F(SystemDeviceInstances, InstancesWithoutSystemsAreNoneAndTheBuildIsComplete)
{
    setComputerSystems({});
    expectEmptyAnswer(enumerate());
    EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(2));
    EXPECT_THAT(broker.calls({"trace", "getNext"}), IsEmpty());
}

TEST_F(SystemDeviceInstances, InstancesNeedTheClassPathOfTheSystems)
{
    const std::string traceText =
        "Create CMPIObjectPath failed for" + thirteenBlanks + "ComputerSystemClass.";
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        newRequest();
        broker.fail("newObjectPath", 1, failure);
        expectEmptyAnswer(enumerate());
        EXPECT_THAT(timeline(),
                    ElementsAre("ENTERING " + forInstances, "ENTERING " + forBuilder, "ENTERING setVector",
                                "EXITING setVector", "getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                                "newObjectPath(\"root/test\", \"TAVRO_ComputerSystem\", rc)",
                                statusText("Create CMPIObjectPath" + twelveBlanks + "failed."),
                                warning(traceText), "EXITING " + forInstances, "returnDone()"));
    }
}

TEST_F(SystemDeviceInstances, InstancesOfAFailedEnumerationAreNone)
{
    broker.fail("enumerateInstanceNames", 1, Failure::errorStatus);
    expectEmptyAnswer(enumerate());
    EXPECT_THAT(broker.calls({"newString", "trace", "hasNext"}), IsEmpty());
    EXPECT_THAT(Logged::linesOf(forBuilder), ElementsAre(StartsWith("3000 "), enumerationFailed));
    EXPECT_THAT(Logged::linesOf(forInstances), SizeIs(2));
}

TEST_P(WithoutSystemProvider, InstancesAreNone)
{
    expectEmptyAnswer(enumerate());
    EXPECT_THAT(broker.calls({"newString", "trace", "hasNext"}), IsEmpty());
    EXPECT_THAT(Logged::linesOf(forBuilder), ElementsAre(StartsWith("3000 "), enumerationFailed));
    EXPECT_THAT(Logged::linesOf(forInstances), SizeIs(2));
}

TEST_F(SystemDeviceInstances, InstancesOfNoEnumerationAreNoneAndTheBuildIsComplete)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        newRequest();
        broker.fail("enumerateInstanceNames", 1, failure);
        expectEmptyAnswer(enumerate());
        EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(2));
    }
}

TEST_F(SystemDeviceInstances, InstancesSkipASystemThatIsNone)
{
    for (const Failure failure : {Failure::nullResult, Failure::wrongValue}) {
        newRequest();
        setComputerSystems({"two"});
        broker.fail("getNext", 1, failure);
        const CMPIStatus status = enumerate();
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_THAT(pairsOf(answer(status).instances), ElementsAre("two a:/1", "two b:/2"))
            << "the item that is none is not taken from the enumeration";
        EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(2));
    }
}

TEST_F(SystemDeviceInstances, InstancesAreNoneWhereTheFactoryCannotMakeADevicePath)
{
    setComputerSystems({"one", "two"});
    broker.fail("newObjectPath", 6, Failure::nullResult); // the first device of the second system
    expectEmptyAnswer(enumerate());
    EXPECT_THAT(broker.calls({"newInstance"}), SizeIs(2)) << "built and not returned";
    EXPECT_THAT(broker.calls({"trace"}), ElementsAre(StartsWith("trace(2, \"GlimmarkProfileProvider\"")));
    EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(1));
    EXPECT_THAT(Logged::linesOf(forInstances), SizeIs(2));
}

TEST_F(SystemDeviceInstances, InstancesAreNoneAtADevicePathWithoutAHandle)
{
    const std::string text = "CMPIObjectPath is NULL for Glimmark Provider";
    broker.fail("addKey", 8, Failure::lostHandle); // the last one of the second device
    expectEmptyAnswer(enumerate());
    EXPECT_THAT(broker.calls({"newInstance", "newString", "trace"}),
                ElementsAre("newInstance(path4, null)", statusText(text), warning(text)));
    EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(1));
    EXPECT_THAT(Logged::linesOf(forInstances), SizeIs(2));
}

TEST_F(SystemDeviceInstances, AnAssociationPathThatCannotBeMadeIsReportedAndLeavesANullInstance)
{
    const std::string traceText = "Create CMPIObjectPath failed for" + twentyOneBlanks + "HostedAccessPoint.";
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        newRequest();
        broker.fail("newObjectPath", 4, failure); // the first association's
        const CMPIStatus status = enumerate();
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(message(status), std::nullopt);
        EXPECT_THAT(broker.calls({"newString", "trace"}),
                    ElementsAre(statusText("Create CMPIObjectPath failed for HostedAccessPoint"),
                                warning(traceText)));
        EXPECT_THAT(broker.calls(resultServices),
                    ElementsAre("returnInstance(null)", "returnInstance(instance1)", "returnDone()"));
        EXPECT_THAT(pairsOf(answer(status).instances), ElementsAre("alpha b:/2"));
        EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(2)) << "it carries on";
    }
}

TEST_F(SystemDeviceInstances, AnAssociationPathWithoutAHandleIsUsedAllTheSame)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("newObjectPath", 3, Failure::noHandle);
    enumerate();
    EXPECT_THAT(broker.calls({"setNameSpace", "setHostname", "newInstance", "setPropertyFilter"}),
                ElementsAre("setNameSpace(path2, \"root/test\")", "setHostname(path2, " + quotedHost + ")",
                            "setNameSpace(path2, \"root/test\")", "setNameSpace(path3, \"root/test\")",
                            "setHostname(path3, " + quotedHost + ")", "newInstance(path3, null)"));
}

TEST_F(SystemDeviceInstances, AnInstanceThatCouldNotBeMadeIsHandedOn)
{
    broker.fail("newInstance", 1, Failure::nullResult);
    const CMPIStatus status = enumerate();
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices),
                ElementsAre("returnInstance(null)", "returnInstance(instance1)", "returnDone()"));
    EXPECT_THAT(broker.calls({"newString", "trace"}), IsEmpty());
}

TEST_F(SystemDeviceInstances, AnInstanceWithoutAHandleIsHandedOnAsItIs)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("newInstance", 1, Failure::noHandle);
    enumerate();
    EXPECT_THAT(broker.calls({"setPropertyFilter", "setProperty", "returnInstance"}),
                ElementsAre("returnInstance(instance1)"));
}

TEST_F(SystemDeviceInstances, InstancesNeverAnswerTheBuildersStatus)
{
    broker.fail("getNameSpace", 1, Failure::errorStatus);
    broker.fail("getNameSpace", 2, Failure::errorStatus);
    const CMPIStatus status = enumerate();
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
}

TEST_F(SystemDeviceInstances, InstancesWithoutABrokerAreNone)
{
    mi = GlimmarkSystemDeviceProvider_Create_InstanceMI(nullptr, nullptr, nullptr);
    expectEmptyAnswer(enumerate());
    EXPECT_THAT(broker.calls({"newString", "trace"}), IsEmpty());
}

// GetInstance

TEST_F(SystemDeviceInstances, GetNeedsAKey)
{
    const CMPIStatus status = get(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), noKeys);
    EXPECT_THAT(timeline(), ElementsAre("ENTERING " + forOne, "getKeyCount(ref, rc)", statusText(noKeys),
                                        warning(noKeys), "returnDone()", "EXITING " + forOne));
}

TEST_F(SystemDeviceInstances, GetAnswersTheInstanceOfThePath)
{
    setComputerSystems({"one", "two"});
    for (const char* system : {"one", "two"}) {
        for (const char* device : {"a:/1", "b:/2"}) {
            newRequest();
            const CMPIStatus status = get(refTo(system, device));
            EXPECT_EQ(status.rc, CMPI_RC_OK);
            EXPECT_EQ(message(status), std::nullopt);
            EXPECT_THAT(pairsOf(answer(status).instances), ElementsAre(std::string(system) + " " + device));
            EXPECT_EQ(request->doneCount(), 1);
        }
    }
}

TEST_F(SystemDeviceInstances, GetAnswersThePathsThatTheEnumerationReturned)
{
    const auto paths = answer(enumerateNames()).paths;
    ASSERT_THAT(paths, SizeIs(2));
    for (const auto& path : paths) {
        newRequest();
        const CMPIStatus status = get(refTo(path));
        EXPECT_THAT(pairsOf(answer(status).instances), ElementsAre(SystemDevice::pairAmong(path.keys)));
    }
}

TEST_F(SystemDeviceInstances, GetBuildsAllInstancesAndStopsAtTheFirstMatch)
{
    setComputerSystems({"one", "two"});
    get(refTo("one", "b:/2"));
    EXPECT_THAT(broker.calls({"newInstance"}), SizeIs(4));
    EXPECT_THAT(broker.calls({"getObjectPath", "returnInstance", "returnDone"}),
                ElementsAre("getObjectPath(instance1, rc)", "getObjectPath(instance2, rc)",
                            "returnInstance(instance2)", "returnDone()"));
    EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(2));
    const auto events = timeline();
    EXPECT_THAT(std::vector<std::string>(events.end() - 2, events.end()),
                ElementsAre("returnDone()", "EXITING " + forOne));
}

TEST_F(SystemDeviceInstances, GetCountsTheKeysAndThenBuilds)
{
    MadeInventory::set({{"a", "1"}});
    get(refTo("alpha", "a:/1"));
    const auto events = timeline();
    ASSERT_GE(events.size(), 6U);
    EXPECT_THAT(std::vector<std::string>(events.begin(), events.begin() + 6),
                ElementsAre("ENTERING " + forOne, "getKeyCount(ref, rc)", "ENTERING " + forBuilder,
                            "ENTERING setVector", "EXITING setVector", "getNameSpace(ref, rc)"));
}

TEST_F(SystemDeviceInstances, GetIsTraced)
{
    const CMPIObjectPath* const path = refTo("alpha", "a:/1");
    PropertyNames properties{"GroupComponent"};
    const char** const list = properties;
    get(path, list);
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " cop=", path,
                                               " properties=", list);
    EXPECT_THAT(Logged::linesOf(forOne), ElementsAre(Logged::line(module, "ENTERING", forOne, parameters),
                                                     Logged::line(module, "EXITING", forOne, parameters)));
    EXPECT_THAT(Logged::linesOf(forBuilder),
                Each(HasSubstr(Logged::parameters(" ref=", path, " properties=", list, " ctx=", ctx(),
                                                  " instances=0x"))));
}

TEST_F(SystemDeviceInstances, GetTakesThePropertyList)
{
    PropertyNames properties{"PartComponent"};
    get(refTo("alpha", "a:/1"), properties);
    EXPECT_THAT(broker.calls({"setPropertyFilter"}),
                Each(EndsWith(", [PartComponent], [GroupComponent PartComponent])")));
}

TEST_F(SystemDeviceInstances, GetOfAnUnknownPathAnswersNothing)
{
    cim::ObjectPath otherClass = pathOf("alpha", "a:/1");
    otherClass.className = "CIM_SystemDevice";
    cim::ObjectPath oneKey = pathOf("alpha", "a:/1");
    oneKey.keys.pop_back();
    const cim::ObjectPath otherKeys{"", "root/test", association, {{"Anything", text("else")}}};
    for (const auto& path :
         {pathOf("alpha", "c:/3"), pathOf("beta", "a:/1"), otherClass, oneKey, otherKeys}) {
        newRequest();
        expectEmptyAnswer(get(refTo(path)));
        EXPECT_THAT(broker.calls({"newInstance"}), SizeIs(2)) << "class and keys are not looked at before";
        EXPECT_THAT(Logged::linesOf(forOne), SizeIs(2));
    }
}

TEST_F(SystemDeviceInstances, GetComparesReferencesAsPathsAndNotAsText)
{
    setComputerSystems({"7"});
    cim::ObjectPath path = pathOf("7", "a:/1");
    path.keys[0].value =
        reference("TAVRO_ComputerSystem", {{"CreationClassName", text("TAVRO_ComputerSystem")},
                                           {"Name", cim::Value{CMPI_uint16, false, {std::uint64_t{7}}}}});
    expectEmptyAnswer(get(refTo(path)));
}

TEST_F(SystemDeviceInstances, GetSkipsInstancesThatCouldNotBeMade)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        newRequest();
        broker.fail("newInstance", 1, failure);
        const CMPIStatus status = get(refTo("alpha", "b:/2"));
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_THAT(pairsOf(answer(status).instances), ElementsAre("alpha b:/2"));
        EXPECT_THAT(broker.calls({"getObjectPath"}), ElementsAre("getObjectPath(instance1, rc)"));
    }
}

TEST_F(SystemDeviceInstances, GetKeepsTheStatusThatReadingAPathLeaves)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("getObjectPath", 1, Failure::errorStatus);
    const CMPIStatus status = get(refTo("alpha", "a:/1"));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnDone()"));
}

TEST_F(SystemDeviceInstances, GetOfAFailedBuildAnswersNothing)
{
    broker.fail("newObjectPath", 1, Failure::errorStatus);
    expectEmptyAnswer(get(refTo("alpha", "a:/1")));
    EXPECT_THAT(Logged::linesOf(forBuilder), SizeIs(1));
    EXPECT_EQ(timeline().back(), "EXITING " + forOne);
}

TEST_F(SystemDeviceInstances, GetOfAFailedEnumerationAnswersNothing)
{
    broker.fail("enumerateInstanceNames", 1, Failure::errorStatus);
    expectEmptyAnswer(get(refTo("alpha", "a:/1")));
    EXPECT_THAT(Logged::linesOf(forBuilder), ElementsAre(StartsWith("3000 "), enumerationFailed));
    EXPECT_EQ(timeline().back(), "EXITING " + forOne);
}

TEST_P(WithoutSystemProvider, GetAnswersNothing)
{
    expectEmptyAnswer(get(refTo("alpha", "a:/1")));
    EXPECT_THAT(Logged::linesOf(forBuilder), ElementsAre(StartsWith("3000 "), enumerationFailed));
    EXPECT_EQ(timeline().back(), "EXITING " + forOne);
}

TEST_F(SystemDeviceInstances, GetWithoutSystemsOrDevicesAnswersNothing)
{
    setComputerSystems({});
    expectEmptyAnswer(get(refTo("alpha", "a:/1")));

    newRequest();
    setComputerSystems({"alpha"});
    MadeInventory::set({});
    expectEmptyAnswer(get(refTo("alpha", "a:/1")));
    EXPECT_EQ(timeline().back(), "EXITING " + forOne);
}

} // namespace SystemDeviceInstancesTests
