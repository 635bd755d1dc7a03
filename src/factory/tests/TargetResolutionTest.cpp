// The far end of an association: its class, and the class path that the traversals start from.

#include "GlimmarkFactory.h"
#include "Names.h"
#include "testing/ProviderFixture.h"

#include <Tavro/Common.h>

#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <dlfcn.h>

namespace TargetResolutionTests {

using Tavro::GlimmarkProvider::GlimmarkFactory;
using ::testing::Contains;
using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::ElementsAreArray;
using ::testing::IsEmpty;
using ::testing::Not;

namespace {

constexpr auto module = "GlimmarkObjFactory";
const std::string forName = "get_assoc_targetClass_Name";
const std::string forPath = "get_assoc_targetClass_ObjectPath";

class TargetResolution : public ProviderFixture
{
protected:
    const char* nameFrom(const CMPIObjectPath* from, const char* assocClass,
                         const char* resultClass = nullptr)
    {
        return factory.get_assoc_targetClass_Name(host.cmpiBroker(), from, assocClass, resultClass, &rc);
    }
    CMPIObjectPath* pathFrom(const CMPIObjectPath* from, const char* assocClass,
                             const char* resultClass = nullptr)
    {
        return factory.get_assoc_targetClass_ObjectPath(host.cmpiBroker(), from, assocClass, resultClass,
                                                        &rc);
    }

    /// Both functions' parameter list, with the fixture's status.
    std::string parameters(const CMPIObjectPath* from, const char* assocClass, const char* resultClass)
    {
        return Logged::parameters(" broker=", host.cmpiBroker(), " ref=", from, " _RefLeftClass=", assocClass,
                                  " _RefRightClass=", resultClass, " rc=", &rc);
    }

