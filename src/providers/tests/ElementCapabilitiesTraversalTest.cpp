// The traversal of the association TAVRO_GlimmarkElementCapabilities, driven through the provider's function
// table.

#include "testing/ElementCapabilitiesFixture.h"

#include <utility>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ElementCapabilities::TraversalTests {

using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::ElementsAreArray;
using ::testing::IsEmpty;
using ::testing::IsSupersetOf;
using ::testing::SizeIs;
using ::testing::StartsWith;

namespace {

constexpr auto systemDevice = "TAVRO_GlimmarkSystemDevice";
constexpr auto referencesName = "GlimmarkElementCapabilities_References";
constexpr auto referenceNamesName = "GlimmarkElementCapabilities_ReferenceNames";
constexpr auto associatorsName = "GlimmarkElementCapabilities_Associators";
constexpr auto associatorNamesName = "GlimmarkElementCapabilities_AssociatorNames";

class ElementCapabilitiesTraversal : public Fixture
{
protected:
    CMPIStatus references(const CMPIObjectPath* path, const char* resultClass = "Some",
                          const char* role = "Any", const char** properties = nullptr)
    {
        return mi->ft->references(mi, ctx(), rslt(), path, resultClass, role, properties);
    }
    CMPIStatus referenceNames(const CMPIObjectPath* path, const char* resultClass = "Some",
                              const char* role = "Any")
    {
        return mi->ft->referenceNames(mi, ctx(), rslt(), path, resultClass, role);
    }
    CMPIStatus associators(const CMPIObjectPath* path, const char* assocClass = association,
                           const char* resultClass = "Some", const char* role = "Any",
                           const char* resultRole = "Other", const char** properties = nullptr)
    {
        return mi->ft->associators(mi, ctx(), rslt(), path, assocClass, resultClass, role, resultRole,
                                   properties);
    }
    CMPIStatus associatorNames(const CMPIObjectPath* path, const char* assocClass = association,
                               const char* resultClass = "Some", const char* role = "Any",
                               const char* resultRole = "Other")
    {
        return mi->ft->associatorNames(mi, ctx(), rslt(), path, assocClass, resultClass, role, resultRole);
    }

    CMPIObjectPath* device() { return ref(glimmark, {{"DeviceID", "a:/1"}}); }
    CMPIObjectPath* capabilitiesObject()
    {
        return ref(capabilities, {{"InstanceID", "TAVRO:GlimmarkCapabilities1"}});
    }

    // The given paths as valueOf() writes them.
    const std::string givenDevice = "root/test:TAVRO_Glimmark.DeviceID=a:/1";
    const std::string givenCapabilities = capabilitiesText;

    /// Finding the far end's class and reading it off the target's path.
    Texts resolution(const std::string& nearClass, std::size_t routes, const std::string& farClass,
                     const std::string& text) const
    {
        return joined(
            findingOfTheTarget(nearClass, routes, farClass,
                               R"(trace(1, "GlimmarkElementCapabilitiesProvider", ")" + text + R"(", null))"),
            readingOfTheClass("path1", farClass));
    }
    Texts resolutionOfTheDevice() const
    {
        return resolution(glimmark, 3, capabilities, "Target Class is GlimmarkCapabilitiesClass");
    }
    Texts resolutionOfTheCapabilities() const
    {
        return resolution(capabilities, 4, glimmark, "Target Class is GlimmarkClass");
    }

