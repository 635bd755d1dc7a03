// The program from its arguments to its output, in this process, with the sample provider.

#include "cli/Program.h"

#include "testing/TemporaryDirectory.h"

#include <cstdlib>
#include <sstream>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

using namespace cimhost::cli;
using testing::HasSubstr;
using testing::StartsWith;
using Testing::TemporaryDirectory;

namespace {

constexpr const char* firstPath =
    R"(root/cimv2:CIMT_Lamp.CreationClassName="CIMT_Lamp",DeviceID="Fan 1:/bay[0]")";
constexpr const char* secondPath =
    R"(root/cimv2:CIMT_Lamp.CreationClassName="CIMT_Lamp",DeviceID="Lüfter \"2\", a=b\\c")";
constexpr const char* rackPath = R"(root/cimv2:CIMT_RackSystem.Name="rack-1")";

struct Outcome
{
    int status;
    std::string out;
    std::string err;
};

Outcome runOn(std::optional<std::size_t> columns, const std::vector<std::string>& arguments)
{
    const Surroundings surroundings{"/nowhere/bin", SAMPLE_PROVIDER_DIRECTORY, SAMPLE_REGISTRATION};
    std::ostringstream out;
    std::ostringstream err;
    const int status = cimhost::cli::run(arguments, surroundings, columns, out, err).status;
    return {status, out.str(), err.str()};
}

/// \param isTerminal  whether the output is a wide one
Outcome run(const std::vector<std::string>& arguments, bool isTerminal = false)
{
    return runOn(isTerminal ? std::optional<std::size_t>(200) : std::nullopt, arguments);
}

void expectAnswer(const Outcome& outcome, const std::string& out)
{
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.out, out);
    EXPECT_EQ(outcome.err, "");
}

void expectError(const Outcome& outcome, int status, const std::string& err)
{
    EXPECT_EQ(outcome.status, status);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err, err);
}

// Names

TEST(EnumerateInstanceNames, printsOnePathALine)
{
    const std::string paths = std::string(firstPath) + '\n' + secondPath + '\n';
    expectAnswer(run({"ein", "CIMT_Lamp"}), paths);
    expectAnswer(run({"ein", "CIMT_Lamp"}, true), paths);
    expectAnswer(run({"enumerate-instance-names", "root/cimv2:cimt_lamp"}), paths);
}

TEST(EnumerateInstanceNames, printsPathsThatGetInstanceTakes)
{
    for (const char* path : {firstPath, secondPath}) {
        const Outcome outcome = run({"gi", path, "Name"});
        EXPECT_EQ(outcome.status, 0) << outcome.err;
        EXPECT_THAT(outcome.out, StartsWith(path));
    }
}

TEST(EnumerateInstanceNames, printsTables)
{
    expectAnswer(run({"ein", "CIMT_Lamp", "--format", "table"}), "CreationClassName  DeviceID\n"
                                                                 "-----------------  -----------------\n"
                                                                 "CIMT_Lamp          Fan 1:/bay[0]\n"
                                                                 "CIMT_Lamp          Lüfter \"2\", a=b\\c\n");
}

TEST(EnumerateInstanceNames, printsMof)
{
    expectAnswer(run({"ein", "CIMT_RackSystem", "--format", "mof"}), std::string("// ") + rackPath +
                                                                         "\n"
                                                                         "instance of CIMT_RackSystem\n"
                                                                         "{\n"
                                                                         "    Name = \"rack-1\";\n"
                                                                         "};\n");
}

TEST(EnumerateInstanceNames, printsJson)
{
    const Outcome outcome = run({"ein", "CIMT_Lamp", "--format", "json"});
    const auto json = nlohmann::json::parse(outcome.out);
    EXPECT_EQ(json["status"]["code"], 0);
    EXPECT_FALSE(json.contains("instances"));
    ASSERT_EQ(json["paths"].size(), 2U);
    EXPECT_EQ(json["paths"][0]["text"], firstPath);
    EXPECT_EQ(json["paths"][1]["keys"]["DeviceID"], "Lüfter \"2\", a=b\\c");
}