    // Without any record: the resolution reads none.
    const GlimmarkFactory factory;
    CMPIStatus rc = {CMPI_RC_OK, nullptr};
};

/// One way through an association.
struct Way
{
    const char* name;
    const char* from;
    const char* assocClass;
    const char* to;
    /// Which of the four ways it is: for each one tested, the class of the path is read.
    int position;
    const char* trace;
};

void PrintTo(const Way& way, std::ostream* stream)
{
    *stream << way.name;
}

class KnownWays : public TargetResolution, public ::testing::WithParamInterface<Way>
{
protected:
    const char* assocClass = GetParam().assocClass;
};

INSTANTIATE_TEST_SUITE_P(
    , KnownWays,
    ::testing::Values(
        Way{"SystemToDevice", "TAVRO_ComputerSystem", "TAVRO_GlimmarkSystemDevice", "TAVRO_Glimmark", 1,
            R"(trace(1, "GlimmarkSystemDeviceProvider", "Target Class is GlimmarkClass", null))"},
        Way{"DeviceToSystem", "TAVRO_Glimmark", "TAVRO_GlimmarkSystemDevice", "TAVRO_ComputerSystem", 2,
            R"(trace(1, "GlimmarkSystemDeviceProvider", )"
            R"("Target Class is ComputerSystemClass", null))"},
        Way{"DeviceToCapabilities", "TAVRO_Glimmark", "TAVRO_GlimmarkElementCapabilities",
            "TAVRO_GlimmarkCapabilities", 3,
            R"(trace(1, "GlimmarkElementCapabilitiesProvider", )"
            R"("Target Class is GlimmarkCapabilitiesClass", null))"},
        Way{"CapabilitiesToDevice", "TAVRO_GlimmarkCapabilities", "TAVRO_GlimmarkElementCapabilities",
            "TAVRO_Glimmark", 4,
            R"(trace(1, "GlimmarkElementCapabilitiesProvider", )"
            R"("Target Class is GlimmarkClass", null))"}),
    [](const auto& test) { return test.param.name; });

/// A class and an association that does not start from it.
struct NoWay
{
    const char* name;
    const char* from;
    const char* assocClass;
};

void PrintTo(const NoWay& noWay, std::ostream* stream)
{
    *stream << noWay.name;
}

class UnknownWays : public TargetResolution, public ::testing::WithParamInterface<NoWay>
{};

INSTANTIATE_TEST_SUITE_P(
    , UnknownWays,
    ::testing::Values(
        NoWay{"CapabilitiesToSystem", "TAVRO_GlimmarkCapabilities", "TAVRO_GlimmarkSystemDevice"},
        NoWay{"SystemToCapabilities", "TAVRO_ComputerSystem", "TAVRO_GlimmarkElementCapabilities"},
        NoWay{"SourceInSmallLetters", "tavro_glimmark", "TAVRO_GlimmarkSystemDevice"},
        NoWay{"SourceInCapitals", "TAVRO_GLIMMARK", "TAVRO_GlimmarkElementCapabilities"},
        NoWay{"BaseOfTheDevice", "CIM_AlarmDevice", "TAVRO_GlimmarkElementCapabilities"},
        NoWay{"BaseOfTheSystem", "CIM_ComputerSystem", "TAVRO_GlimmarkSystemDevice"},
        NoWay{"LongerSource", "TAVRO_GlimmarkX", "TAVRO_GlimmarkSystemDevice"},
        NoWay{"ShorterSource", "TAVRO_Glimmar", "TAVRO_GlimmarkSystemDevice"},
        NoWay{"AssociationItself", "TAVRO_GlimmarkSystemDevice", "TAVRO_GlimmarkSystemDevice"},
        NoWay{"AssociationInSmallLetters", "TAVRO_Glimmark", "tavro_glimmarksystemdevice"},
        NoWay{"BaseOfTheAssociation", "TAVRO_Glimmark", "CIM_SystemDevice"},
        NoWay{"EmptyAssociation", "TAVRO_Glimmark", ""}, NoWay{"NoAssociation", "TAVRO_Glimmark", nullptr}),
    [](const auto& test) { return test.param.name; });

/// A constant of the library's own, which this program has another of. \param name  mangled
const void* libraryConstant(const std::string& name)
{
    void* const library = dlopen("libGlimmarkProvider.so", RTLD_NOW | RTLD_NOLOAD);
    const void* const constant = dlsym(library, ("_ZN5Tavro16GlimmarkProvider" + name + "E").c_str());
    EXPECT_NE(constant, nullptr) << name;
    dlclose(library);
    return constant;
}

} // namespace

// The class

TEST_P(KnownWays, LeadToTheClassOfTheFarEnd)
{
    EXPECT_STREQ(nameFrom(ref(GetParam().from), assocClass), GetParam().to);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(rc.msg, nullptr);
}

TEST_P(KnownWays, AnswerOneOfTheConstantsAndNoCopy)
{
    const void* const name = nameFrom(ref(GetParam().from), assocClass);
    EXPECT_TRUE(name == libraryConstant("13GlimmarkClass") ||
                name == libraryConstant("19ComputerSystemClass") ||
                name == libraryConstant("25GlimmarkCapabilitiesClass"));
}

TEST_P(KnownWays, ReadTheSourceClassForEachWayTestedAndTellTheBrokerBeforeTheyEnd)
{
    const std::string from = GetParam().from;
    nameFrom(ref(from), assocClass);
    std::vector<std::string> expected{"ENTERING " + forName};
    for (int way = 1; way <= GetParam().position; ++way) {
        expected.emplace_back("getClassName(ref, rc)");
        expected.push_back("getCharPtr(\"" + from + "\", rc)");
    }
    expected.emplace_back(GetParam().trace);
    expected.push_back("EXITING " + forName);
    EXPECT_THAT(timeline(), ElementsAreArray(expected));
}

TEST_P(KnownWays, DoNotDependOnTheResultClass)
{
    for (const char* resultClass : {"", "TAVRO_Glimmark", "TAVRO_ComputerSystem", "CIM_ManagedElement"})
        EXPECT_STREQ(nameFrom(ref(GetParam().from), assocClass, resultClass), GetParam().to) << resultClass;
}

TEST_P(KnownWays, AreTracedWithTheClassNamesAsTexts)
{
    const CMPIObjectPath* const from = ref(GetParam().from);
    nameFrom(from, assocClass, "CIM_LogicalElement");
    const std::string list = parameters(from, assocClass, "CIM_LogicalElement");
    EXPECT_THAT(Logged::linesOf(forName), ElementsAre(Logged::line(module, "ENTERING", forName, list),
                                                      Logged::line(module, "EXITING", forName, list)));
    EXPECT_THAT(list, ::testing::HasSubstr(" _RefRightClass=CIM_LogicalElement rc=0x"));
}

TEST_P(KnownWays, EndTheParameterListAtANullResultClass)
{
    const CMPIObjectPath* const from = ref(GetParam().from);
    nameFrom(from, assocClass, nullptr);
    const std::string list = Logged::parameters(" broker=", host.cmpiBroker(), " ref=", from,
                                                " _RefLeftClass=", assocClass, " _RefRightClass=");
    EXPECT_THAT(Logged::linesOf(forName), ElementsAre(Logged::line(module, "ENTERING", forName, list),
                                                      Logged::line(module, "EXITING", forName, list)));
}

TEST_P(KnownWays, NeedNoStatus)
{
    const CMPIObjectPath* const from = ref(GetParam().from);
    EXPECT_STREQ(factory.get_assoc_targetClass_Name(host.cmpiBroker(), from, assocClass, nullptr, nullptr),
                 GetParam().to);
    EXPECT_THAT(broker.calls({"getClassName"}), Each("getClassName(ref, null)"));
}

TEST_P(KnownWays, AreKnownWithoutABrokerToTellItTo)
{
    const CMPIObjectPath* const from = ref(GetParam().from);
    EXPECT_STREQ(factory.get_assoc_targetClass_Name(nullptr, from, assocClass, nullptr, &rc), GetParam().to);
    EXPECT_THAT(broker.calls({"trace"}), IsEmpty());
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + forName, "EXITING " + forName));
}

