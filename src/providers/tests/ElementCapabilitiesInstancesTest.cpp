// The instances of the association TAVRO_GlimmarkElementCapabilities, driven through the provider's function
// table.

#include "testing/ElementCapabilitiesFixture.h"
#include "testing/RecordedComparisons.h"

#include <algorithm>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ElementCapabilities::InstancesTests {

using ::testing::Contains;
using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::ElementsAreArray;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using ::testing::StartsWith;

namespace cim = cimhost::cim;

namespace {

constexpr auto builder = "glimmarkElementCapabilitiesCMPIInstances";
constexpr auto enumInstanceNames = "GlimmarkElementCapabilities_EnumInstanceNames";
constexpr auto enumInstances = "GlimmarkElementCapabilities_EnumInstances";
constexpr auto getInstance = "GlimmarkElementCapabilities_GetInstance";

const std::string noDevicePaths =
    "***Can't get Glimmark ObjectPaths." + blanks(13) + "Exiting EnumerateInstanceNames***";

class ElementCapabilitiesInstances : public Fixture
{
protected:
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

    /// A path that enumerating the names answered, as that of a request of its own.
    CMPIObjectPath* refToName(std::size_t index)
    {
        newRequest();
        const cim::ObjectPath path = answer(enumerateNames(ref(association))).paths.at(index);
        newRequest();
        RecordedComparisons::clear();
        CMPIObjectPath* const handle = request->path(path);
        broker.name(handle, "ref");
        return handle;
    }

    /// The making of the association path, the third one made.
    Texts makingOfTheAssociationPath() const { return makingOfAPath(association, "path3"); }

    /// The builder's steps for the only indicator. \param list  the property list as recorded
    Texts building(const std::string& list) const
    {
        return joined(Texts{"ENTERING glimmarkElementCapabilitiesCMPIInstances"}, collection,
                      makingOfTheDevicePath("path1"), settingOfTheNamespace("path1"),
                      makingOfTheCapabilitiesPath("path2"), settingOfTheNamespace("path2"),
                      makingOfTheAssociationPath(),
                      Texts{"newInstance(path3, null)",
                            "setPropertyFilter(instance1, " + list + ", [Antecedent Dependent])",
                            "setProperty(instance1, \"ManagedElement\", path1, ref)",
                            "setProperty(instance1, \"Capabilities\", path2, ref)",
                            "EXITING glimmarkElementCapabilitiesCMPIInstances"});
    }