    CMPIAssociationMI* mi =
        GlimmarkElementCapabilitiesProvider_Create_AssociationMI(host.cmpiBroker(), nullptr, nullptr);
};

enum class Kind
{
    references,
    referenceNames,
    associators,
    associatorNames
};

struct Operation
{
    Kind kind;
    const char* name;
    const char* noTargetText;
};

const Operation operations[] = {
    {Kind::references, referencesName, "Object Path is NULL in References."},
    {Kind::referenceNames, referenceNamesName, "Object Path is NULL in ReferenceNames."},
    {Kind::associators, associatorsName, "Object Path is NULL in Associators."},
    {Kind::associatorNames, associatorNamesName, "Object Path is NULL in AssociatorsNames."},
};

void PrintTo(const Operation& operation, std::ostream* stream)
{
    *stream << operation.name;
}

std::string nameOfOperation(const ::testing::TestParamInfo<Operation>& operation)
{
    return std::string(operation.param.name).substr(std::string("GlimmarkElementCapabilities_").size());
}

/// What the four operations have in common.
class ElementCapabilitiesTraversals : public ElementCapabilitiesTraversal,
                                      public ::testing::WithParamInterface<Operation>
{
protected:
    CMPIStatus traverse(const CMPIObjectPath* path, const char* assocClass = association,
                        const char* resultClass = "Some", const char* role = "Any",
                        const char* resultRole = "Other")
    {
        switch (GetParam().kind) {
        case Kind::references:
            return references(path, resultClass, role);
        case Kind::referenceNames:
            return referenceNames(path, resultClass, role);
        case Kind::associators:
            return associators(path, assocClass, resultClass, role, resultRole);
        case Kind::associatorNames:
            break;
        }
        return associatorNames(path, assocClass, resultClass, role, resultRole);
    }

    bool takesAnAssociationClass() const
    {
        return GetParam().kind == Kind::associators || GetParam().kind == Kind::associatorNames;
    }

    /// That the operation found no far end's class and ended at once.
    void expectNoTarget(const CMPIStatus& status)
    {
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), GetParam().noTargetText);
        EXPECT_THAT(lastOf(timeline(), 3),
                    ElementsAre("EXITING get_assoc_targetClass_ObjectPath",
                                statusText(GetParam().noTargetText), warning(GetParam().noTargetText)))
            << "nothing after it";
        EXPECT_THAT(Logged::linesOf(GetParam().name), SizeIs(1));
    }
};

INSTANTIATE_TEST_SUITE_P(Every, ElementCapabilitiesTraversals, ::testing::ValuesIn(operations),
                         nameOfOperation);

} // namespace

// What the four operations have in common

TEST_P(ElementCapabilitiesTraversals, LeadFromAnIndicatorToTheCapabilities)
{
    const CMPIStatus status = traverse(device());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(resultServices), SizeIs(1)) << "no returnDone";
    EXPECT_THAT(Logged::linesOf(GetParam().name), SizeIs(2));
}

TEST_P(ElementCapabilitiesTraversals, LeadFromTheCapabilitiesToEveryIndicator)
{
    MadeInventory::set({{"b", "2"}, {"c", "3"}, {"a", "1"}});
    const CMPIStatus status = traverse(capabilitiesObject());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), SizeIs(3)) << "no returnDone";
    EXPECT_THAT(Logged::linesOf(GetParam().name), SizeIs(2));
}

TEST_P(ElementCapabilitiesTraversals, DoNotAskWhetherTheGivenObjectExists)
{
    for (const CMPIObjectPath* given : {ref(glimmark), ref(glimmark, {{"DeviceID", "unknown"}}),
                                        ref(capabilities, {{"InstanceID", "unknown"}})}) {
        clearRecords();
        EXPECT_EQ(traverse(given).rc, CMPI_RC_OK);
        EXPECT_THAT(broker.calls(resultServices), SizeIs(1));
        EXPECT_THAT(broker.calls({"getKey", "getKeyCount"}), IsEmpty());
    }
}

TEST_P(ElementCapabilitiesTraversals, DoNotFilterByResultClassOrRoles)
{
    for (const char* text : {"CIM_Nothing", "", "TAVRO_Glimmark", static_cast<const char*>(nullptr)}) {
        clearRecords();
        EXPECT_EQ(traverse(device(), association, text, text, text).rc, CMPI_RC_OK);
        EXPECT_THAT(broker.calls(resultServices), SizeIs(1));
    }
}

