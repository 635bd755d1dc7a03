// What a graph shows of instances, whoever they come from.

#include "cli/Graph.h"

#include "cim/Values.h"

#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::cli;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace {

cim::ObjectPath pathOf(const std::string& className, const std::string& id)
{
    return {"", "root/cimv2", className, {{"DeviceID", cim::textValue(id)}}};
}

cim::Instance led(const std::string& id, std::uint64_t health)
{
    return {pathOf("CIM_Led", id),
            {{"DeviceID", cim::textValue(id)}, {"HealthState", cim::unsignedValue(health, CMPI_uint16)}}};
}

cim::Instance link(cim::Value left, cim::Value right)
{
    return {{"", "root/cimv2", "CIM_Link", {}}, {{"Left", std::move(left)}, {"Right", std::move(right)}}};
}

std::string graphOf(const cim::Instances& instances)
{
    Picture picture;
    for (const cim::Instance& instance : instances)
        addInstance(instance, false, picture);
    return dot("root/cimv2", picture);
}

TEST(Picture, takesAnInstanceWithTwoReferencesForAnEdge)
{
    Picture picture;
    addInstance(
        link(cim::referenceValue(pathOf("CIM_Led", "a")), cim::referenceValue(pathOf("CIM_Led", "b"))), true,
        picture);
    ASSERT_EQ(picture.edges.size(), 1U);
    EXPECT_EQ(picture.edges[0].className, "CIM_Link");
    EXPECT_EQ(picture.edges[0].from.role, "Left");
    EXPECT_EQ(picture.edges[0].to.role, "Right");
    EXPECT_EQ(picture.edges[0].to.path, pathOf("CIM_Led", "b"));
    EXPECT_THAT(picture.nodes, IsEmpty());
    EXPECT_THAT(picture.remarks, IsEmpty());
}

TEST(Picture, takesTheReferencesOfThePathWhereNoPropertyIsOne)
{
    Picture picture;
    const cim::Value end = cim::referenceValue(pathOf("CIM_Led", "a"));
    addInstance({{"", "root/cimv2", "CIM_Link", {{"Left", end}, {"Right", end}}}, {}}, true, picture);
    EXPECT_EQ(picture.edges.size(), 1U);
}

TEST(Picture, remarksOnAnAssociationThatLacksAnEnd)
{
    Picture picture;
    addInstance(link(cim::referenceValue(pathOf("CIM_Led", "a")), cim::nullValue(CMPI_ref)), true, picture);
    EXPECT_THAT(picture.edges, IsEmpty());
    EXPECT_THAT(picture.nodes, IsEmpty());
    EXPECT_THAT(picture.remarks,
                testing::ElementsAre("CIM_Link: an instance that does not refer to two objects"));
    EXPECT_THAT(dot("root/cimv2", picture),
                HasSubstr("\n    // CIM_Link: an instance that does not refer to two objects\n"));
}

TEST(Picture, takesAnythingElseForANode)
{
    Picture picture;
    addInstance(led("a", 5), false, picture);
    addInstance(link(cim::referenceValue(pathOf("CIM_Led", "a")), cim::nullValue(CMPI_ref)), false, picture);
    EXPECT_EQ(picture.nodes.size(), 2U);
    EXPECT_THAT(picture.remarks, IsEmpty());
}

struct HealthColour
{
    std::uint64_t health;
    const char* colour;
};

class HealthColours : public testing::TestWithParam<HealthColour>
{};

TEST_P(HealthColours, fillNodes)
{
    EXPECT_THAT(graphOf({led("a", GetParam().health)}),
                HasSubstr(std::string("fillcolor=") + GetParam().colour + "]"));
}

INSTANTIATE_TEST_SUITE_P(Dot, HealthColours,
                         testing::Values(HealthColour{0, "lightgrey"}, HealthColour{5, "palegreen"},
                                         HealthColour{10, "khaki"}, HealthColour{15, "sandybrown"},
                                         HealthColour{20, "sandybrown"}, HealthColour{25, "salmon"},
                                         HealthColour{30, "salmon"}));

TEST(Dot, leavesNodesWithoutAHealthWhite)
{
    EXPECT_THAT(graphOf({{pathOf("CIM_Thing", "a"), {}}}), HasSubstr("shape=box, fillcolor=white]"));
    EXPECT_THAT(graphOf({{pathOf("CIM_Thing", "a"), {{"HealthState", cim::nullValue(CMPI_uint16)}}}}),
                HasSubstr("shape=box, fillcolor=white]"));
}

TEST(Dot, shapesNodesByTheKindOfTheirClass)
{
    EXPECT_THAT(graphOf({{pathOf("CIM_ComputerSystem", "a"), {}}}), HasSubstr("shape=box3d"));
    EXPECT_THAT(graphOf({{pathOf("CIM_LedCapabilities", "a"), {}}}), HasSubstr("shape=note"));
}