    CMPIInstanceMI* mi =
        GlimmarkElementCapabilitiesProvider_Create_InstanceMI(host.cmpiBroker(), nullptr, nullptr);
};

/// A call that fails while a single pair is built, and what is told of it.
struct PairFailure
{
    const char* name;
    const char* service;
    int nth;
    Failure failure;
    std::string statusText; ///< empty: the operation makes none itself
    std::string traceText;  ///< empty: the operation traces none itself
};

void PrintTo(const PairFailure& row, std::ostream* stream)
{
    *stream << row.name;
}

std::string nameOfRow(const ::testing::TestParamInfo<PairFailure>& row)
{
    return row.param.name;
}

/// What the operation itself tells the broker of a failure.
Texts reportOf(const PairFailure& row)
{
    Texts calls;
    if (!row.statusText.empty())
        calls.push_back(statusText(row.statusText));
    if (!row.traceText.empty())
        calls.push_back(warning(row.traceText));
    return calls;
}

// Keys are added to the device's path (1 to 4) and to that of the capabilities (5).
const PairFailure builderFailures[] = {
    {"DevicePathNotMade", "newObjectPath", 1, Failure::nullResult, "", noDevicePaths},
    {"DevicePathWithoutObject", "addKey", 4, Failure::lostHandle,
     "CMPIObjectPath is" + blanks(17) + "NULL for Glimmark", "CMPIObjectPath is NULL for Glimmark"},
    {"CapabilitiesPathNotMade", "newObjectPath", 2, Failure::nullResult, "",
     "***Can't get ObjectPaths for" + blanks(17) + "Capabilities" + blanks(17) +
         "Exiting EnumerateInstanceNames***"},
    {"DevicePathWithoutObjectAtThePair", "setNameSpace", 2, Failure::lostHandle,
     "CMPIObjectPath is" + blanks(21) + "NULL for Capabilities", "CMPIObjectPath is NULL for Capabilities"},
    {"AssociationPathNull", "newObjectPath", 3, Failure::nullResult,
     "Create CMPIObjectPath failed for ElementCapabilities",
     "Create CMPIObjectPath failed for ElementCapabilities."},
    {"AssociationPathWithoutObject", "newObjectPath", 3, Failure::noHandle,
     "Create CMPIObjectPath failed for ElementCapabilities",
     "Create CMPIObjectPath failed for ElementCapabilities."},
    {"AssociationPathRefused", "newObjectPath", 3, Failure::errorStatus,
     "Create CMPIObjectPath failed for ElementCapabilities",
     "Create CMPIObjectPath failed for ElementCapabilities."},
};

const PairFailure nameFailures[] = {
    {"DevicePathWithoutObject", "addKey", 4, Failure::lostHandle, "CMPIObjectPath is NULL for Glimmark class",
     "CMPIObjectPath is NULL for Glimmark class"},
    {"CapabilitiesPathWithoutObject", "addKey", 5, Failure::lostHandle,
     "CMPIObjectPath is" + blanks(21) + "NULL for GlimmarkCapabilities",
     "CMPIObjectPath is NULL for" + blanks(21) + "Capabilities"},
    {"AssociationPathNull", "newObjectPath", 3, Failure::nullResult,
     "Create CMPIObjectPath failed" + blanks(21) + "for ElementCapabilities",
     "Create CMPIObjectPath failed" + blanks(21) + "for ElementCapabilities."},
    {"AssociationPathWithoutObject", "newObjectPath", 3, Failure::noHandle,
     "Create CMPIObjectPath failed" + blanks(21) + "for ElementCapabilities",
     "Create CMPIObjectPath failed" + blanks(21) + "for ElementCapabilities."},
    {"AssociationPathRefused", "newObjectPath", 3, Failure::errorStatus,
     "Create CMPIObjectPath failed" + blanks(21) + "for ElementCapabilities",
     "Create CMPIObjectPath failed" + blanks(21) + "for ElementCapabilities."},
};

class ElementCapabilitiesBuilderFailures : public ElementCapabilitiesInstances,
                                           public ::testing::WithParamInterface<PairFailure>
{};

class ElementCapabilitiesNameFailures : public ElementCapabilitiesInstances,
                                        public ::testing::WithParamInterface<PairFailure>
{};

INSTANTIATE_TEST_SUITE_P(Every, ElementCapabilitiesBuilderFailures, ::testing::ValuesIn(builderFailures),
                         nameOfRow);
INSTANTIATE_TEST_SUITE_P(Every, ElementCapabilitiesNameFailures, ::testing::ValuesIn(nameFailures),
                         nameOfRow);

} // namespace

// EnumInstanceNames