TEST_P(ElementCapabilitiesTraversals, FailWhereNoAssociationStarts)
{
    for (const char* nearClass :
         {"TAVRO_ComputerSystem", "CIM_AlarmDevice", "tavro_glimmark", "TAVRO_GlimmarkElementCapabilities"}) {
        clearRecords();
        expectNoTarget(traverse(ref(nearClass)));
    }
}

TEST_P(ElementCapabilitiesTraversals, FailWithoutAPathOfTheFarClass)
{
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus}) {
        clearRecords();
        broker.fail("newObjectPath", 1, failure);
        expectNoTarget(traverse(device()));
    }
}

TEST_P(ElementCapabilitiesTraversals, TakeTheAssociationClassOfTheRequestOrTheirOwn)
{
    for (const char* assocClass : {"tavro_glimmarkelementcapabilities", "CIM_ElementCapabilities", "",
                                   static_cast<const char*>(nullptr)}) {
        clearRecords();
        const CMPIStatus status = traverse(device(), assocClass);
        if (takesAnAssociationClass())
            expectNoTarget(status);
        else
            EXPECT_EQ(status.rc, CMPI_RC_OK);
    }
    clearRecords();
    const CMPIStatus status = traverse(capabilitiesObject(), systemDevice);
    if (takesAnAssociationClass())
        expectNoTarget(status);
    else
        EXPECT_EQ(status.rc, CMPI_RC_OK);
}

TEST_P(ElementCapabilitiesTraversals, HandTheirClassesToTheResolution)
{
    const CMPIObjectPath* const path = device();
    traverse(path);
    const auto lines = Logged::linesOf("get_assoc_targetClass_ObjectPath");
    ASSERT_THAT(lines, SizeIs(2));
    const auto line = Logged::line("GlimmarkObjFactory", "ENTERING", "get_assoc_targetClass_ObjectPath",
                                   Logged::parameters(" broker=", host.cmpiBroker(), " ref=", path,
                                                      " _RefLeftClass=", association, " _RefRightClass="));
    if (takesAnAssociationClass())
        EXPECT_THAT(lines[0], StartsWith(line + "Some rc="));
    else
        EXPECT_EQ(lines[0], line) << "a null result class ends the list";
}

TEST_P(ElementCapabilitiesTraversals, FindNothingBeyondTheirTwoClasses)
{
    if (!takesAnAssociationClass())
        return; // their association class is their own
    const CMPIStatus status = traverse(device(), systemDevice);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(lastOf(timeline(), 4),
                ElementsAre("EXITING get_assoc_targetClass_ObjectPath", "getClassName(path1, rc)",
                            "getCharPtr(\"TAVRO_ComputerSystem\", rc)",
                            "EXITING " + std::string(GetParam().name)));
}

TEST_P(ElementCapabilitiesTraversals, LeadFromAComputerSystemByTheOtherAssociationToTheIndicators)
{
    if (!takesAnAssociationClass())
        return;
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    EXPECT_EQ(traverse(ref("TAVRO_ComputerSystem"), systemDevice).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), SizeIs(2));
}

TEST_P(ElementCapabilitiesTraversals, FindNothingWhenTheFarClassCannotBeRead)
{
    broker.fail("getClassName", 4, Failure::nullResult); // three for the routes to it
    EXPECT_EQ(traverse(device()).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    EXPECT_THAT(Logged::linesOf(GetParam().name), SizeIs(2));
}

TEST_P(ElementCapabilitiesTraversals, FollowNoNullPath)
{
    expectNoTarget(traverse(nullptr));
}

TEST_P(ElementCapabilitiesTraversals, OfAnEmptyInventoryStillLeadToTheCapabilities)
{
    MadeInventory::set({});
    EXPECT_EQ(traverse(device()).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices), SizeIs(1));
    EXPECT_THAT(Logged::linesOf(GetParam().name), SizeIs(2));
}

