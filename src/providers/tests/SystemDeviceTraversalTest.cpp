// The traversal of TAVRO_GlimmarkSystemDevice, driven through the provider's function table.

#include "testing/SystemDeviceFixture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace SystemDeviceTraversalTests {

using ::testing::Contains;
using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::ElementsAreArray;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::SizeIs;
using ::testing::StartsWith;

using SystemDevice::association;
using SystemDevice::enumerationFailed;
using SystemDevice::joined;
using SystemDevice::module;
using SystemDevice::statusText;
using SystemDevice::Texts;
using SystemDevice::warning;

namespace {

constexpr auto capabilities = "TAVRO_GlimmarkElementCapabilities";
const std::string systemClass = "TAVRO_ComputerSystem";
const std::string deviceClass = "TAVRO_Glimmark";
const std::string forTargetPath = "get_assoc_targetClass_ObjectPath";
const std::string forTargetName = "get_assoc_targetClass_Name";
const std::string forDevices = "getAllGlimmarkCMPIInstances";

/// A client's arguments besides the path. Where an operation has no such argument, it is left out.
struct Asked
{
    const char* assocClass = association;
    const char* resultClass = nullptr;
    const char* role = nullptr;
    const char* resultRole = nullptr;
    const char** properties = nullptr;
};

class SystemDeviceTraversal : public SystemDevice::Fixture
{
public:
    using Fixture::Fixture;

    CMPIStatus associators(const CMPIObjectPath* path, const Asked& asked = {})
    {
        return mi->ft->associators(mi, ctx(), rslt(), path, asked.assocClass, asked.resultClass, asked.role,
                                   asked.resultRole, asked.properties);
    }
    CMPIStatus associatorNames(const CMPIObjectPath* path, const Asked& asked = {})
    {
        return mi->ft->associatorNames(mi, ctx(), rslt(), path, asked.assocClass, asked.resultClass,
                                       asked.role, asked.resultRole);
    }
    CMPIStatus references(const CMPIObjectPath* path, const Asked& asked = {})
    {
        return mi->ft->references(mi, ctx(), rslt(), path, asked.resultClass, asked.role, asked.properties);
    }
    CMPIStatus referenceNames(const CMPIObjectPath* path, const Asked& asked = {})
    {
        return mi->ft->referenceNames(mi, ctx(), rslt(), path, asked.resultClass, asked.role);
    }

protected:
    CMPIObjectPath* refToSystem()
    {
        return ref(systemClass, {{"CreationClassName", systemClass}, {"Name", "alpha"}});
    }
    CMPIObjectPath* refToDevice() { return ref(deviceClass, {{"DeviceID", "a:/1"}}); }

    /// Calls and lines of the way to the target path, which is path1, after the operation's own entry.
    Texts findingTheTarget(const std::string& from, const std::string& to) const
    {
        // The way from a system is tested first, that from a device second.
        const std::size_t ways = from == systemClass ? 1 : 2;
        const std::string target = to == deviceClass ? "GlimmarkClass" : "ComputerSystemClass";
        return joined(Texts{"ENTERING setVector", "EXITING setVector"},
                      findingOfTheTarget(from, ways, to,
                                         R"(trace(1, "GlimmarkSystemDeviceProvider", "Target Class is )" +
                                             target + R"(", null))"));
    }
    static Texts readingTheTargetsClass(const std::string& to) { return readingOfTheClass("path1", to); }
    Texts makingOfTheAssociationPath() const { return makingOfAPath(association, "path2"); }
    /// Gives a path the namespace of the request and returns it.
    Texts returning(const std::string& path) const
    {
        return joined(settingOfTheNamespace(path), Texts{"returnObjectPath(" + path + ")"});
    }

    CMPIAssociationMI* mi =
        GlimmarkSystemDeviceProvider_Create_AssociationMI(host.cmpiBroker(), nullptr, nullptr);
};

// What is the same for several operations.

using Operation = CMPIStatus (SystemDeviceTraversal::*)(const CMPIObjectPath*, const Asked&);

struct Named
{
    const char* name;
    Operation operation;
};

void PrintTo(const Named& named, std::ostream* stream)
{
    *stream << named.name;
}

const Named associators{"Associators", &SystemDeviceTraversal::associators};
const Named associatorNames{"AssociatorNames", &SystemDeviceTraversal::associatorNames};
const Named references{"References", &SystemDeviceTraversal::references};
const Named referenceNames{"ReferenceNames", &SystemDeviceTraversal::referenceNames};

class OneOperation : public SystemDeviceTraversal, public ::testing::WithParamInterface<Named>
{
protected:
    using SystemDeviceTraversal::SystemDeviceTraversal;

    CMPIStatus traverse(const CMPIObjectPath* path, const Asked& asked = {})
    {
        return (this->*GetParam().operation)(path, asked);
    }
    const std::string function = std::string("GlimmarkSystemDevice_") + GetParam().name;

    /// Number of paths or instances that an operation answered.
    std::size_t answered(const CMPIStatus& status) const
    {
        const auto returned = answer(status);
        return returned.paths.size() + returned.instances.size();
    }
    void expectNothing(const CMPIStatus& status)
    {
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(message(status), std::nullopt);
        EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    }
};

class AllTraversals : public OneOperation
{};
class AssociatorOperations : public OneOperation
{};
class ReferenceOperations : public OneOperation
{
protected:
    const std::string noTarget = std::string("Object Path is NULL in ") + GetParam().name + ".";
};
/// Those that ask the broker for the names of the systems.
class NameEnumeratingOperations : public OneOperation
{};
/// Those that need the paths of the devices.
class PathCollectingOperations : public OneOperation
{};

const auto nameOfOperation = [](const auto& test) { return std::string(test.param.name); };