TEST_F(ElementCapabilitiesInstances, NamesComeAboutByTheseStepsInThisOrder)
{
    const CMPIStatus status = enumerateNames(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(timeline(),
                ElementsAreArray(
                    joined(Texts{"ENTERING GlimmarkElementCapabilities_EnumInstanceNames"}, collection,
                           makingOfTheDevicePath("path1"), settingOfTheNamespace("path1"),
                           makingOfTheCapabilitiesPath("path2"), settingOfTheNamespace("path2"),
                           makingOfTheAssociationPath(),
                           Texts{"addKey(path3, \"ManagedElement\", path1, ref)",
                                 "addKey(path3, \"Capabilities\", path2, ref)", "returnObjectPath(path3)",
                                 "EXITING GlimmarkElementCapabilities_EnumInstanceNames", "returnDone()"})));
}

TEST_F(ElementCapabilitiesInstances, NamesPairEachIndicatorWithTheCapabilities)
{
    MadeInventory::set({{"b", "2"}, {"c", "3"}, {"a", "1"}});
    const auto paths = answer(enumerateNames(ref(association))).paths;
    EXPECT_THAT(valuesOf(paths, "ManagedElement"),
                ElementsAre(deviceText("a:/1"), deviceText("b:/2"), deviceText("c:/3")));
    EXPECT_THAT(valuesOf(paths, "Capabilities"), Each(capabilitiesText));
    for (const auto& path : paths) {
        EXPECT_EQ(path.className, association);
        EXPECT_EQ(path.nameSpace, "root/test");
        EXPECT_EQ(path.host, Tavro::getSystemName());
        EXPECT_THAT(path.keys, SizeIs(2));
    }
    EXPECT_THAT(broker.calls(resultServices), SizeIs(4));
    EXPECT_THAT(Logged::linesOf("getAllGlimmarkCapabilitiesCMPIObjPaths"), SizeIs(6))
        << "fetched anew for each indicator";
}

TEST_F(ElementCapabilitiesInstances, NamesAreTraced)
{
    const CMPIObjectPath* const path = ref(association);
    enumerateNames(path);
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path);
    EXPECT_THAT(Logged::linesOf(enumInstanceNames),
                ElementsAre(Logged::line(module, "ENTERING", enumInstanceNames, parameters),
                            Logged::line(module, "EXITING", enumInstanceNames, parameters)));
}

TEST_F(ElementCapabilitiesInstances, NamesOfAnEmptyInventoryEndWithoutDoneAndExit)
{
    MadeInventory::set({});
    const CMPIStatus status = enumerateNames(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls(),
                ElementsAre("trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)"));
    EXPECT_THAT(Logged::linesOf(enumInstanceNames), SizeIs(1));
}

TEST_F(ElementCapabilitiesInstances, NamesWithoutTheFactorysPathsEndWithTheFactorysReportOnly)
{
    struct Row
    {
        int nthPath;
        const char* message;
        const char* component;
    };
    for (const Row& row : {Row{1, "Create CMPIObjectPath failed.", "GlimmarkProfileProvider"},
                           Row{2, "Create CMPIObjectPath failed", "GlimmarkCapabilitiesProvider"}}) {
        clearRecords();
        broker.fail("newObjectPath", row.nthPath, Failure::nullResult);
        const CMPIStatus status = enumerateNames(ref(association));
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(message(status), row.message);
        EXPECT_THAT(broker.calls({"trace"}),
                    ElementsAre(StartsWith("trace(2, \"" + std::string(row.component) + "\", ")));
        EXPECT_THAT(broker.calls(resultServices), IsEmpty());
        EXPECT_THAT(Logged::linesOf(enumInstanceNames), SizeIs(1));
    }
}

TEST_P(ElementCapabilitiesNameFailures, AreReportedAndEndTheOperationWithoutDoneAndExit)
{
    broker.fail(GetParam().service, GetParam().nth, GetParam().failure);
    const CMPIStatus status = enumerateNames(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), GetParam().statusText);
    EXPECT_THAT(broker.calls(reports), ElementsAreArray(reportOf(GetParam())));
    EXPECT_EQ(broker.calls().back(), warning(GetParam().traceText)) << "nothing after it";
    EXPECT_THAT(broker.calls(resultServices), IsEmpty());
    EXPECT_THAT(Logged::linesOf(enumInstanceNames), SizeIs(1));
}

TEST_F(ElementCapabilitiesInstances, NamesBeforeAFailureHaveBeenReturned)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    // Two devices, capabilities and association of the first, capabilities and association of the second.
    broker.fail("newObjectPath", 6, Failure::nullResult);
    const CMPIStatus status = enumerateNames(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(valuesOf(answer(status).paths, "ManagedElement"), ElementsAre(deviceText("a:/1")));
    EXPECT_THAT(broker.calls(resultServices), SizeIs(1)) << "no returnDone";
}