TEST_P(ElementCapabilitiesTraversals, OfAnEmptyInventoryFindNoIndicator)
{
    MadeInventory::set({});
    const CMPIStatus status = traverse(capabilitiesObject());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    if (GetParam().kind == Kind::associators) {
        EXPECT_THAT(lastOf(timeline(), 2), ElementsAre("EXITING getAllGlimmarkCMPIInstances",
                                                       "EXITING GlimmarkElementCapabilities_Associators"));
    } else {
        // The factory answers that there is no path, which ends the operation at once.
        EXPECT_THAT(lastOf(timeline(), 2),
                    ElementsAre("ENTERING getAllGlimmarkCMPIObjPaths",
                                "trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)"));
    }
}

TEST_P(ElementCapabilitiesTraversals, EndWithTheFactorysReportWithoutTheFarPaths)
{
    if (GetParam().kind == Kind::associators)
        return; // it gets instances, which the factory always answers
    struct Row
    {
        CMPIObjectPath* given;
        const char* message;
        const char* component;
    };
    // The target's path, for the references that of the association, then the far one.
    const int farPath = takesAnAssociationClass() ? 2 : 3;
    for (const Row& row :
         {Row{device(), "Create CMPIObjectPath failed", "GlimmarkCapabilitiesProvider"},
          Row{capabilitiesObject(), "Create CMPIObjectPath failed.", "GlimmarkProfileProvider"}}) {
        clearRecords();
        broker.fail("newObjectPath", farPath, Failure::nullResult);
        const CMPIStatus status = traverse(row.given);
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), row.message);
        EXPECT_THAT(broker.calls().back(), StartsWith("trace(2, \"" + std::string(row.component) + "\", "));
        EXPECT_THAT(broker.calls({"newString"}), SizeIs(1)) << "none of its own";
        EXPECT_THAT(broker.calls(resultServices), IsEmpty());
        EXPECT_THAT(Logged::linesOf(GetParam().name), SizeIs(1));
    }
}

// References

TEST_F(ElementCapabilitiesTraversal, ReferencesOfAnIndicatorTakeTheseSteps)
{
    references(device());
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            Texts{"ENTERING GlimmarkElementCapabilities_References"}, collection, resolutionOfTheDevice(),
            makingOfAPath(association, "path2"), makingOfTheCapabilitiesPath("path3"),
            Texts{"newInstance(path2, rc)", "setProperty(instance1, \"ManagedElement\", ref, ref)",
                  "setProperty(instance1, \"Capabilities\", path3, ref)", "returnInstance(instance1)",
                  "EXITING GlimmarkElementCapabilities_References"})));
}

TEST_F(ElementCapabilitiesTraversal, ReferencesOfTheCapabilitiesTakeTheseSteps)
{
    references(capabilitiesObject());
    EXPECT_THAT(timeline(),
                ElementsAreArray(joined(
                    Texts{"ENTERING GlimmarkElementCapabilities_References"}, collection,
                    resolutionOfTheCapabilities(), makingOfAPath(association, "path2"),
                    makingOfTheDevicePath("path3"),
                    Texts{"newInstance(path2, rc)", "setProperty(instance1, \"ManagedElement\", path3, ref)",
                          "setProperty(instance1, \"Capabilities\", ref, ref)", "returnInstance(instance1)",
                          "EXITING GlimmarkElementCapabilities_References"})));
}

TEST_F(ElementCapabilitiesTraversal, ReferencesOfAnIndicatorPairItWithTheCapabilities)
{
    const auto instances = answer(references(device())).instances;
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_EQ(valueOf(instances[0], "ManagedElement"), givenDevice);
    EXPECT_EQ(valueOf(instances[0], "Capabilities"), capabilitiesText);
    EXPECT_EQ(instances[0].path.className, association);
    EXPECT_EQ(instances[0].path.nameSpace, "root/test");
    EXPECT_EQ(instances[0].path.host, Tavro::getSystemName());
}