INSTANTIATE_TEST_SUITE_P(, AllTraversals,
                         ::testing::Values(associators, associatorNames, references, referenceNames),
                         nameOfOperation);
INSTANTIATE_TEST_SUITE_P(, AssociatorOperations, ::testing::Values(associators, associatorNames),
                         nameOfOperation);
INSTANTIATE_TEST_SUITE_P(, ReferenceOperations, ::testing::Values(references, referenceNames),
                         nameOfOperation);
INSTANTIATE_TEST_SUITE_P(, NameEnumeratingOperations,
                         ::testing::Values(associatorNames, references, referenceNames), nameOfOperation);
INSTANTIATE_TEST_SUITE_P(, PathCollectingOperations,
                         ::testing::Values(associatorNames, references, referenceNames), nameOfOperation);

/// Operations on a broker without a provider for the systems.
template <cimhost::Registration (*registration)()>
class OperationsWithout : public OneOperation
{
protected:
    OperationsWithout() : OneOperation(registration()) {}
};
class WithoutRegistration : public OperationsWithout<&SystemDevice::nobody>
{};
class WithoutLibrary : public OperationsWithout<&SystemDevice::unloadable>
{};

INSTANTIATE_TEST_SUITE_P(, WithoutRegistration,
                         ::testing::Values(associators, associatorNames, references, referenceNames),
                         nameOfOperation);
INSTANTIATE_TEST_SUITE_P(, WithoutLibrary,
                         ::testing::Values(associators, associatorNames, references, referenceNames),
                         nameOfOperation);

// Result classes of the associator operations.

struct ResultClass
{
    const char* name;
    const std::string& from;
    const char* resultClass;
    bool isWanted;
};

void PrintTo(const ResultClass& resultClass, std::ostream* stream)
{
    *stream << resultClass.name;
}

class ResultClasses : public SystemDeviceTraversal, public ::testing::WithParamInterface<ResultClass>
{
protected:
    /// Expects the far end, or an empty answer that ends before anything is asked for.
    void expectWhatIsWanted(const std::string& function, const CMPIStatus& status, std::size_t answered)
    {
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(message(status), std::nullopt);
        if (GetParam().isWanted) {
            EXPECT_EQ(answered, 2U);
            EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
        } else {
            EXPECT_EQ(answered, 0U);
            EXPECT_THAT(Logged::linesOf(function), SizeIs(1));
            EXPECT_THAT(broker.calls({"enumerateInstances", "enumerateInstanceNames", "newInstance", "addKey",
                                      "returnDone"}),
                        IsEmpty());
        }
    }
    static Asked asked()
    {
        Asked arguments;
        arguments.resultClass = GetParam().resultClass;
        return arguments;
    }
};

INSTANTIATE_TEST_SUITE_P(
    , ResultClasses,
    ::testing::Values(ResultClass{"DevicesOfAnyClass", systemClass, nullptr, true},
                      ResultClass{"Devices", systemClass, "TAVRO_Glimmark", true},
                      ResultClass{"DevicesInSmallLetters", systemClass, "tavro_glimmark", true},
                      ResultClass{"DevicesByTheirBase", systemClass, "CIM_AlarmDevice", true},
                      ResultClass{"DevicesByTheirBaseInSmallLetters", systemClass, "cim_alarmdevice", true},
                      ResultClass{"DevicesByABaseFurtherUp", systemClass, "CIM_LogicalDevice", false},
                      ResultClass{"DevicesAsSystems", systemClass, "TAVRO_ComputerSystem", false},
                      ResultClass{"DevicesAsSystemsByTheirBase", systemClass, "CIM_ComputerSystem", false},
                      ResultClass{"DevicesOfTheEmptyClass", systemClass, "", false},
                      ResultClass{"DevicesOfALongerClass", systemClass, "TAVRO_GlimmarkX", false},
                      ResultClass{"SystemsOfAnyClass", deviceClass, nullptr, true},
                      ResultClass{"Systems", deviceClass, "TAVRO_ComputerSystem", true},
                      ResultClass{"SystemsInCapitals", deviceClass, "TAVRO_COMPUTERSYSTEM", true},
                      ResultClass{"SystemsByTheirBase", deviceClass, "CIM_ComputerSystem", true},
                      ResultClass{"SystemsByTheirBaseInSmallLetters", deviceClass, "cim_computersystem",
                                  true},
                      ResultClass{"SystemsByABaseFurtherUp", deviceClass, "CIM_System", false},
                      ResultClass{"SystemsAsDevices", deviceClass, "TAVRO_Glimmark", false},
                      ResultClass{"SystemsAsDevicesByTheirBase", deviceClass, "CIM_AlarmDevice", false},
                      ResultClass{"SystemsOfTheEmptyClass", deviceClass, "", false}),
    [](const auto& test) { return test.param.name; });

// How many computer systems there are.

class SystemCounts : public SystemDeviceTraversal, public ::testing::WithParamInterface<Texts>
{
protected:
    SystemCounts() { setComputerSystems(GetParam()); }
};

INSTANTIATE_TEST_SUITE_P(Systems, SystemCounts,
                         ::testing::Values(Texts{}, Texts{"one"}, Texts{"two", "one"}, Texts{"x", "z", "y"}),
                         [](const auto& test) { return std::to_string(test.param.size()); });

} // namespace

// AssociatorNames

TEST_F(SystemDeviceTraversal, NamesFromASystemAreThePathsOfTheDevices)
{
    const CMPIStatus status = associatorNames(refToSystem());
    const auto paths = answer(status).paths;
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(valuesOf(paths, "DeviceID"), ElementsAre("a:/1", "b:/2"));
    for (const auto& path : paths) {
        EXPECT_EQ(path.className, deviceClass);
        EXPECT_EQ(path.nameSpace, "root/test");
    }
    EXPECT_THAT(broker.calls({"enumerateInstanceNames"}), IsEmpty());
}