TEST(EnumerateInstanceNames, asksInTheNamespaceGiven)
{
    EXPECT_THAT(run({"ein", "CIMT_Lamp", "--namespace", "root/other"}).out,
                StartsWith("root/other:CIMT_Lamp."));
    EXPECT_THAT(run({"ein", "root/other:CIMT_Lamp"}).out, StartsWith("root/other:CIMT_Lamp."));
}

// Instances

TEST(EnumerateInstances, printsTextForPrograms)
{
    expectAnswer(run({"ei", "CIMT_Lamp"}), std::string(firstPath) +
                                               "\n"
                                               "  CreationClassName = \"CIMT_Lamp\"\n"
                                               "  DeviceID = \"Fan 1:/bay[0]\"\n"
                                               "  Name = \"Fan 1\"\n"
                                               "  HealthState = 5\n"
                                               "  OperationalStatus = {2, 11}\n"
                                               "  AlarmState = 1\n"
                                               "\n" +
                                               secondPath +
                                               "\n"
                                               "  CreationClassName = \"CIMT_Lamp\"\n"
                                               "  DeviceID = \"Lüfter \\\"2\\\", a=b\\\\c\"\n"
                                               "  Name = \"Lüfter 2\"\n"
                                               "  HealthState = 10\n"
                                               "  OperationalStatus = {3, 5}\n"
                                               "  AlarmState = 3\n");
}

TEST(EnumerateInstances, printsATableOnATerminal)
{
    expectAnswer(
        run({"ei", "CIMT_Lamp"}, true),
        "Name      HealthState       OperationalStatus             AlarmState   DeviceID\n"
        "--------  ----------------  ----------------------------  -----------  -----------------\n"
        "Fan 1     OK                OK, In Service                Off          Fan 1:/bay[0]\n"
        "Lüfter 2  Degraded/Warning  Degraded, Predictive Failure  Alternating  Lüfter \"2\", a=b\\c\n");
}

TEST(EnumerateInstances, fitsTheTerminalUnlessItIsAskedToBeWide)
{
    const std::string whole = run({"ei", "CIMT_Lamp"}, true).out;
    EXPECT_EQ(runOn(60, {"ei", "CIMT_Lamp", "--wide"}).out, whole);
    EXPECT_EQ(runOn(std::nullopt, {"ei", "CIMT_Lamp", "-f", "table"}).out, whole);
    expectAnswer(runOn(60, {"ei", "CIMT_Lamp"}),
                 "Name      HealthState       OperationalStatus    AlarmState\n"
                 "--------  ----------------  -------------------  -----------\n"
                 "Fan 1     OK                OK, In Service       Off\n"
                 "Lüfter 2  Degraded/Warning  Degraded, Predicti…  Alternating\n");
}

TEST(EnumerateInstances, printsThePropertiesNamed)
{
    expectAnswer(run({"ei", "CIMT_Lamp", "Name"}, true), "DeviceID           Name\n"
                                                         "-----------------  --------\n"
                                                         "Fan 1:/bay[0]      Fan 1\n"
                                                         "Lüfter \"2\", a=b\\c  Lüfter 2\n");
    const Outcome outcome = run({"ei", "CIMT_RackSystem", "EnabledState"});
    expectAnswer(outcome, std::string(rackPath) + "\n  Name = \"rack-1\"\n  EnabledState = 2\n");
}

TEST(EnumerateInstances, printsOtherInstancesAsBlocksOnATerminal)
{
    expectAnswer(run({"ei", "CIMT_RackSystem"}, true), std::string(rackPath) +
                                                           "\n"
                                                           "  Name          rack-1\n"
                                                           "  ElementName   Rack <1> & \"co\"\n"
                                                           "  EnabledState  2 (Enabled)\n");
}