TEST_F(ElementCapabilitiesTraversal, ReferencesOfTheCapabilitiesPairThemWithEachIndicatorInOrder)
{
    MadeInventory::set({{"b", "2"}, {"c", "3"}, {"a", "1"}});
    const auto instances = answer(references(capabilitiesObject())).instances;
    EXPECT_THAT(valuesOf(instances, "ManagedElement"),
                ElementsAre(deviceText("a:/1"), deviceText("b:/2"), deviceText("c:/3")));
    EXPECT_THAT(valuesOf(instances, "Capabilities"), Each(givenCapabilities));
}

TEST_F(ElementCapabilitiesTraversal, ReferencesIgnoreThePropertyList)
{
    PropertyNames properties{"Capabilities"};
    const auto instances = answer(references(device(), "Some", "Any", properties)).instances;
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("ManagedElement", "Capabilities"));
    EXPECT_THAT(broker.calls({"setPropertyFilter"}), IsEmpty());
}

TEST_F(ElementCapabilitiesTraversal, ReferencesAreTracedWithAFlawedLabelAtTheExit)
{
    const CMPIObjectPath* const path = device();
    PropertyNames properties{"Capabilities"};
    const char** const list = properties;
    using Strings = std::pair<const char*, const char*>;
    for (const auto& [resultClass, role] :
         {Strings{"Result", "Role"}, Strings{nullptr, "Role"}, Strings{"Result", nullptr}}) {
        clearRecords();
        references(path, resultClass, role, list);
        const auto parameters = [&, result = resultClass, given = role](const std::string& lastLabel) {
            return Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                                      " resultClass=", result, " role=", given, lastLabel, list);
        };
        EXPECT_THAT(Logged::linesOf(referencesName),
                    ElementsAre(Logged::line(module, "ENTERING", referencesName, parameters(" properties=")),
                                Logged::line(module, "EXITING", referencesName,
                                             parameters(" p" + blanks(5) + "roperties="))));
    }
}

TEST_F(ElementCapabilitiesTraversal, ReferencesThatCouldNotBeMadeAreHandedOn)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    broker.fail("newInstance", 1, Failure::nullResult);
    EXPECT_EQ(references(capabilitiesObject()).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls({"setProperty"}), SizeIs(2)) << "of the other alone";
    EXPECT_THAT(broker.calls(resultServices),
                ElementsAre("returnInstance(null)", "returnInstance(instance1)"));
}

TEST_F(ElementCapabilitiesTraversal, ReferencesWithoutAnAssociationPathAreNull)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    broker.fail("newObjectPath", 2, Failure::nullResult);
    EXPECT_EQ(references(capabilitiesObject()).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls({"newInstance", "setProperty"}), IsEmpty());
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(null)", "returnInstance(null)"));
    EXPECT_THAT(Logged::linesOf(referencesName), SizeIs(2));
}

TEST_F(ElementCapabilitiesTraversal, ReferencesKeepTheStatusOfNewInstance)
{
    broker.fail("newInstance", 1, Failure::errorStatus);
    const CMPIStatus status = references(device());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(Logged::linesOf(referencesName), SizeIs(2));
}

// ReferenceNames

TEST_F(ElementCapabilitiesTraversal, ReferenceNamesOfAnIndicatorTakeTheseSteps)
{
    referenceNames(device());
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            Texts{"ENTERING GlimmarkElementCapabilities_ReferenceNames"}, collection, resolutionOfTheDevice(),
            makingOfAPath(association, "path2"), makingOfTheCapabilitiesPath("path3"),
            Texts{"newInstance(path2, rc)", "setProperty(instance1, \"ManagedElement\", ref, ref)",
                  "setProperty(instance1, \"Capabilities\", path3, ref)", "getObjectPath(instance1, rc)"},
            settingOfTheNamespace("path4"),
            Texts{"returnObjectPath(path4)", "EXITING GlimmarkElementCapabilities_ReferenceNames"})));
}