TEST_P(UnknownWays, LeadNowhereWithoutATraceAndAnExit)
{
    const std::string from = GetParam().from;
    EXPECT_EQ(nameFrom(ref(from), GetParam().assocClass), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(rc.msg, nullptr);
    std::vector<std::string> expected{"ENTERING " + forName};
    for (int way = 1; way <= 4; ++way) {
        expected.emplace_back("getClassName(ref, rc)");
        expected.push_back("getCharPtr(\"" + from + "\", rc)");
    }
    EXPECT_THAT(timeline(), ElementsAreArray(expected));
}

TEST_F(TargetResolution, ANullAssociationClassEndsTheParameterList)
{
    const CMPIObjectPath* const from = ref("TAVRO_Glimmark");
    nameFrom(from, nullptr, "CIM_LogicalElement");
    const std::string list =
        Logged::parameters(" broker=", host.cmpiBroker(), " ref=", from, " _RefLeftClass=");
    EXPECT_THAT(Logged::linesOf(forName), ElementsAre(Logged::line(module, "ENTERING", forName, list)));
}

TEST_F(TargetResolution, ASourceClassThatCannotBeReadOnceCostsOneWayOnly)
{
    for (const char* service : {"getClassName", "getCharPtr"}) {
        for (const Failure failure : {Failure::nullResult, Failure::errorStatus}) {
            broker.fail(service, 1, failure);
            EXPECT_STREQ(nameFrom(ref("TAVRO_Glimmark"), "TAVRO_GlimmarkSystemDevice"),
                         "TAVRO_ComputerSystem")
                << "the second way";
            broker.fail(service, 1, failure);
            EXPECT_EQ(nameFrom(ref("TAVRO_ComputerSystem"), "TAVRO_GlimmarkSystemDevice"), nullptr)
                << "the first way was missed";
        }
    }
}

TEST_F(TargetResolution, TheStatusOfTheLastReadingStays)
{
    broker.fail("getClassName", 4, Failure::errorStatus);
    EXPECT_EQ(nameFrom(ref("CIM_AlarmDevice"), "TAVRO_GlimmarkSystemDevice"), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(rc), "injected");
    EXPECT_THAT(broker.calls({"newString", "trace"}), IsEmpty());
}

TEST_F(TargetResolution, ANullSourceLeadsNowhere)
{
    EXPECT_EQ(nameFrom(nullptr, "TAVRO_GlimmarkSystemDevice"), nullptr);
    EXPECT_EQ(pathFrom(nullptr, "TAVRO_GlimmarkSystemDevice"), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls(), IsEmpty());
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + forName, "ENTERING " + forPath,
                                            "ENTERING " + forName, "EXITING " + forPath));
}