TEST_F(SystemDeviceTraversal, NamesFromASystemAreMadeBeforeTheFirstIsReturned)
{
    MadeInventory::set({{"a", "1"}});
    associatorNames(refToSystem());
    const std::string function = "GlimmarkSystemDevice_AssociatorNames";
    EXPECT_THAT(timeline(),
                ElementsAreArray(joined({"ENTERING " + function}, findingTheTarget(systemClass, deviceClass),
                                        readingTheTargetsClass(deviceClass), makingOfTheDevicePath("path2"),
                                        returning("path2"), Texts{"EXITING " + function})));
}

TEST_P(SystemCounts, NamesFromADeviceAreThePathsOfAllSystems)
{
    const CMPIStatus status = associatorNames(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(valuesOf(answer(status).paths, "Name"), ElementsAreArray(GetParam()));
    EXPECT_THAT(Logged::linesOf("GlimmarkSystemDevice_AssociatorNames"), SizeIs(2));
}

TEST_F(SystemDeviceTraversal, NamesFromADeviceAreReturnedAsTheBrokerGaveThem)
{
    associatorNames(refToDevice());
    const std::string function = "GlimmarkSystemDevice_AssociatorNames";
    Texts expected = joined({"ENTERING " + function}, findingTheTarget(deviceClass, systemClass),
                            readingTheTargetsClass(systemClass),
                            Texts{"enumerateInstanceNames(ctx, path1, rc)", "hasNext(enumeration1, null)",
                                  "getNext(enumeration1, null)", "returnObjectPath(path2)",
                                  "hasNext(enumeration1, null)", "EXITING " + function});
    Texts events = timeline();
    // The inventory's two nodes make no difference here.
    EXPECT_THAT(events, ElementsAreArray(expected));
}

TEST_F(SystemDeviceTraversal, NamesFromADeviceDoNotDependOnWhichDeviceItIs)
{
    const CMPIStatus status = associatorNames(ref(deviceClass, {{"DeviceID", "no such device"}}));
    EXPECT_THAT(valuesOf(answer(status).paths, "Name"), ElementsAre("alpha"));
}

TEST_F(SystemDeviceTraversal, NamesFromASystemDoNotDependOnWhichSystemItIs)
{
    const CMPIStatus status = associatorNames(ref(systemClass, {{"Name", "no such system"}}));
    EXPECT_THAT(answer(status).paths, SizeIs(2));
}

TEST_P(ResultClasses, SelectNames)
{
    setComputerSystems({"one", "two"});
    const CMPIStatus status = associatorNames(ref(GetParam().from), asked());
    expectWhatIsWanted("GlimmarkSystemDevice_AssociatorNames", status, answer(status).paths.size());
}

TEST_F(SystemDeviceTraversal, NamesAreTraced)
{
    const CMPIObjectPath* const path = refToDevice();
    const Asked asked{association, systemClass.c_str(), "PartComponent", "GroupComponent"};
    associatorNames(path, asked);
    const std::string function = "GlimmarkSystemDevice_AssociatorNames";
    const auto parameters = Logged::parameters(
        " mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path, " _RefLeftClass=", asked.assocClass,
        " _RefRightClass=", asked.resultClass, " role=", asked.role, " resultRole=", asked.resultRole);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
}

TEST_F(SystemDeviceTraversal, NamesFromASystemHandOnAPathThatLostItsHandle)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("addKey", 4, Failure::lostHandle);
    associatorNames(refToSystem());
    EXPECT_THAT(broker.calls({"returnObjectPath"}), ElementsAre("returnObjectPath(path2)"));
    EXPECT_THAT(Logged::linesOf("GlimmarkSystemDevice_AssociatorNames"), SizeIs(2));
}

TEST_F(SystemDeviceTraversal, NamesKeepTheStatusThatTheBrokersCallsLeave)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("getNameSpace", 5, Failure::errorStatus); // for the path that is returned
    const CMPIStatus status = associatorNames(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls({"returnObjectPath"}), ElementsAre("returnObjectPath(path2)"));
    EXPECT_THAT(Logged::linesOf("GlimmarkSystemDevice_AssociatorNames"), SizeIs(2));
}

// Associators

TEST_F(SystemDeviceTraversal, AssociatorsOfASystemAreTheDevices)
{
    const CMPIStatus status = associators(refToSystem());
    const auto instances = answer(status).instances;
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(valuesOf(instances, "DeviceID"), ElementsAre("a:/1", "b:/2"));
    EXPECT_THAT(instances.at(0).properties, SizeIs(15)) << "not the keys alone";
    EXPECT_THAT(broker.calls({"enumerateInstances"}), IsEmpty());
}

TEST_F(SystemDeviceTraversal, AssociatorsOfASystemGetThePropertyList)
{
    PropertyNames properties{"AlarmState"};
    Asked asked;
    asked.properties = properties;
    const auto instances = answer(associators(refToSystem(), asked)).instances;
    ASSERT_THAT(instances, SizeIs(2));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("CreationClassName", "DeviceID", "SystemCreationClassName",
                                                   "SystemName", "AlarmState"));
}