TEST(EnumerateInstances, printsMof)
{
    expectAnswer(run({"ei", "CIMT_Lamp", "OperationalStatus", "-f", "mof"}),
                 std::string("// ") + firstPath +
                     "\n"
                     "instance of CIMT_Lamp\n"
                     "{\n"
                     "    CreationClassName = \"CIMT_Lamp\";\n"
                     "    DeviceID = \"Fan 1:/bay[0]\";\n"
                     "    OperationalStatus = {2, 11};\n"
                     "};\n"
                     "\n"
                     "// " +
                     secondPath +
                     "\n"
                     "instance of CIMT_Lamp\n"
                     "{\n"
                     "    CreationClassName = \"CIMT_Lamp\";\n"
                     "    DeviceID = \"Lüfter \\\"2\\\", a=b\\\\c\";\n"
                     "    OperationalStatus = {3, 5};\n"
                     "};\n");
}

TEST(EnumerateInstances, printsJson)
{
    const auto json = nlohmann::json::parse(run({"ei", "CIMT_Lamp", "-f", "json"}, true).out);
    EXPECT_EQ(json["status"], nlohmann::json::parse(R"({"code": 0, "name": "CMPI_RC_OK", "message": null})"));
    EXPECT_FALSE(json.contains("paths"));
    ASSERT_EQ(json["instances"].size(), 2U);
    EXPECT_EQ(json["instances"][0]["path"]["text"], firstPath);
    EXPECT_EQ(json["instances"][0]["properties"],
              nlohmann::json::parse(R"({"CreationClassName": "CIMT_Lamp", "DeviceID": "Fan 1:/bay[0]",
                  "Name": "Fan 1", "HealthState": 5, "OperationalStatus": [2, 11], "AlarmState": 1})"));
}

TEST(EnumerateInstances, mayBringNothing)
{
    expectAnswer(run({"ei", "root/careless:CIMT_Careless"}), "");
    expectAnswer(run({"ei", "root/careless:CIMT_Careless"}, true), "No instances.\n");
    expectAnswer(run({"ei", "root/careless:CIMT_Careless", "-f", "mof"}), "");
    const auto json = nlohmann::json::parse(run({"ei", "root/careless:CIMT_Careless", "-f", "json"}).out);
    EXPECT_EQ(json["instances"], nlohmann::json::array());
}

TEST(GetInstance, showsAllOfItOnATerminal)
{
    expectAnswer(run({"gi", firstPath}, true), std::string(firstPath) +
                                                   "\n"
                                                   "  CreationClassName  CIMT_Lamp\n"
                                                   "  DeviceID           Fan 1:/bay[0]\n"
                                                   "  Name               Fan 1\n"
                                                   "  HealthState        5 (OK)\n"
                                                   "  OperationalStatus  2 (OK), 11 (In Service)\n"
                                                   "  AlarmState         1 (Off)\n");
}

TEST(GetInstance, showsThePropertiesNamed)
{
    EXPECT_THAT(run({"gi", firstPath, "AlarmState"}).out, HasSubstr("\n  AlarmState = 1\n"));
    EXPECT_THAT(run({"gi", firstPath, "AlarmState"}).out, testing::Not(HasSubstr("HealthState")));
}

TEST(GetInstance, isNotFoundIfNothingComesWithoutAnError)
{
    expectError(run({"gi", "CIMT_Lamp.DeviceID=\"none\""}), 1,
                "cimhost: CMPI_RC_ERR_NOT_FOUND (6): there is no root/cimv2:CIMT_Lamp.DeviceID=\"none\"\n");
    const Outcome outcome = run({"gi", "CIMT_Lamp.DeviceID=\"none\"", "--format", "json"});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_EQ(nlohmann::json::parse(outcome.out),
              nlohmann::json::parse(
                  R"({"status": {"code": 6, "name": "CMPI_RC_ERR_NOT_FOUND", "message": null}})"));
}

// Traversals