TEST(Dot, callsNodesByTheirFirstNameThatIsNotEmpty)
{
    const cim::Value empty = cim::textValue("");
    EXPECT_THAT(graphOf({{pathOf("CIM_A", "a"), {{"Name", cim::textValue("N")}, {"ElementName", empty}}}}),
                HasSubstr(R"(label="N\nCIM_A")"));
    EXPECT_THAT(graphOf({{pathOf("CIM_A", "a"), {{"InstanceID", cim::textValue("I")}}}}),
                HasSubstr(R"(label="I\nCIM_A")"));
    EXPECT_THAT(graphOf({{pathOf("CIM_A", "a"), {}}}),
                HasSubstr(R"(label="root/cimv2:CIM_A.DeviceID=\"a\"\nCIM_A")"));
}

TEST(Dot, showsTheAlarmStateBesideTheHealth)
{
    cim::Instance lamp = led("a", 10);
    lamp.properties.push_back({"AlarmState", cim::unsignedValue(3, CMPI_uint16)});
    EXPECT_THAT(graphOf({lamp}), HasSubstr(R"(\nCIM_Led\nDegraded/Warning, alarm Alternating")"));
    lamp.properties.erase(lamp.properties.begin() + 1);
    EXPECT_THAT(graphOf({lamp}), HasSubstr(R"(\nCIM_Led\nalarm Alternating")"));
}

TEST(Dot, saysOnceWhatTheEdgesAre)
{
    const cim::Value a = cim::referenceValue(pathOf("CIM_Led", "a"));
    cim::Instance other = link(a, a);
    other.properties[0].name = "<Other>";
    const std::string graph = graphOf({led("a", 5), link(a, a), link(a, a), other});
    EXPECT_THAT(graph,
                HasSubstr("    label=<<font color=\"steelblue\">CIM_Link: Left \u2192 Right</font><br/>"
                          "<font color=\"darkorange\">CIM_Link: &lt;Other&gt; \u2192 Right</font><br/>>;\n"));
    EXPECT_THAT(graph, HasSubstr("\n    n0 -> n0 [color=steelblue];\n    n0 -> n0 [color=steelblue];\n"
                                 "    n0 -> n0 [color=darkorange];\n}"));
    EXPECT_THAT(graphOf({led("a", 5)}), Not(HasSubstr("label=<")));
}

TEST(Dot, escapesLabels)
{
    EXPECT_THAT(graphOf({{pathOf("CIM_A", "a"), {{"Name", cim::textValue("\"\\N\n\x1b &lt; \xff")}}}}),
                HasSubstr("label=\"\\\"\\\\N\\\\n\\\\x001B &amp;lt; \uFFFD\\nCIM_A\""));
}

TEST(Dot, findsNodesWhateverTheHostAndTheLetterCaseOfTheClass)
{
    cim::ObjectPath left = pathOf("cim_led", "a");
    left.host = "srv";
    const std::string graph =
        graphOf({led("b", 5), led("a", 5),
                 link(cim::referenceValue(left), cim::referenceValue(pathOf("CIM_Led", "b")))});
    EXPECT_THAT(graph, HasSubstr("\n    n1 -> n0 [color=steelblue];\n"));
    EXPECT_THAT(graph, Not(HasSubstr("dashed")));
}

TEST(Dot, findsNodesByTheirPropertiesWhereTheirPathsHaveNoKeys)
{
    cim::Instance bare = led("a", 5);
    bare.path.keys.clear();
    cim::Instance other = led("b", 5);
    other.path.keys.clear();
    const std::string graph = graphOf(
        {other, bare,
         link(cim::referenceValue(pathOf("CIM_Led", "a")), cim::referenceValue(pathOf("CIM_Led", "b")))});
    EXPECT_THAT(graph, HasSubstr("\n    n1 -> n0 ["));
}

TEST(Dot, showsAMissingObjectOnce)
{
    const cim::Value missing = cim::referenceValue(pathOf("CIM_Gone", "x"));
    const cim::Value a = cim::referenceValue(pathOf("CIM_Led", "a"));
    const std::string graph = graphOf({led("a", 5), link(missing, a), link(a, missing)});
    EXPECT_THAT(graph, HasSubstr("\n    n1 [label=\"root/cimv2:CIM_Gone.DeviceID=\\\"x\\\"\", shape=box, "
                                 "style=dashed];\n    n1 -> n0 ["));
    EXPECT_THAT(graph, HasSubstr("\n    n0 -> n1 ["));
    EXPECT_THAT(graph, Not(HasSubstr("n2")));
}

TEST(Dot, tellsNodesOfTheSameKeysInDifferentNamespacesApart)
{
    cim::Instance elsewhere = led("a", 5);
    elsewhere.path.nameSpace = "root/other";
    const cim::Value a = cim::referenceValue(pathOf("CIM_Led", "a"));
    EXPECT_THAT(graphOf({elsewhere, led("a", 5), link(a, a)}), HasSubstr("\n    n1 -> n1 ["));
}

TEST(Dot, prefersTheFirstNodeHoweverItIsFound)
{
    cim::Instance bare = led("a", 5);
    bare.path.keys.clear();
    const cim::Value a = cim::referenceValue(pathOf("CIM_Led", "a"));
    EXPECT_THAT(graphOf({bare, led("a", 5), link(a, a)}), HasSubstr("\n    n0 -> n0 ["));
    EXPECT_THAT(graphOf({led("a", 5), bare, link(a, a)}), HasSubstr("\n    n0 -> n0 ["));
}

std::size_t count(const std::string& text, const std::string& part)
{
    std::size_t found = 0;
    for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + part.size()))
        ++found;
    return found;
}

// Comparing every end of an edge with every node would take minutes here.
TEST(Dot, drawsManyNodesAndEdges)
{
    constexpr std::size_t most = 20000;
    cim::Instances instances;
    for (std::size_t i = 0; i < most; ++i) {
        const std::string id = std::to_string(i);
        instances.push_back(led(id, 5));
        instances.push_back(
            link(cim::referenceValue(pathOf("CIM_Led", id)), cim::referenceValue(pathOf("CIM_Gone", id))));
    }
    const std::string graph = graphOf(instances);
    EXPECT_EQ(count(graph, " -> "), most);
    EXPECT_EQ(count(graph, "fillcolor=palegreen"), most);
    EXPECT_EQ(count(graph, "style=dashed"), most);
    EXPECT_THAT(graph, HasSubstr("\n    n19999 -> n39999 ["));
}

} // namespace