TEST_F(SystemDeviceTraversal, AssociatorsOfASystemAreMadeBeforeTheFirstIsReturned)
{
    const CMPIObjectPath* const path = refToSystem();
    associators(path);
    EXPECT_THAT(Logged::flow(),
                ElementsAre("ENTERING GlimmarkSystemDevice_Associators", "ENTERING setVector",
                            "EXITING setVector", "ENTERING " + forTargetPath, "ENTERING " + forTargetName,
                            "EXITING " + forTargetName, "EXITING " + forTargetPath, "ENTERING " + forDevices,
                            "ENTERING makeGlimmarkInstance", "EXITING makeGlimmarkInstance",
                            "ENTERING makeGlimmarkInstance", "EXITING makeGlimmarkInstance",
                            "EXITING " + forDevices, "EXITING GlimmarkSystemDevice_Associators"));
    const Texts events = timeline();
    EXPECT_THAT(Texts(events.end() - 4, events.end()),
                ElementsAre("EXITING " + forDevices, "returnInstance(instance1)", "returnInstance(instance2)",
                            "EXITING GlimmarkSystemDevice_Associators"));
    EXPECT_THAT(
        Logged::linesOf(forDevices),
        Each(::testing::HasSubstr(Logged::parameters(
            " ref=", path, " properties=", static_cast<const char**>(nullptr), " isObjPath=", false))));
}

TEST_P(SystemCounts, AssociatorsOfADeviceAreAllSystems)
{
    const CMPIStatus status = associators(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(valuesOf(answer(status).instances, "Name"), ElementsAreArray(GetParam()));
    EXPECT_THAT(Logged::linesOf("GlimmarkSystemDevice_Associators"), SizeIs(2));
}

TEST_F(SystemDeviceTraversal, AssociatorsOfADeviceAreAskedForWithoutThePropertyList)
{
    PropertyNames properties{"Name"};
    Asked asked;
    asked.properties = properties;
    const auto instances = answer(associators(refToDevice(), asked)).instances;
    const std::string function = "GlimmarkSystemDevice_Associators";
    EXPECT_THAT(timeline(),
                ElementsAreArray(
                    joined({"ENTERING " + function}, findingTheTarget(deviceClass, systemClass),
                           readingTheTargetsClass(systemClass),
                           Texts{"enumerateInstances(ctx, path1, null, rc)", "hasNext(enumeration1, null)",
                                 "getNext(enumeration1, null)", "returnInstance(instance1)",
                                 "hasNext(enumeration1, null)", "EXITING " + function})));
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(instances[0]), Contains("ElementName"));
}

TEST_P(ResultClasses, SelectAssociators)
{
    setComputerSystems({"one", "two"});
    const CMPIStatus status = associators(ref(GetParam().from), asked());
    expectWhatIsWanted("GlimmarkSystemDevice_Associators", status, answer(status).instances.size());
}

TEST_F(SystemDeviceTraversal, AssociatorsAreTraced)
{
    const CMPIObjectPath* const path = refToDevice();
    PropertyNames properties{"Name"};
    const Asked asked{association, systemClass.c_str(), "PartComponent", "GroupComponent", properties};
    associators(path, asked);
    const std::string function = "GlimmarkSystemDevice_Associators";
    const auto parameters = Logged::parameters(
        " mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path, " _RefLeftClass=", asked.assocClass,
        " _RefRightClass=", asked.resultClass, " role=", asked.role, " resultRole=", asked.resultRole,
        " properties=", asked.properties);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
}

TEST_F(SystemDeviceTraversal, AssociatorsOfADeviceDoNotCheckTheStatus)
{
    broker.fail("enumerateInstances", 1, Failure::errorStatus);
    const CMPIStatus status = associators(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    EXPECT_THAT(Logged::linesOf("GlimmarkSystemDevice_Associators"),
                ElementsAre(StartsWith("3000 "), StartsWith("3000 ")))
        << "an exit, and no message";
}

TEST_F(SystemDeviceTraversal, AssociatorsOfNoEnumerationAreNone)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        newRequest();
        broker.fail("enumerateInstances", 1, failure);
        const CMPIStatus status = associators(refToDevice());
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_THAT(broker.calls(resultServices), IsEmpty());
        EXPECT_THAT(Logged::linesOf("GlimmarkSystemDevice_Associators"), SizeIs(2));
    }
}

TEST_F(SystemDeviceTraversal, AssociatorsWithoutDevicesAreNone)
{
    MadeInventory::set({});
    const CMPIStatus status = associators(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    EXPECT_THAT(Logged::linesOf("GlimmarkSystemDevice_Associators"), SizeIs(2));
}

TEST_F(SystemDeviceTraversal, AssociatorsSkipADeviceThatCouldNotBeMade)
{
    broker.fail("newInstance", 1, Failure::nullResult);
    const CMPIStatus status = associators(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(instance1)"));
    EXPECT_THAT(valuesOf(answer(status).instances, "DeviceID"), ElementsAre("b:/2"));
    EXPECT_THAT(broker.calls({"newString"}), IsEmpty());
}

TEST_F(SystemDeviceTraversal, AssociatorsHandOnADeviceWithoutAHandle)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("newInstance", 1, Failure::noHandle);
    associators(refToSystem());
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(instance1)"));
}

// Both associator operations

TEST_P(AssociatorOperations, AnswerNothingWhereNothingIsAssociated)
{
    struct Start
    {
        std::string className;
        const char* assocClass;
    };
    for (const Start& start :
         {Start{"CIM_AlarmDevice", association}, Start{"tavro_glimmark", association},
          Start{"TAVRO_GlimmarkCapabilities", association}, Start{systemClass, capabilities},
          Start{systemClass, "CIM_SystemDevice"}, Start{deviceClass, "tavro_glimmarksystemdevice"}}) {
        newRequest();
        Asked asked;
        asked.assocClass = start.assocClass;
        expectNothing(traverse(ref(start.className), asked));
        EXPECT_THAT(Logged::linesOf(function), SizeIs(1)) << start.className << ' ' << start.assocClass;
        EXPECT_THAT(broker.calls({"newString", "trace"}), IsEmpty());
    }
}

TEST_P(AssociatorOperations, AnswerAGoodStatusWhereTheSourceClassCannotBeRead)
{
    for (int reading = 1; reading <= 4; ++reading)
        broker.fail("getClassName", reading, Failure::errorStatus);
    expectNothing(traverse(refToDevice()));
    EXPECT_THAT(Logged::linesOf(function), SizeIs(1));
}

TEST_P(AssociatorOperations, AnswerAGoodStatusWhereTheTargetPathCannotBeMade)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        newRequest();
        broker.fail("newObjectPath", 1, failure);
        expectNothing(traverse(refToDevice()));
        EXPECT_THAT(Logged::linesOf(function), SizeIs(1));
        EXPECT_THAT(broker.calls({"newString"}), IsEmpty());
    }
}