TEST_F(ElementCapabilitiesTraversal, ReferenceNamesOfTheCapabilitiesTakeTheseSteps)
{
    referenceNames(capabilitiesObject());
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            Texts{"ENTERING GlimmarkElementCapabilities_ReferenceNames"}, collection,
            resolutionOfTheCapabilities(), makingOfAPath(association, "path2"),
            makingOfTheDevicePath("path3"),
            Texts{"newInstance(path2, rc)", "setProperty(instance1, \"ManagedElement\", path3, ref)",
                  "setProperty(instance1, \"Capabilities\", ref, ref)", "getObjectPath(instance1, rc)"},
            settingOfTheNamespace("path4"),
            Texts{"returnObjectPath(path4)", "EXITING GlimmarkElementCapabilities_ReferenceNames"})));
}

TEST_F(ElementCapabilitiesTraversal, ReferenceNamesCarryBothEndsAsKeys)
{
    MadeInventory::set({{"b", "2"}, {"a", "1"}});
    const auto paths = answer(referenceNames(capabilitiesObject())).paths;
    EXPECT_THAT(valuesOf(paths, "ManagedElement"), ElementsAre(deviceText("a:/1"), deviceText("b:/2")));
    EXPECT_THAT(valuesOf(paths, "Capabilities"), Each(givenCapabilities));
    for (const auto& path : paths) {
        EXPECT_EQ(path.className, association);
        EXPECT_EQ(path.nameSpace, "root/test");
        EXPECT_EQ(path.host, Tavro::getSystemName());
    }
}

TEST_F(ElementCapabilitiesTraversal, ReferenceNamesAreTraced)
{
    const CMPIObjectPath* const path = device();
    using Strings = std::pair<const char*, const char*>;
    for (const auto& [resultClass, role] :
         {Strings{"Result", "Role"}, Strings{nullptr, "Role"}, Strings{"Result", nullptr}}) {
        clearRecords();
        referenceNames(path, resultClass, role);
        const auto parameters =
            Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                               " resultClass=", resultClass, " role=", role);
        EXPECT_THAT(Logged::linesOf(referenceNamesName),
                    ElementsAre(Logged::line(module, "ENTERING", referenceNamesName, parameters),
                                Logged::line(module, "EXITING", referenceNamesName, parameters)));
    }
}

TEST_F(ElementCapabilitiesTraversal, ReferenceNamesPassOverWhatCouldNotBeMade)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    for (const char* service : {"newInstance", "getObjectPath"}) {
        newRequest();
        broker.fail(service, 1, Failure::nullResult);
        const CMPIStatus status = referenceNames(capabilitiesObject());
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_THAT(valuesOf(answer(status).paths, "ManagedElement"), ElementsAre(deviceText("b:/2")));
        EXPECT_THAT(broker.calls(resultServices), SizeIs(1));
        EXPECT_THAT(Logged::linesOf(referenceNamesName), SizeIs(2));
    }
}

TEST_F(ElementCapabilitiesTraversal, ReferenceNamesWithoutAnAssociationPathAreNone)
{
    broker.fail("newObjectPath", 2, Failure::nullResult);
    EXPECT_EQ(referenceNames(device()).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls({"newInstance", "setProperty", "getObjectPath"}), IsEmpty());
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    EXPECT_THAT(Logged::linesOf(referenceNamesName), SizeIs(2));
}

TEST_F(ElementCapabilitiesTraversal, ReferenceNamesKeepTheStatusOfGetObjectPath)
{
    broker.fail("getObjectPath", 1, Failure::errorStatus);
    const CMPIStatus status = referenceNames(device());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
}

// AssociatorNames

TEST_F(ElementCapabilitiesTraversal, AssociatorNamesOfAnIndicatorTakeTheseSteps)
{
    associatorNames(device());
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            Texts{"ENTERING GlimmarkElementCapabilities_AssociatorNames"}, collection,
            resolutionOfTheDevice(), makingOfTheCapabilitiesPath("path2"), settingOfTheNamespace("path2"),
            Texts{"returnObjectPath(path2)", "EXITING GlimmarkElementCapabilities_AssociatorNames"})));
}