TEST_F(ElementCapabilitiesInstances, NamesDoNotCheckTheIndicatorAgainAtThePair)
{
    broker.fail("setNameSpace", 2, Failure::lostHandle);
    EXPECT_EQ(enumerateNames(ref(association)).rc, CMPI_RC_OK);
    EXPECT_THAT(lastOf(broker.calls(), 4), ElementsAre("addKey(path3, \"ManagedElement\", path1, ref)",
                                                       "addKey(path3, \"Capabilities\", path2, ref)",
                                                       "returnObjectPath(path3)", "returnDone()"));
}

TEST_F(ElementCapabilitiesInstances, NamesKeepTheStatusThatTheBrokersCallsLeave)
{
    // Twice for each of the factory's paths and after it, then twice for the association's: the last one.
    broker.fail("getNameSpace", 8, Failure::errorStatus);
    const CMPIStatus status = enumerateNames(ref(association));
    EXPECT_EQ(broker.calls({"getNameSpace"}).size(), 8U);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnObjectPath(path3)", "returnDone()"));
}

// EnumInstances

TEST_F(ElementCapabilitiesInstances, InstancesComeAboutByTheseStepsInThisOrder)
{
    const CMPIStatus status = enumerate(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(timeline(), ElementsAreArray(joined(
                                Texts{"ENTERING GlimmarkElementCapabilities_EnumInstances"}, building("null"),
                                Texts{"returnInstance(instance1)",
                                      "EXITING GlimmarkElementCapabilities_EnumInstances", "returnDone()"})));
}

TEST_F(ElementCapabilitiesInstances, InstancesPairEachIndicatorWithTheCapabilities)
{
    MadeInventory::set({{"b", "2"}, {"c", "3"}, {"a", "1"}});
    const auto instances = answer(enumerate(ref(association))).instances;
    EXPECT_THAT(valuesOf(instances, "ManagedElement"),
                ElementsAre(deviceText("a:/1"), deviceText("b:/2"), deviceText("c:/3")));
    EXPECT_THAT(valuesOf(instances, "Capabilities"), Each(capabilitiesText));
    for (const auto& instance : instances) {
        EXPECT_EQ(instance.path.className, association);
        EXPECT_EQ(instance.path.nameSpace, "root/test");
        EXPECT_EQ(instance.path.host, Tavro::getSystemName());
        EXPECT_THAT(namesOf(instance), ElementsAre("ManagedElement", "Capabilities"));
    }
    EXPECT_THAT(broker.calls(resultServices),
                ElementsAre("returnInstance(instance1)", "returnInstance(instance2)",
                            "returnInstance(instance3)", "returnDone()"));
    EXPECT_THAT(Logged::linesOf("getAllGlimmarkCapabilitiesCMPIObjPaths"), SizeIs(6))
        << "fetched anew for each indicator";
}

TEST_F(ElementCapabilitiesInstances, ThePropertyListIsTheInstancesFilterAndNothingElse)
{
    PropertyNames properties{"Capabilities"};
    const auto instances = answer(enumerate(ref(association), properties)).instances;
    EXPECT_THAT(broker.calls({"setPropertyFilter"}),
                ElementsAre("setPropertyFilter(instance1, [Capabilities], [Antecedent Dependent])"));
    EXPECT_THAT(broker.calls({"setProperty"}), SizeIs(2)) << "both are set whatever was asked for";
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("Capabilities"));
}