TEST(Traversals, handEveryArgumentOn)
{
    EXPECT_EQ(run({"ai", rackPath, "-ac", "CIMT_RackLamp", "-arc", "R", "-ar", "From", "-arr", "To", "Name",
                   "AlarmState", "--trace"})
                  .err,
              "cimhost: trace INFO Sample: CIMT_RackLamp R From To +Name +AlarmState\n");
    EXPECT_EQ(
        run({"ain", rackPath, "-ac", "CIMT_RackLamp", "-arc", "R", "-ar", "From", "-arr", "To", "--trace"})
            .err,
        "cimhost: trace INFO Sample: CIMT_RackLamp R From To\n");
    EXPECT_EQ(run({"ri", rackPath, "-arc", "CIMT_RackLamp", "-ar", "From", "PartComponent", "--trace"}).err,
              "cimhost: trace INFO Sample: CIMT_RackLamp From +PartComponent\n");
    EXPECT_EQ(run({"rin", rackPath, "-arc", "CIMT_RackLamp", "-ar", "From", "--trace"}).err,
              "cimhost: trace INFO Sample: CIMT_RackLamp From\n");
}

TEST(Traversals, askEveryAssociationWithoutAClass)
{
    EXPECT_EQ(run({"ai", rackPath, "--trace"}).err, "cimhost: trace INFO Sample: - - - -\n");
    EXPECT_EQ(run({"rin", rackPath, "--trace"}).err, "cimhost: trace INFO Sample: - -\n");
}

TEST(Traversals, printWhatTheyBring)
{
    expectAnswer(run({"ain", firstPath, "-ac", "CIMT_RackLamp"}), std::string(rackPath) + '\n');
    expectAnswer(run({"ai", firstPath, "-ac", "CIMT_RackLamp", "EnabledState"}, true),
                 "Name    EnabledState\n"
                 "------  ------------\n"
                 "rack-1  Enabled\n");
    EXPECT_THAT(run({"ai", rackPath}, true).out, StartsWith("Name      HealthState"));
    const Outcome references = run({"ri", rackPath, "-arc", "CIMT_RackLamp"}, true);
    EXPECT_THAT(references.out, HasSubstr(std::string("\n  GroupComponent  ") + rackPath + '\n'));
    EXPECT_THAT(references.out, HasSubstr(std::string("\n  PartComponent   ") + secondPath + '\n'));
}

TEST(Traversals, printReferencesThatAreReadBack)
{
    const Outcome outcome = run({"rin", rackPath});
    const std::string path = outcome.out.substr(0, outcome.out.find('\n'));
    EXPECT_EQ(path, R"(root/cimv2:CIMT_RackLamp.GroupComponent="root/cimv2:CIMT_RackSystem.Name=\"rack-1\"",)"
                    R"(PartComponent="root/cimv2:CIMT_Lamp.CreationClassName=\"CIMT_Lamp\",)"
                    R"(DeviceID=\"Fan 1:/bay[0]\"")");
    EXPECT_EQ(run({"rin", path}).out, outcome.out);
}

TEST(Traversals, adviseAnAssociationClassAfterAnErrorWithoutOne)
{
    const std::string path = "root/refusing:CIMT_Lamp.DeviceID=\"x\"";
    const std::string advice = "Every association was asked. For one of them add -ac CIMT_Refusing\n";
    for (const char* const command : {"ai", "ain", "ri", "rin"}) {
        const Outcome outcome = run({command, path});
        EXPECT_EQ(outcome.status, 1);
        EXPECT_EQ(outcome.err, "cimhost: CMPI_RC_ERR_FAILED (1): which association?\n" + advice) << command;
        EXPECT_EQ(run({command, path, "-ac", "CIMT_Refusing"}).err,
                  "cimhost: CMPI_RC_ERR_FAILED (1): which association?\n");
    }
}

TEST(Classes, areListedWithWhatTheyAnswer)
{
    const std::string list = run({"classes"}).out;
    EXPECT_THAT(list, StartsWith("Namespace "));
    EXPECT_THAT(
        list,
        HasSubstr("\nroot/other     CIMT_RackLamp    all               Rack      libCimhostSample.so\n"));
    EXPECT_THAT(list, HasSubstr("\nroot/cimv2     CIMT_RackSystem  ein, ei, gi       Rack "));
}