TEST_F(ElementCapabilitiesTraversal, AssociatorNamesOfTheCapabilitiesTakeTheseSteps)
{
    associatorNames(capabilitiesObject());
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            Texts{"ENTERING GlimmarkElementCapabilities_AssociatorNames"}, collection,
            resolutionOfTheCapabilities(), makingOfTheDevicePath("path2"), settingOfTheNamespace("path2"),
            Texts{"returnObjectPath(path2)", "EXITING GlimmarkElementCapabilities_AssociatorNames"})));
}

TEST_F(ElementCapabilitiesTraversal, AssociatorNamesAreTheFarPathsInOrder)
{
    MadeInventory::set({{"b", "2"}, {"a", "1"}});
    EXPECT_THAT(valuesOf(answer(associatorNames(capabilitiesObject())).paths, "DeviceID"),
                ElementsAre("a:/1", "b:/2"));
    newRequest();
    EXPECT_THAT(valuesOf(answer(associatorNames(device())).paths, "InstanceID"),
                ElementsAre("TAVRO:GlimmarkCapabilities1"));
}

TEST_F(ElementCapabilitiesTraversal, AssociatorNamesAreTraced)
{
    const CMPIObjectPath* const path = device();
    // One after the other null, the first one never: it alone decides what is found.
    for (int null = 0; null < 4; ++null) {
        const char* const resultClass = null == 1 ? nullptr : "Result";
        const char* const role = null == 2 ? nullptr : "Role";
        const char* const resultRole = null == 3 ? nullptr : "ResultRole";
        clearRecords();
        associatorNames(path, association, resultClass, role, resultRole);
        const auto parameters = Logged::parameters(
            " mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path, " _RefLeftClass=", association,
            " _RefRightClass=", resultClass, " role=", role, " resultRole=", resultRole);
        EXPECT_THAT(Logged::linesOf(associatorNamesName),
                    ElementsAre(Logged::line(module, "ENTERING", associatorNamesName, parameters),
                                Logged::line(module, "EXITING", associatorNamesName, parameters)));
    }
}

TEST_F(ElementCapabilitiesTraversal, AssociatorNamesKeepTheStatusThatTheBrokersCallsLeave)
{
    // Two for the target's path, two for the far one, and one more before it is returned.
    broker.fail("getNameSpace", 5, Failure::errorStatus);
    const CMPIStatus status = associatorNames(device());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnObjectPath(path2)"));
}

// Associators

TEST_F(ElementCapabilitiesTraversal, AssociatorsOfAnIndicatorTakeTheseSteps)
{
    associators(device());
    EXPECT_THAT(
        timeline(),
        ElementsAreArray(joined(
            Texts{"ENTERING GlimmarkElementCapabilities_Associators"}, collection, resolutionOfTheDevice(),
            Texts{"ENTERING getAllGlimmarkCapabilitiesCMPIInstances",
                  "ENTERING makeGlimmarkCapabilitiesInstance"},
            readingOfTheNamespace,
            Texts{"newObjectPath(\"root/test\", \"TAVRO_GlimmarkCapabilities\", null)"},
            settingOfTheNamespace("path2"),
            Texts{"setHostname(path2, " + quotedHost + ")", "newInstance(path2, null)",
                  "setPropertyFilter(instance1, null, [InstanceID])",
                  "setProperty(instance1, \"InstanceID\", \"TAVRO:GlimmarkCapabilities1\", chars)",
                  "newArray(3, uint16, rc)", "setElementAt(array1, 0, 1, uint16)",
                  "setElementAt(array1, 1, 2, uint16)", "setElementAt(array1, 2, 3, uint16)",
                  "setProperty(instance1, \"RequestedAlarmStatesSupported\", array1, uint16A)",
                  "EXITING makeGlimmarkCapabilitiesInstance",
                  "EXITING getAllGlimmarkCapabilitiesCMPIInstances", "returnInstance(instance1)",
                  "EXITING GlimmarkElementCapabilities_Associators"})));
}