TEST_F(ElementCapabilitiesInstances, InstancesAreTracedWithTwoLabelsThatLackTheEqualsSign)
{
    const CMPIObjectPath* const path = ref(association);
    PropertyNames properties{"Capabilities"};
    const char** const list = properties;
    enumerate(path, list);
    const auto parameters =
        Logged::parameters(" mi", mi, " ctx=", ctx(), " result=", rslt(), " ref=", path, " properties", list);
    EXPECT_THAT(Logged::linesOf(enumInstances),
                ElementsAre(Logged::line(module, "ENTERING", enumInstances, parameters),
                            Logged::line(module, "EXITING", enumInstances, parameters)));
}

TEST_F(ElementCapabilitiesInstances, TheBuilderIsTraced)
{
    const CMPIObjectPath* const path = ref(association);
    PropertyNames properties{"Capabilities"};
    const char** const list = properties;
    enumerate(path, list);
    const auto lines = Logged::linesOf(builder);
    ASSERT_THAT(lines, SizeIs(2));
    // The address of the list of instances is known to the operation alone.
    const auto parameters = Logged::parameters(" ref=", path, " properties=", list, " instances=") + "0x";
    EXPECT_THAT(lines[0], StartsWith(Logged::line(module, "ENTERING", builder, parameters)));
    EXPECT_THAT(lines[1], StartsWith(Logged::line(module, "EXITING", builder, parameters)));
}

TEST_F(ElementCapabilitiesInstances, InstancesOfAnEmptyInventoryAreNoneAndDone)
{
    MadeInventory::set({});
    const CMPIStatus status = enumerate(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(lastOf(timeline(), 5),
                ElementsAre("ENTERING getAllGlimmarkCMPIObjPaths",
                            "trace(1, \"GlimmarkProfileProvider\", \"***No instance found***\", null)",
                            warning(noDevicePaths), "EXITING GlimmarkElementCapabilities_EnumInstances",
                            "returnDone()"));
    EXPECT_THAT(Logged::linesOf(builder), SizeIs(1));
}

TEST_P(ElementCapabilitiesBuilderFailures, AreReportedAndAnsweredAsAnEmptySuccess)
{
    broker.fail(GetParam().service, GetParam().nth, GetParam().failure);
    const CMPIStatus status = enumerate(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    const Texts report = reportOf(GetParam());
    EXPECT_THAT(lastOf(broker.calls(reports), report.size()), ElementsAreArray(report));
    EXPECT_THAT(
        lastOf(timeline(), 3),
        ElementsAre(report.back(), "EXITING GlimmarkElementCapabilities_EnumInstances", "returnDone()"));
    EXPECT_THAT(Logged::linesOf(builder), SizeIs(1)) << "no EXITING line of the builder";
}

TEST_P(ElementCapabilitiesBuilderFailures, MakeAGetInstanceFindNothing)
{
    const CMPIObjectPath* const path = refToName(0);
    broker.fail(GetParam().service, GetParam().nth, GetParam().failure);
    const CMPIStatus status = get(path);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(lastOf(timeline(), 3),
                ElementsAre(reportOf(GetParam()).back(), "EXITING GlimmarkElementCapabilities_GetInstance",
                            "returnDone()"));
}

TEST_F(ElementCapabilitiesInstances, TheFactorysReportStandsBeforeTheBuilders)
{
    broker.fail("newObjectPath", 2, Failure::nullResult);
    enumerate(ref(association));
    EXPECT_THAT(broker.calls(reports),
                ElementsAre("newString(\"Create CMPIObjectPath failed\", null)",
                            StartsWith("trace(2, \"GlimmarkCapabilitiesProvider\", "),
                            StartsWith("trace(2, \"GlimmarkElementCapabilitiesProvider\", ")));
}

TEST_F(ElementCapabilitiesInstances, NoInstanceIsReturnedWhenALaterOneFails)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    broker.fail("newObjectPath", 6, Failure::nullResult);
    EXPECT_EQ(enumerate(ref(association)).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls({"newInstance"}), SizeIs(1)) << "the first was made";
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnDone()"));
}

TEST_F(ElementCapabilitiesInstances, ACapabilitiesPathWithoutAnObjectBehindItIsNotDetected)
{
    broker.fail("addKey", 5, Failure::lostHandle);
    EXPECT_EQ(enumerate(ref(association)).rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(reports), IsEmpty());
    EXPECT_THAT(lastOf(broker.calls(), 3), ElementsAre("setProperty(instance1, \"Capabilities\", path2, ref)",
                                                       "returnInstance(instance1)", "returnDone()"));
}

TEST_F(ElementCapabilitiesInstances, InstancesThatCouldNotBeMadeAreHandedOn)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        newRequest();
        broker.fail("newInstance", 1, failure);
        EXPECT_EQ(enumerate(ref(association)).rc, CMPI_RC_OK);
        EXPECT_THAT(broker.calls({"setPropertyFilter", "setProperty"}), SizeIs(3)) << "of the other alone";
        EXPECT_THAT(
            broker.calls(resultServices),
            ElementsAre(failure == Failure::nullResult ? "returnInstance(null)" : "returnInstance(instance2)",
                        "returnInstance(instance1)", "returnDone()"));
        EXPECT_THAT(Logged::linesOf(builder), SizeIs(2));
    }
}