TEST_P(AssociatorOperations, GoToTheEndForATargetThatTheyDoNotServe)
{
    Asked asked;
    asked.assocClass = capabilities;
    for (const char* resultClass : {static_cast<const char*>(nullptr), "TAVRO_GlimmarkCapabilities", "Any"}) {
        newRequest();
        asked.resultClass = resultClass;
        expectNothing(traverse(refToDevice(), asked));
        EXPECT_THAT(Logged::linesOf(function), SizeIs(2)) << "with an exit";
    }
}

TEST_P(AssociatorOperations, LeadFromTheCapabilitiesToTheDevicesByTheirAssociation)
{
    Asked asked;
    asked.assocClass = capabilities;
    const CMPIStatus status = traverse(ref("TAVRO_GlimmarkCapabilities"), asked);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(answered(status), 2U);
}

TEST_P(AssociatorOperations, GoToTheEndWhereTheTargetsClassCannotBeRead)
{
    broker.fail("getClassName", 2, Failure::errorStatus);
    const CMPIStatus status = traverse(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected") << "the working status is handed on";
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
}

TEST_P(AssociatorOperations, TakeASystemForWhatItsTypeAndItsValueSayWhateverItsState)
{
    broker.fail("getNext", 1, Failure::nullState);
    const CMPIStatus status = traverse(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(answered(status), 1U);
}

TEST_P(AssociatorOperations, SkipASystemThatIsNone)
{
    for (const Failure failure : {Failure::nullResult, Failure::wrongValue}) {
        newRequest();
        broker.fail("getNext", 1, failure);
        const CMPIStatus status = traverse(refToDevice());
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(answered(status), 1U) << "the item that is none is not taken from the enumeration";
        EXPECT_THAT(broker.calls({"getNext"}), SizeIs(2));
        EXPECT_THAT(broker.calls(resultServices), Each(Not(HasSubstr("null"))));
    }
}

TEST_P(AssociatorOperations, NeedAnAssociationClassWhichEndsTheParameterListWhenNull)
{
    Asked asked;
    asked.assocClass = nullptr;
    asked.resultClass = "CIM_AlarmDevice";
    const CMPIObjectPath* const path = refToSystem();
    expectNothing(traverse(path, asked));
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function,
                                         Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(),
                                                            " ref=", path, " _RefLeftClass="))));
}

TEST_P(AssociatorOperations, EndTheParameterListAtTheFirstNullText)
{
    const auto upTo = [&](const CMPIObjectPath* path, const Asked& asked) {
        const auto parameters =
            Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                               " _RefLeftClass=", asked.assocClass, " _RefRightClass=", asked.resultClass,
                               " role=", asked.role, " resultRole=", asked.resultRole);
        return ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                           Logged::line(module, "EXITING", function, parameters));
    };
    for (const Asked& asked : {Asked{association, nullptr, "role", "resultRole"},
                               Asked{association, "CIM_AlarmDevice", nullptr, "x"},
                               Asked{association, "CIM_AlarmDevice", "role", nullptr}}) {
        newRequest();
        const CMPIObjectPath* const path = refToSystem();
        traverse(path, asked);
        EXPECT_THAT(Logged::linesOf(function), upTo(path, asked));
    }
}

TEST_P(AssociatorOperations, FindTheTargetByTheArgumentsAsReceived)
{
    const CMPIObjectPath* const path = refToSystem();
    Asked asked;
    asked.resultClass = "cim_ALARMdevice";
    traverse(path, asked);
    EXPECT_THAT(Logged::linesOf(forTargetPath),
                Each(::testing::HasSubstr(Logged::parameters(
                    " broker=", host.cmpiBroker(), " ref=", path, " _RefLeftClass=", association,
                    " _RefRightClass=", "cim_ALARMdevice", " rc=0x"))));
}

// References and ReferenceNames

TEST_F(SystemDeviceTraversal, ReferencesOfASystemNameItAndEachDevice)
{
    const CMPIStatus status = references(refToSystem());
    const auto instances = answer(status).instances;
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(SystemDevice::pairsOf(instances), ElementsAre("alpha a:/1", "alpha b:/2"));
    for (const auto& instance : instances) {
        EXPECT_EQ(instance.path.className, association);
        EXPECT_EQ(instance.path.nameSpace, "root/test");
        EXPECT_EQ(instance.path.host, Tavro::getSystemName());
        EXPECT_THAT(namesOf(instance), ElementsAre("GroupComponent", "PartComponent"));
    }
}

TEST_F(SystemDeviceTraversal, ReferenceNamesOfASystemNameItAndEachDevice)
{
    const CMPIStatus status = referenceNames(refToSystem());
    const auto paths = answer(status).paths;
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(SystemDevice::pairsOf(paths), ElementsAre("alpha a:/1", "alpha b:/2"));
    for (const auto& path : paths) {
        EXPECT_EQ(path.className, association);
        EXPECT_EQ(path.nameSpace, "root/test");
        EXPECT_EQ(path.host, Tavro::getSystemName());
    }
}