TEST_F(ElementCapabilitiesTraversal, AssociatorsOfTheCapabilitiesAreTheIndicatorsInOrder)
{
    MadeInventory::set({{"b", "2"}, {"a", "1"}});
    const auto instances = answer(associators(capabilitiesObject())).instances;
    EXPECT_THAT(valuesOf(instances, "DeviceID"), ElementsAre("a:/1", "b:/2"));
    EXPECT_THAT(namesOf(instances.at(0)), IsSupersetOf({"DeviceID", "AlarmState"})) << "a full instance";
}

TEST_F(ElementCapabilitiesTraversal, AssociatorsTakeThePropertyList)
{
    PropertyNames properties{"AlarmState"};
    const auto devices =
        answer(associators(capabilitiesObject(), association, nullptr, nullptr, nullptr, properties))
            .instances;
    ASSERT_THAT(devices, SizeIs(1));
    EXPECT_THAT(namesOf(devices[0]), ElementsAre("CreationClassName", "DeviceID", "SystemCreationClassName",
                                                 "SystemName", "AlarmState"));
    newRequest();
    const auto capabilitiesObjects =
        answer(associators(device(), association, nullptr, nullptr, nullptr, properties)).instances;
    ASSERT_THAT(capabilitiesObjects, SizeIs(1));
    EXPECT_THAT(namesOf(capabilitiesObjects[0]), ElementsAre("InstanceID"));
}

TEST_F(ElementCapabilitiesTraversal, AssociatorsAreTraced)
{
    const CMPIObjectPath* const path = device();
    PropertyNames properties{"InstanceID"};
    const char** const list = properties;
    for (int null = 0; null < 4; ++null) {
        const char* const resultClass = null == 1 ? nullptr : "Result";
        const char* const role = null == 2 ? nullptr : "Role";
        const char* const resultRole = null == 3 ? nullptr : "ResultRole";
        clearRecords();
        associators(path, association, resultClass, role, resultRole, list);
        const auto parameters =
            Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path,
                               " _RefLeftClass=", association, " _RefRightClass=", resultClass,
                               " role=", role, " resultRole=", resultRole, " properties=", list);
        EXPECT_THAT(Logged::linesOf(associatorsName),
                    ElementsAre(Logged::line(module, "ENTERING", associatorsName, parameters),
                                Logged::line(module, "EXITING", associatorsName, parameters)));
    }
}

TEST_F(ElementCapabilitiesTraversal, ANullAssociationClassEndsTheParameterList)
{
    const CMPIObjectPath* const path = device();
    associators(path, nullptr);
    associatorNames(path, nullptr);
    const auto parameters =
        Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path, " _RefLeftClass=");
    EXPECT_THAT(Logged::linesOf(associatorsName),
                ElementsAre(Logged::line(module, "ENTERING", associatorsName, parameters)));
    EXPECT_THAT(Logged::linesOf(associatorNamesName),
                ElementsAre(Logged::line(module, "ENTERING", associatorNamesName, parameters)));
}

TEST_F(ElementCapabilitiesTraversal, AssociatorsHandOnWhatCouldNotBeMade)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    broker.fail("newInstance", 1, Failure::nullResult);
    EXPECT_EQ(associators(capabilitiesObject()).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(resultServices),
                ElementsAre("returnInstance(null)", "returnInstance(instance1)"));
}

TEST_F(ElementCapabilitiesTraversal, AssociatorsAreReturnedBesideTheFactorysFailure)
{
    broker.fail("newArray", 1, Failure::nullResult);
    const CMPIStatus status = associators(device());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status),
              "Creating array for Property" + blanks(25) + "RequestedAlarmStatesSupported failed.");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnInstance(instance1)"));
    EXPECT_THAT(Logged::linesOf(associatorsName), SizeIs(2));
}

} // namespace ElementCapabilities::TraversalTests