TEST_F(ElementCapabilitiesInstances, InstancesHideTheStatusThatTheBrokersCallsLeave)
{
    broker.fail("getNameSpace", 8, Failure::errorStatus);
    const CMPIStatus status = enumerate(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
}

// GetInstance

TEST_F(ElementCapabilitiesInstances, GetNeedsAKey)
{
    const CMPIStatus status = get(ref(association));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "At least one key should be passed");
    EXPECT_THAT(timeline(),
                ElementsAre("ENTERING GlimmarkElementCapabilities_GetInstance", "getKeyCount(ref, rc)",
                            "newString(\"At least one key should be passed\", null)",
                            warning("At least one key should be passed"),
                            "EXITING GlimmarkElementCapabilities_GetInstance", "returnDone()"));
}

TEST_F(ElementCapabilitiesInstances, GetTakesTheseStepsInThisOrder)
{
    const CMPIObjectPath* const path = refToName(0);
    const CMPIStatus status = get(path);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    Texts steps = timeline();
    // How the two paths are compared is the support library's matter.
    const auto comparison = std::find(steps.begin(), steps.end(), "getObjectPath(instance1, rc)");
    ASSERT_NE(comparison, steps.end());
    steps.erase(comparison + 1, std::max(comparison + 1, steps.end() - 3));
    EXPECT_THAT(steps, ElementsAreArray(joined(
                           Texts{"ENTERING GlimmarkElementCapabilities_GetInstance", "getKeyCount(ref, rc)"},
                           building("null"),
                           Texts{"getObjectPath(instance1, rc)", "returnInstance(instance1)",
                                 "EXITING GlimmarkElementCapabilities_GetInstance", "returnDone()"})));
}

TEST_F(ElementCapabilitiesInstances, GetAnswersTheFirstEqualPathAndLooksNoFurther)
{
    MadeInventory::set({{"b", "2"}, {"c", "3"}, {"a", "1"}});
    const CMPIObjectPath* const path = refToName(1);
    const auto instances = answer(get(path)).instances;
    EXPECT_THAT(valuesOf(instances, "ManagedElement"), ElementsAre(deviceText("b:/2")));
    EXPECT_THAT(valuesOf(instances, "Capabilities"), ElementsAre(capabilitiesText));
    EXPECT_THAT(broker.calls({"getObjectPath", "returnInstance", "returnDone"}),
                ElementsAre("getObjectPath(instance1, rc)", "getObjectPath(instance2, rc)",
                            "returnInstance(instance2)", "returnDone()"));
}