TEST(Properties, thatNoInstanceHasAreWarnedOf)
{
    const Outcome outcome = run({"ei", "CIMT_Lamp", "Nmae", "HealthState", "Bogus", "deviceid"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.err, "cimhost: no instance has the property Nmae; did you mean Name?\n"
                           "cimhost: no instance has the property Bogus\n");
    EXPECT_EQ(run({"gi", firstPath, "Name", "HealthState"}).err, "");
    EXPECT_EQ(run({"ei", "root/careless:CIMT_Careless", "Name"}).err, "") << "there is no instance at all";
}

// Errors

TEST(Errors, comeWithTheirCodeAndMessage)
{
    expectError(run({"gi", "CIMT_Lamp"}), 1,
                "cimhost: CMPI_RC_ERR_FAILED (1): At least one key should be passed\n");
    expectError(run({"ei", "CIMT_Lamp", "-n", "root/none"}), 1,
                "cimhost: CMPI_RC_ERR_INVALID_NAMESPACE (3): no registration names the namespace root/none\n"
                "Try: cimhost classes\n");
    EXPECT_EQ(run({"ei", "CIMT_Lmap"}).err,
              "cimhost: CMPI_RC_ERR_INVALID_CLASS (5): no provider is registered for the class CIMT_Lmap in "
              "root/cimv2; did you mean CIMT_Lamp?\nTry: cimhost classes\n");
}

TEST(Errors, leaveOutWhatCameBeforeThemAndCannotDriveATerminal)
{
    expectError(run({"ei", "CIMT_Broken"}), 1,
                "cimhost: CMPI_RC_ERR_FAILED (1): broken on purpose\\x001B[2J\n");
}

TEST(Errors, areOnStandardOutputTooInJson)
{
    const Outcome outcome = run({"ei", "CIMT_Broken", "--format", "json"});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_EQ(outcome.err, "cimhost: CMPI_RC_ERR_FAILED (1): broken on purpose\\x001B[2J\n");
    const auto json = nlohmann::json::parse(outcome.out);
    EXPECT_EQ(json["status"]["code"], 1);
    EXPECT_EQ(json["status"]["name"], "CMPI_RC_ERR_FAILED");
    EXPECT_EQ(json["status"]["message"], "broken on purpose\x1b[2J");
    EXPECT_EQ(json.size(), 1U);
}

TEST(Errors, ofTheProviderInUsingTheInterfaceAreReported)
{
    const Outcome outcome = run({"ein", "root/careless:CIMT_Careless"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.out, "");
    EXPECT_THAT(outcome.err, StartsWith("cimhost: provider misuse: "));
}

TEST(Errors, ofUsageReturnTwo)
{
    expectError(run({}), 2, "cimhost: a command is required\nTry: cimhost --help\n");
    expectError(run({"gi", "CIMT_Lamp.DeviceID=x"}), 2,
                "cimhost: column 20: found \"x\", expected a quoted text, a number, TRUE or FALSE\n"
                "  CIMT_Lamp.DeviceID=x\n"
                "                     ^\n");
}

TEST(Errors, ofARegistrationReturnTwo)
{
    const TemporaryDirectory directory;
    const std::string wrong = directory.file("wrong.reg", "nonsense\n");
    const Outcome outcome = run({"ei", "CIMT_Lamp", "--registration", wrong});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_THAT(outcome.err, StartsWith("cimhost: " + wrong));
    EXPECT_EQ(run({"ei", "CIMT_Lamp", "--registration", directory.path().string() + "/none.reg"}).status, 2);
}

TEST(Errors, ofASchemaReturnTwo)
{
    const TemporaryDirectory directory;
    const std::string wrong = directory.file("wrong.mof", "class A {\n};\nnonsense\n");
    const Outcome outcome = run({"ei", "CIMT_Lamp", "--schema", wrong});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.err, "cimhost: " + wrong + ":3:1: expected class, found \"nonsense\"\n");
}

TEST(Errors, ofAMissingProviderAreTheAnswers)
{
    const TemporaryDirectory directory;
    const Outcome outcome = run({"ei", "CIMT_Lamp", "--provider-dir", directory.path().string()});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.err, StartsWith("cimhost: CMPI_RC_ERR_FAILED (1): "));
    EXPECT_THAT(outcome.err, HasSubstr("libCimhostSample.so"));
}