// The class path

TEST_P(KnownWays, GiveAClassPathInTheRequestsTerms)
{
    const CMPIObjectPath* const path =
        pathFrom(ref(GetParam().from, {{"DeviceID", "a:/1"}}, "root/other"), assocClass);
    const auto read = cimhost::read(path);
    ASSERT_TRUE(read);
    EXPECT_EQ(read->className, GetParam().to);
    EXPECT_EQ(read->nameSpace, "root/other");
    EXPECT_EQ(read->host, Tavro::getSystemName());
    EXPECT_THAT(read->keys, IsEmpty());
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(rc.msg, nullptr);
}

TEST_F(TargetResolution, TheClassPathIsMadeWithTheNamespaceReadTwice)
{
    pathFrom(ref("TAVRO_ComputerSystem"), "TAVRO_GlimmarkSystemDevice");
    EXPECT_THAT(
        timeline(),
        ElementsAre("ENTERING " + forPath, "ENTERING " + forName, "getClassName(ref, rc)",
                    "getCharPtr(\"TAVRO_ComputerSystem\", rc)",
                    "trace(1, \"GlimmarkSystemDeviceProvider\", \"Target Class is GlimmarkClass\", null)",
                    "EXITING " + forName, "getNameSpace(ref, rc)", "getCharPtr(\"root/test\", rc)",
                    "newObjectPath(\"root/test\", \"TAVRO_Glimmark\", rc)", "getNameSpace(ref, rc)",
                    "getCharPtr(\"root/test\", rc)", "setNameSpace(path1, \"root/test\")",
                    "setHostname(path1, \"" + Tavro::getSystemName() + "\")", "EXITING " + forPath));
}

TEST_F(TargetResolution, TheClassPathIsTracedWithTheSameParameters)
{
    const CMPIObjectPath* const from = ref("TAVRO_Glimmark");
    pathFrom(from, "TAVRO_GlimmarkSystemDevice", "CIM_System");
    const std::string list = parameters(from, "TAVRO_GlimmarkSystemDevice", "CIM_System");
    EXPECT_THAT(Logged::linesOf(forPath), ElementsAre(Logged::line(module, "ENTERING", forPath, list),
                                                      Logged::line(module, "EXITING", forPath, list)));
    EXPECT_THAT(Logged::linesOf(forName), ElementsAre(Logged::line(module, "ENTERING", forName, list),
                                                      Logged::line(module, "EXITING", forName, list)))
        << "the same five arguments";
}

TEST_F(TargetResolution, ANullResultClassEndsTheListOfTheClassPathToo)
{
    const CMPIObjectPath* const from = ref("TAVRO_Glimmark");
    pathFrom(from, "TAVRO_GlimmarkSystemDevice");
    const std::string list =
        Logged::parameters(" broker=", host.cmpiBroker(), " ref=", from,
                           " _RefLeftClass=", "TAVRO_GlimmarkSystemDevice", " _RefRightClass=");
    EXPECT_THAT(Logged::linesOf(forPath), ElementsAre(Logged::line(module, "ENTERING", forPath, list),
                                                      Logged::line(module, "EXITING", forPath, list)));
}