TEST_F(ElementCapabilitiesInstances, GetComparesTheRequestsPathWithEachInReferencesToo)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    const CMPIObjectPath* const path = refToName(1);
    get(path);
    const auto comparisons = RecordedComparisons::all();
    ASSERT_THAT(comparisons, SizeIs(2));
    for (const auto& comparison : comparisons) {
        EXPECT_EQ(comparison.first, path);
        EXPECT_TRUE(comparison.deep);
    }
    EXPECT_TRUE(comparisons[1].equal);
}

TEST_F(ElementCapabilitiesInstances, GetTakesThePropertyList)
{
    const CMPIObjectPath* const path = refToName(0);
    PropertyNames properties{"ManagedElement"};
    const auto instances = answer(get(path, properties)).instances;
    ASSERT_THAT(instances, SizeIs(1));
    EXPECT_THAT(namesOf(instances[0]), ElementsAre("ManagedElement"));
    EXPECT_THAT(broker.calls({"setPropertyFilter"}),
                ElementsAre("setPropertyFilter(instance1, [ManagedElement], [Antecedent Dependent])"));
}

TEST_F(ElementCapabilitiesInstances, GetIsTraced)
{
    const CMPIObjectPath* const path = refToName(0);
    PropertyNames properties{"ManagedElement"};
    const char** const list = properties;
    get(path, list);
    const auto parameters = Logged::parameters(" mi=", mi, " ctx=", ctx(), " result=", rslt(), " cop=", path,
                                               " properties=", list);
    EXPECT_THAT(Logged::linesOf(getInstance),
                ElementsAre(Logged::line(module, "ENTERING", getInstance, parameters),
                            Logged::line(module, "EXITING", getInstance, parameters)));
    EXPECT_THAT(Logged::linesOf(builder),
                Contains(StartsWith(Logged::line(module, "ENTERING", builder,
                                                 Logged::parameters(" ref=", path, " properties=", list)))));
}

TEST_F(ElementCapabilitiesInstances, GetOfAnAssociationThatDoesNotExistIsAnEmptySuccess)
{
    const CMPIStatus status = get(ref(association, {{"ManagedElement", "a"}, {"Capabilities", "b"}}));
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(message(status), std::nullopt);
    EXPECT_THAT(broker.calls({"getObjectPath", "returnInstance", "returnDone"}),
                ElementsAre("getObjectPath(instance1, rc)", "returnDone()"));
    EXPECT_THAT(broker.calls(reports), IsEmpty());
    EXPECT_THAT(Logged::linesOf(getInstance), SizeIs(2));
}

TEST_F(ElementCapabilitiesInstances, GetInAnEmptyInventoryIsAnEmptySuccess)
{
    MadeInventory::set({});
    EXPECT_EQ(get(ref(association, {{"ManagedElement", "a"}})).rc, CMPI_RC_OK);
    EXPECT_THAT(lastOf(timeline(), 3),
                ElementsAre(warning(noDevicePaths), "EXITING GlimmarkElementCapabilities_GetInstance",
                            "returnDone()"));
}

TEST_F(ElementCapabilitiesInstances, GetPassesOverWhatCouldNotBeMade)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    for (const Failure failure : {Failure::nullResult, Failure::noHandle}) {
        const CMPIObjectPath* const path = refToName(1);
        broker.fail("newInstance", 1, failure);
        EXPECT_EQ(get(path).rc, CMPI_RC_OK);
        EXPECT_THAT(broker.calls({"getObjectPath", "returnInstance", "returnDone"}),
                    ElementsAre("getObjectPath(instance1, rc)", "returnInstance(instance1)", "returnDone()"));
    }
}

TEST_F(ElementCapabilitiesInstances, GetKeepsTheStatusThatGetObjectPathLeaves)
{
    const CMPIObjectPath* const path = refToName(0);
    broker.fail("getObjectPath", 1, Failure::errorStatus);
    const CMPIStatus status = get(path);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(status), "injected");
    EXPECT_THAT(broker.calls(resultServices), ElementsAre("returnDone()"));
}

} // namespace ElementCapabilities::InstancesTests