// Surroundings of the providers

TEST(Inventory, isSetBeforeTheProvidersAreLoaded)
{
    const TemporaryDirectory directory;
    const std::string file = directory.file("inventory.json", "{}");
    const auto traced = [](const std::string& inventory) {
        return StartsWith("cimhost: trace VERBOSE Sample: inventory " + inventory + '\n');
    };
    EXPECT_THAT(run({"ei", "CIMT_RackSystem", "--inventory", file, "--trace"}).err, traced(file));
    unsetenv("CIMT_INVENTORY");
    EXPECT_THAT(run({"ei", "CIMT_RackSystem", "--trace"}).err, traced("unset"));
}

TEST(Inventory, mustExist)
{
    expectError(run({"ei", "CIMT_RackSystem", "--inventory", "/nowhere/inventory.json"}), 2,
                "cimhost: cannot read the inventory /nowhere/inventory.json: No such file or directory\n");
}

TEST(Help, isAnAnswer)
{
    EXPECT_EQ(run({"--help"}).status, 0);
    EXPECT_THAT(run({"--help"}).out, HasSubstr("Usage: cimhost"));
    expectAnswer(run({"--version"}), "cimhost " CIMHOST_VERSION "\n");
}

// Graph

TEST(Graph, showsObjectsByHealthAndAssociationsByName)
{
    const Outcome outcome = run({"graph"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.err, "cimhost: CIMT_Broken: CMPI_RC_ERR_FAILED (1): broken on purpose\\x001B[2J\n");
    EXPECT_EQ(outcome.out,
              R"(digraph "root/cimv2" {
    rankdir=LR;
    ranksep=2;
    nodesep=0.1;
    labelloc=t;
    fontname="sans-serif";
    label=<<font color="steelblue">CIMT_RackLamp: GroupComponent → PartComponent</font><br/>>;
    node [fontname="sans-serif", style=filled, margin="0.1,0.03"];
    // CIMT_Broken: CMPI_RC_ERR_FAILED (1): broken on purpose\x001B[2J
    n0 [label="Rack <1> &amp; \"co\"\nCIMT_RackSystem", shape=box3d, fillcolor=white];
    n1 [label="Fan 1\nCIMT_Lamp\nOK, alarm Off", shape=box, fillcolor=palegreen];
    n2 [label="Lüfter 2\nCIMT_Lamp\nDegraded/Warning, alarm Alternating", shape=box, fillcolor=khaki];
    n0 -> n1 [color=steelblue];
    n0 -> n2 [color=steelblue];
}
)");
}

TEST(Graph, showsObjectsThatOnlyReferencesName)
{
    // In this namespace nobody serves the rack.
    const Outcome outcome = run({"graph", "--namespace", "root/other"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.err, "");
    EXPECT_THAT(
        outcome.out,
        HasSubstr(R"(    n2 [label="root/other:CIMT_RackSystem.Name=\"rack-1\"", shape=box, style=dashed];)"
                  "\n    n2 -> n0 ["));
    EXPECT_THAT(outcome.out, HasSubstr("\n    n2 -> n1 ["));
}

TEST(Graph, failsOnlyIfNothingAnswers)
{
    const Outcome broken = run({"graph", "-n", "root/broken"});
    EXPECT_EQ(broken.status, 1);
    EXPECT_EQ(broken.out, "");
    EXPECT_EQ(broken.err, "cimhost: CIMT_Broken: CMPI_RC_ERR_FAILED (1): broken on purpose\\x001B[2J\n"
                          "cimhost: no class of the namespace root/broken answered\n");
    expectError(run({"graph", "-n", "root/none"}), 1,
                "cimhost: no class of the namespace root/none answered\n");
    EXPECT_EQ(run({"graph", "-n", "root/careless"}).status, 0);
}

} // namespace