TEST_P(UnknownWays, GiveNoClassPathButAnExit)
{
    EXPECT_EQ(pathFrom(ref(GetParam().from), GetParam().assocClass), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_THAT(broker.calls({"getNameSpace", "newObjectPath", "setNameSpace", "setHostname"}), IsEmpty());
    EXPECT_THAT(Logged::flow(),
                ElementsAre("ENTERING " + forPath, "ENTERING " + forName, "EXITING " + forPath));
}

TEST_F(TargetResolution, AClassPathThatTheBrokerDidNotMakeIsLeftAlone)
{
    broker.fail("newObjectPath", 1, Failure::errorStatus);
    EXPECT_EQ(pathFrom(ref("TAVRO_Glimmark"), "TAVRO_GlimmarkSystemDevice"), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(message(rc), "injected") << "the broker's own words";
    EXPECT_THAT(broker.calls({"setNameSpace", "setHostname", "newString"}), IsEmpty());
    EXPECT_EQ(Logged::flow().back(), "EXITING " + forPath);
}

TEST_F(TargetResolution, ANullClassPathWithoutAnErrorIsNone)
{
    broker.fail("newObjectPath", 1, Failure::nullResult);
    EXPECT_EQ(pathFrom(ref("TAVRO_Glimmark"), "TAVRO_GlimmarkSystemDevice"), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(rc.msg, nullptr);
    EXPECT_THAT(broker.calls({"setNameSpace", "setHostname", "newString"}), IsEmpty());
}

TEST_F(TargetResolution, AClassPathWithoutAHandleIsHandedOn)
{
    broker.fail("newObjectPath", 1, Failure::noHandle);
    const CMPIObjectPath* const path = pathFrom(ref("TAVRO_Glimmark"), "TAVRO_GlimmarkSystemDevice");
    ASSERT_NE(path, nullptr);
    EXPECT_EQ(path->hdl, nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(TargetResolution, ANamespaceThatCannotBeReadIsTheBrokersMatter)
{
    broker.fail("getNameSpace", 1, Failure::errorStatus);
    broker.fail("getNameSpace", 2, Failure::errorStatus);
    pathFrom(ref("TAVRO_Glimmark"), "TAVRO_GlimmarkSystemDevice");
    EXPECT_THAT(broker.calls({"newObjectPath", "setNameSpace", "newString"}),
                Contains("newObjectPath(null, \"TAVRO_ComputerSystem\", rc)"));
    EXPECT_THAT(broker.calls({"newString"}), IsEmpty());
    EXPECT_EQ(Logged::flow().back(), "EXITING " + forPath);
}

TEST_F(TargetResolution, TheClassPathNeedsNoStatus)
{
    const CMPIObjectPath* const path = factory.get_assoc_targetClass_ObjectPath(
        host.cmpiBroker(), ref("TAVRO_Glimmark"), "TAVRO_GlimmarkElementCapabilities", nullptr, nullptr);
    ASSERT_NE(path, nullptr);
    EXPECT_THAT(broker.calls({"getClassName", "getNameSpace", "newObjectPath"}),
                Not(Contains(::testing::HasSubstr("rc"))));
}

TEST_F(TargetResolution, WithoutABrokerThereIsNoClassPath)
{
    EXPECT_EQ(factory.get_assoc_targetClass_ObjectPath(nullptr, ref("TAVRO_Glimmark"),
                                                       "TAVRO_GlimmarkSystemDevice", nullptr, &rc),
              nullptr);
    EXPECT_THAT(broker.calls({"newObjectPath", "setNameSpace", "setHostname", "trace"}), IsEmpty());
    EXPECT_THAT(Logged::flow(), ElementsAre("ENTERING " + forPath, "ENTERING " + forName,
                                            "EXITING " + forName, "EXITING " + forPath));
}

} // namespace TargetResolutionTests