TEST_P(SystemCounts, ReferencesOfADeviceNameTheSystemsClassOnceForEachSystem)
{
    const auto instances = answer(references(refToDevice())).instances;
    EXPECT_THAT(instances, SizeIs(GetParam().size()));
    for (const auto& instance : instances) {
        const auto system = SystemDevice::referenceAmong(instance.properties, "GroupComponent");
        EXPECT_EQ(system.className, systemClass);
        EXPECT_EQ(system.nameSpace, "root/test");
        EXPECT_THAT(system.keys, IsEmpty());
        const auto device = SystemDevice::referenceAmong(instance.properties, "PartComponent");
        EXPECT_EQ(valueOf(device, "DeviceID"), "a:/1");
        EXPECT_THAT(device.keys, SizeIs(1)) << "the request's path";
    }
}

TEST_P(SystemCounts, ReferenceNamesOfADeviceNameTheSystemsClassOnceForEachSystem)
{
    const auto paths = answer(referenceNames(refToDevice())).paths;
    EXPECT_THAT(paths, SizeIs(GetParam().size()));
    for (const auto& path : paths) {
        const auto system = SystemDevice::referenceAmong(path.keys, "GroupComponent");
        EXPECT_EQ(system.className, systemClass);
        EXPECT_THAT(system.keys, IsEmpty());
        EXPECT_EQ(valueOf(SystemDevice::referenceAmong(path.keys, "PartComponent"), "DeviceID"), "a:/1");
    }
}

TEST_F(SystemDeviceTraversal, ReferencesOfASystemAreReturnedOneByOne)
{
    MadeInventory::set({{"a", "1"}});
    references(refToSystem());
    const std::string function = "GlimmarkSystemDevice_References";
    EXPECT_THAT(timeline(),
                ElementsAreArray(joined({"ENTERING " + function}, findingTheTarget(systemClass, deviceClass),
                                        makingOfTheAssociationPath(), readingTheTargetsClass(deviceClass),
                                        makingOfTheDevicePath("path3"),
                                        Texts{"newInstance(path2, rc)",
                                              "setProperty(instance1, \"GroupComponent\", ref, ref)",
                                              "setProperty(instance1, \"PartComponent\", path3, ref)",
                                              "returnInstance(instance1)", "EXITING " + function})));
}

TEST_F(SystemDeviceTraversal, ReferenceNamesOfASystemArePathsOfInstances)
{
    MadeInventory::set({{"a", "1"}});
    referenceNames(refToSystem());
    const std::string function = "GlimmarkSystemDevice_ReferenceNames";
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            {"ENTERING " + function}, findingTheTarget(systemClass, deviceClass),
            makingOfTheAssociationPath(), readingTheTargetsClass(deviceClass), makingOfTheDevicePath("path3"),
            Texts{"newInstance(path2, rc)", "setProperty(instance1, \"GroupComponent\", ref, ref)",
                  "setProperty(instance1, \"PartComponent\", path3, ref)", "getObjectPath(instance1, rc)"},
            returning("path4"), Texts{"EXITING " + function})));
}

TEST_F(SystemDeviceTraversal, ReferencesOfADeviceShareTheTargetPath)
{
    setComputerSystems({"one", "two"});
    references(refToDevice());
    const std::string function = "GlimmarkSystemDevice_References";
    EXPECT_THAT(timeline(),
                ElementsAreArray(joined(
                    {"ENTERING " + function}, findingTheTarget(deviceClass, systemClass),
                    makingOfTheAssociationPath(), readingTheTargetsClass(systemClass),
                    Texts{"enumerateInstanceNames(ctx, path1, rc)", "hasNext(enumeration1, null)",
                          "getNext(enumeration1, null)", "newInstance(path2, rc)",
                          "setProperty(instance1, \"GroupComponent\", path1, ref)",
                          "setProperty(instance1, \"PartComponent\", ref, ref)", "returnInstance(instance1)",
                          "hasNext(enumeration1, null)", "getNext(enumeration1, null)",
                          "newInstance(path2, rc)", "setProperty(instance2, \"GroupComponent\", path1, ref)",
                          "setProperty(instance2, \"PartComponent\", ref, ref)", "returnInstance(instance2)",
                          "hasNext(enumeration1, null)", "EXITING " + function})));
}

TEST_F(SystemDeviceTraversal, ReferenceNamesOfADeviceArePathsOfInstances)
{
    referenceNames(refToDevice());
    const std::string function = "GlimmarkSystemDevice_ReferenceNames";
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            {"ENTERING " + function}, findingTheTarget(deviceClass, systemClass),
            makingOfTheAssociationPath(), readingTheTargetsClass(systemClass),
            Texts{"enumerateInstanceNames(ctx, path1, rc)", "hasNext(enumeration1, null)",
                  "getNext(enumeration1, null)", "newInstance(path2, rc)",
                  "setProperty(instance1, \"GroupComponent\", path1, ref)",
                  "setProperty(instance1, \"PartComponent\", ref, ref)", "getObjectPath(instance1, rc)"},
            returning("path3"), Texts{"hasNext(enumeration1, null)", "EXITING " + function})));
}

TEST_F(SystemDeviceTraversal, ReferencesAreTracedAndNotFiltered)
{
    const CMPIObjectPath* const path = refToSystem();
    PropertyNames properties{"PartComponent"};
    const Asked asked{association, "CIM_Anything", "NoRole", nullptr, properties};
    const CMPIStatus status = references(path, asked);
    const std::string function = "GlimmarkSystemDevice_References";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                                               " resultClass=", asked.resultClass, " role=", asked.role,
                                               " properties=", asked.properties);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
    EXPECT_THAT(broker.calls({"setPropertyFilter"}), IsEmpty());
    EXPECT_THAT(SystemDevice::pairsOf(answer(status).instances), ElementsAre("alpha a:/1", "alpha b:/2"));
}

TEST_F(SystemDeviceTraversal, ReferenceNamesAreTraced)
{
    const CMPIObjectPath* const path = refToSystem();
    const Asked asked{association, "CIM_Anything", "NoRole"};
    referenceNames(path, asked);
    const std::string function = "GlimmarkSystemDevice_ReferenceNames";
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                                               " resultClass=", asked.resultClass, " role=", asked.role);
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                            Logged::line(module, "EXITING", function, parameters)));
}

TEST_P(ReferenceOperations, EndTheParameterListAtTheFirstNullText)
{
    for (const Asked& asked : {Asked{association, nullptr, "role"}, Asked{association, "Any", nullptr}}) {
        newRequest();
        const CMPIObjectPath* const path = refToSystem();
        traverse(path, asked);
        const auto parameters =
            Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                               " resultClass=", asked.resultClass, " role=", asked.role);
        EXPECT_THAT(Logged::linesOf(function),
                    ElementsAre(Logged::line(module, "ENTERING", function, parameters),
                                Logged::line(module, "EXITING", function, parameters)));
    }
}

TEST_P(ReferenceOperations, AnswerWhateverTheResultClassAndTheRole)
{
    for (const std::string& from : {systemClass, deviceClass}) {
        for (const char* text : {"", "CIM_Unrelated", "GroupComponent", "PartComponent"}) {
            newRequest();
            setComputerSystems({"one", "two"});
            const CMPIStatus status = traverse(ref(from, {{"Any", "key"}}), {association, text, text});
            EXPECT_EQ(status.rc, CMPI_RC_OK);
            EXPECT_EQ(answered(status), 2U) << from << ' ' << text;
        }
    }
}

TEST_P(ReferenceOperations, FindTheTargetByTheirOwnAssociation)
{
    const CMPIObjectPath* const path = refToSystem();
    Asked asked;
    asked.resultClass = capabilities;
    traverse(path, asked);
    const auto parameters = Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path,
                                               " _RefLeftClass=", association, " _RefRightClass=");
    EXPECT_THAT(Logged::linesOf(forTargetPath),
                ElementsAre(Logged::line("GlimmarkObjFactory", "ENTERING", forTargetPath, parameters),
                            Logged::line("GlimmarkObjFactory", "EXITING", forTargetPath, parameters)));
}

TEST_P(ReferenceOperations, FailWithoutATarget)
{
    for (const char* from : {"CIM_AlarmDevice", "TAVRO_GlimmarkCapabilities", "tavro_computersystem"}) {
        newRequest();
        const CMPIStatus status = traverse(ref(from, {{"Any", "key"}}));
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), noTarget);
        EXPECT_THAT(broker.calls({"newString", "trace", "newObjectPath"}),
                    ElementsAre(statusText(noTarget), warning(noTarget)));
        EXPECT_EQ(timeline().back(), warning(noTarget));
        EXPECT_THAT(Logged::linesOf(function), SizeIs(1));
    }
}

TEST_P(ReferenceOperations, FailWhereTheTargetPathCannotBeMade)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        newRequest();
        broker.fail("newObjectPath", 1, failure);
        const CMPIStatus status = traverse(refToDevice());
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), noTarget);
        EXPECT_EQ(timeline().back(), warning(noTarget));
        EXPECT_THAT(broker.calls({"newObjectPath"}), SizeIs(1));
    }
}

TEST_P(ReferenceOperations, FailWithoutABrokerWithoutAMessage)
{
    mi = GlimmarkSystemDeviceProvider_Create_AssociationMI(nullptr, nullptr, nullptr);
    const CMPIStatus status = traverse(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls({"newString", "trace"}), IsEmpty());
    EXPECT_THAT(Logged::linesOf(function), SizeIs(1));
}

TEST_P(ReferenceOperations, AnswerNothingWithoutAnAssociationPath)
{
    setComputerSystems({"one", "two"});
    for (const std::string& from : {systemClass, deviceClass}) {
        newRequest();
        broker.fail("newObjectPath", 2, Failure::nullResult);
        expectNothing(traverse(ref(from, {{"Any", "key"}})));
        EXPECT_THAT(broker.calls({"newInstance", "setProperty", "newString"}), IsEmpty());
        EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
    }
}

TEST_P(ReferenceOperations, AskForInstancesOfAnAssociationPathWithoutAHandle)
{
    broker.fail("newObjectPath", 2, Failure::noHandle);
    traverse(refToSystem());
    EXPECT_THAT(broker.calls({"newInstance"}),
                ElementsAre("newInstance(path2, rc)", "newInstance(path2, rc)"));
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
}

TEST_P(ReferenceOperations, SkipAnInstanceThatCouldNotBeMade)
{
    setComputerSystems({"one", "two"});
    for (const std::string& from : {systemClass, deviceClass}) {
        newRequest();
        broker.fail("newInstance", 1, Failure::nullResult);
        const CMPIStatus status = traverse(ref(from, {{"Any", "key"}}));
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(message(status), std::nullopt);
        EXPECT_EQ(answered(status), 1U);
        EXPECT_THAT(broker.calls(resultServices), SizeIs(1));
        EXPECT_THAT(broker.calls({"newString"}), IsEmpty()) << "and say nothing";
    }
}

TEST_P(ReferenceOperations, TakeAnInstanceWithoutAHandleForOne)
{
    MadeInventory::set({{"a", "1"}});
    for (const std::string& from : {systemClass, deviceClass}) {
        newRequest();
        broker.fail("newInstance", 1, Failure::noHandle);
        traverse(ref(from, {{"Any", "key"}}));
        EXPECT_THAT(broker.calls({"setProperty"}), SizeIs(2))
            << "what it is without one is its maker's to say";
        EXPECT_THAT(broker.calls({"returnInstance", "getObjectPath"}), ElementsAre(HasSubstr("(instance1")));
    }
}

TEST_P(ReferenceOperations, ReferToADevicePathThatLostItsHandle)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("addKey", 4, Failure::lostHandle);
    traverse(refToSystem());
    EXPECT_THAT(broker.calls({"setProperty"}),
                ElementsAre("setProperty(instance1, \"GroupComponent\", ref, ref)",
                            "setProperty(instance1, \"PartComponent\", path3, ref)"));
    EXPECT_THAT(broker.calls(resultServices), SizeIs(1));
    EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
}

TEST_P(ReferenceOperations, KeepTheStatusThatTheBrokersCallsLeave)
{
    MadeInventory::set({{"a", "1"}});
    broker.fail("newInstance", 1, Failure::errorStatus);
    const CMPIStatus status = traverse(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
}

TEST_F(SystemDeviceTraversal, ReferenceNamesSkipAnInstanceWithoutAPath)
{
    broker.fail("getObjectPath", 1, Failure::nullResult);
    const CMPIStatus status = referenceNames(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(SystemDevice::pairsOf(answer(status).paths), ElementsAre("alpha b:/2"));
    EXPECT_THAT(broker.calls(resultServices), SizeIs(1));
}

TEST_P(ReferenceOperations, CountASystemThatIsNone)
{
    // What the enumeration brings is not looked at.
    for (const Failure failure : {Failure::nullResult, Failure::wrongValue}) {
        newRequest();
        broker.fail("getNext", 1, failure);
        const CMPIStatus status = traverse(refToDevice());
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(answered(status), broker.calls({"getNext"}).size());
        EXPECT_EQ(answered(status), 2U) << "the item that is none is not taken from the enumeration";
    }
}

TEST_P(ReferenceOperations, GoToTheEndWhereTheTargetsClassCannotBeRead)
{
    broker.fail("getClassName", 2, Failure::errorStatus);
    const CMPIStatus status = traverse(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls({"newInstance", "returnInstance", "returnObjectPath"}), IsEmpty());
    EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
}

// Several operations

TEST_P(NameEnumeratingOperations, EndAtAFailedEnumeration)
{
    broker.fail("enumerateInstanceNames", 1, Failure::errorStatus);
    const CMPIStatus status = traverse(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_EQ(broker.calls().back(), "enumerateInstanceNames(ctx, path1, rc)") << "and no broker trace";
    EXPECT_THAT(Logged::linesOf(function), ElementsAre(StartsWith("3000 "), enumerationFailed));
}

TEST_P(NameEnumeratingOperations, TakeNoEnumerationForAnEmptyOne)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        newRequest();
        broker.fail("enumerateInstanceNames", 1, failure);
        expectNothing(traverse(refToDevice()));
        EXPECT_THAT(Logged::linesOf(function), SizeIs(2));
    }
}

TEST_P(PathCollectingOperations, EndWithoutAnExitWhereThereIsNoDevice)
{
    MadeInventory::set({});
    expectNothing(traverse(refToSystem()));
    EXPECT_THAT(Logged::linesOf(function), SizeIs(1));
    EXPECT_EQ(broker.calls().back(),
              "trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)");
}

TEST_P(PathCollectingOperations, EndWithTheFactorysStatusWhereAPathCannotBeMade)
{
    // After the target path and, for the references, the association path: the second device's.
    const int second = GetParam().name == std::string("AssociatorNames") ? 3 : 4;
    broker.fail("newObjectPath", second, Failure::nullResult);
    const CMPIStatus status = traverse(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "Create CMPIObjectPath failed.");
    EXPECT_THAT(broker.calls(resultServices), IsEmpty()) << "not even the first device's";
    EXPECT_THAT(Logged::linesOf(function), SizeIs(1));
}

TEST_P(WithoutRegistration, ADeviceIsAnsweredWithTheBrokersStatus)
{
    const CMPIStatus status = traverse(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_NAMESPACE);
    EXPECT_NE(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    const bool checksTheStatus = GetParam().name != std::string("Associators");
    EXPECT_THAT(Logged::linesOf(function),
                ElementsAre(StartsWith("3000 "), checksTheStatus
                                                     ? ::testing::Matcher<std::string>(enumerationFailed)
                                                     : StartsWith("3000 ")));
}

TEST_P(WithoutLibrary, ADeviceIsAnsweredWithTheBrokersStatus)
{
    const CMPIStatus status = traverse(refToDevice());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_NE(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
}

TEST_P(WithoutRegistration, ASystemIsAnsweredAllTheSame)
{
    const CMPIStatus status = traverse(refToSystem());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(answered(status), 2U) << "its devices come from the inventory";
}

TEST_P(AllTraversals, AreNeverDone)
{
    for (const std::string& from : {systemClass, deviceClass, std::string("CIM_AlarmDevice")}) {
        newRequest();
        traverse(ref(from, {{"Any", "key"}}));
        EXPECT_EQ(request->doneCount(), 0);
    }
}

TEST_P(AllTraversals, StayInTheRequestsNamespace)
{
    traverse(ref(systemClass, {{"Name", "alpha"}}, "root/other"));
    EXPECT_THAT(broker.calls({"newObjectPath"}), Each(StartsWith("newObjectPath(\"root/other\", ")));
    EXPECT_THAT(broker.calls({"setNameSpace"}), Each(::testing::EndsWith(", \"root/other\")")));
}

TEST_P(AllTraversals, DoNotLookAtTheRoles)
{
    const CMPIStatus status = traverse(refToSystem(), {association, nullptr, "NoRole", "NoRole"});
    EXPECT_EQ(answered(status), 2U);
}

} // namespace SystemDeviceTraversalTests
