#include "cli/Arguments.h"

#include "cim/Values.h"

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::cli;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

Invocation parse(std::vector<std::string> arguments)
{
    return std::get<Invocation>(parseArguments(std::move(arguments)));
}

OperationRequest requestOf(std::vector<std::string> arguments)
{
    return std::get<Ask>(parse(std::move(arguments)).command).request;
}

std::optional<Format> formatOf(std::vector<std::string> arguments)
{
    return std::get<Ask>(parse(std::move(arguments)).command).format;
}

std::string noticeOf(std::vector<std::string> arguments)
{
    return std::get<Notice>(parseArguments(std::move(arguments))).text;
}

/// The message of the usage error; empty: there was none.
std::string errorOf(std::vector<std::string> arguments)
{
    try {
        parseArguments(std::move(arguments));
        return "";
    } catch (const UsageError& error) {
        return error.what();
    }
}

struct CommandName
{
    const char* name;
    const char* target;
    Operation operation;
};

class CommandNames : public testing::TestWithParam<CommandName>
{};

TEST_P(CommandNames, chooseTheOperation)
{
    EXPECT_EQ(requestOf({GetParam().name, GetParam().target}).operation, GetParam().operation);
}

INSTANTIATE_TEST_SUITE_P(
    Arguments, CommandNames,
    testing::Values(CommandName{"ein", "C", Operation::enumerateInstanceNames},
                    CommandName{"enumerate-instance-names", "C", Operation::enumerateInstanceNames},
                    CommandName{"ei", "C", Operation::enumerateInstances},
                    CommandName{"enumerate-instances", "C", Operation::enumerateInstances},
                    CommandName{"gi", "C.K=1", Operation::getInstance},
                    CommandName{"get-instance", "C.K=1", Operation::getInstance},
                    CommandName{"ai", "C.K=1", Operation::associators},
                    CommandName{"associators", "C.K=1", Operation::associators},
                    CommandName{"ain", "C.K=1", Operation::associatorNames},
                    CommandName{"associator-names", "C.K=1", Operation::associatorNames},
                    CommandName{"ri", "C.K=1", Operation::references},
                    CommandName{"references", "C.K=1", Operation::references},
                    CommandName{"rin", "C.K=1", Operation::referenceNames},
                    CommandName{"reference-names", "C.K=1", Operation::referenceNames}));

TEST(Arguments, graphTakesNoTarget)
{
    EXPECT_EQ(std::get<DrawGraph>(parse({"graph"}).command).nameSpace, "root/cimv2");
    EXPECT_EQ(std::get<DrawGraph>(parse({"graph", "--namespace", "root/x"}).command).nameSpace, "root/x");
    EXPECT_NE(errorOf({"graph", "C"}), "");
}

TEST(Arguments, serveTakesAnAddressAndAPort)
{
    const Serve usual = std::get<Serve>(parse({"serve"}).command);
    EXPECT_EQ(usual.address, "127.0.0.1");
    EXPECT_EQ(usual.port, 5988);
    const Serve other = std::get<Serve>(parse({"serve", "--address", "::1", "--port", "0"}).command);
    EXPECT_EQ(other.address, "::1");
    EXPECT_EQ(other.port, 0);
    for (const char* port : {"-1", "65536", "x", ""})
        EXPECT_THAT(errorOf({"serve", "--port", port}), HasSubstr("--port")) << port;
    EXPECT_THAT(errorOf({"serve", "--address", ""}),
                StartsWith("--address: expected the name of a network address"));
    EXPECT_EQ(errorOf({"serve", "--format", "json"}), "--format has no meaning for serve, which writes XML");
    EXPECT_NE(errorOf({"serve", "C"}), "");
}

TEST(Arguments, watchHasAClassAndAnInterval)
{
    const auto watchOf = [](std::vector<std::string> arguments) {
        return std::get<Watch>(parse(std::move(arguments)).command);
    };
    EXPECT_EQ(watchOf({"watch"}).target, (cim::ObjectPath{"", "root/cimv2", "", {}}));
    EXPECT_EQ(watchOf({"watch"}).interval, std::chrono::seconds(2));
    EXPECT_EQ(watchOf({"watch", "root/x:C", "--interval", "0.25"}).target,
              (cim::ObjectPath{"", "root/x", "C", {}}));
    EXPECT_EQ(watchOf({"watch", "--interval", "0.25"}).interval, std::chrono::milliseconds(250));
    for (const char* const interval : {"0", "-1", "0.05", "86401", "nan", "inf", "2s", ""})
        EXPECT_NE(errorOf({"watch", "--interval", interval}), "") << interval;
    EXPECT_EQ(errorOf({"watch", "C.K=1"}), "watch takes a class; gi gets the one instance of a path");
    EXPECT_EQ(errorOf({"watch", "--format", "json"}),
              "--format has no meaning for watch, which shows a table, or a line for each change");
}

TEST(Arguments, serveShowsMetricsIfAsked)
{
    const auto metricsOf = [](std::vector<std::string> arguments) {
        return std::get<Serve>(parse(std::move(arguments)).command).metrics;
    };
    EXPECT_EQ(metricsOf({"serve"}), std::nullopt);
    EXPECT_EQ(metricsOf({"serve", "--metrics"}), (cim::ObjectPath{"", "root/cimv2", "CIM_AlarmDevice", {}}));
    EXPECT_EQ(metricsOf({"-n", "root/x", "serve", "--metrics"})->nameSpace, "root/x");
}

TEST(Arguments, metricsHaveAClassALimitAndAFile)
{
    const auto metricsOf = [](std::vector<std::string> arguments) {
        return std::get<Measurement>(parseArguments(std::move(arguments))).metrics;
    };
    EXPECT_EQ(metricsOf({"metrics"}).target, (cim::ObjectPath{"", "root/cimv2", "CIM_AlarmDevice", {}}));
    EXPECT_EQ(metricsOf({"metrics"}).limit, std::chrono::seconds(30));
    EXPECT_EQ(metricsOf({"metrics"}).output, std::nullopt);
    EXPECT_EQ(metricsOf({"metrics", "root/x:C"}).target, (cim::ObjectPath{"", "root/x", "C", {}}));
    EXPECT_EQ(metricsOf({"metrics", "-n", "root/x"}).target.nameSpace, "root/x");
    EXPECT_EQ(metricsOf({"metrics", "--limit", "1.5"}).limit, std::chrono::milliseconds(1500));
    EXPECT_EQ(metricsOf({"metrics", "--output", "f"}).output, "f");
    for (const char* const limit : {"0", "0.9", "3601", "nan", ""})
        EXPECT_THAT(errorOf({"metrics", "--limit", limit}),
                    StartsWith("--limit: expected 1 to 3600 seconds"));
    EXPECT_THAT(errorOf({"metrics", "--output", ""}), StartsWith("--output: expected the name of a file"));
    EXPECT_EQ(errorOf({"metrics", "C.K=1"}), "metrics takes a class; gi gets the one instance of a path");
    EXPECT_EQ(errorOf({"metrics", "--format", "json"}),
              "--format has no meaning for metrics, which writes the text format of Prometheus");
}

TEST(Arguments, theTargetHasANamespaceOfItsOwnOrTheCommonOne)
{
    EXPECT_EQ(requestOf({"ein", "C"}).target, (cim::ObjectPath{"", "root/cimv2", "C", {}}));
    EXPECT_EQ(requestOf({"ein", "C", "--namespace", "root/x"}).target,
              (cim::ObjectPath{"", "root/x", "C", {}}));
    EXPECT_EQ(requestOf({"-n", "root/x", "ein", "C"}).target, (cim::ObjectPath{"", "root/x", "C", {}}));
    EXPECT_EQ(requestOf({"ein", "a/b:C", "--namespace", "root/x"}).target,
              (cim::ObjectPath{"", "a/b", "C", {}}));
    EXPECT_EQ(requestOf({"gi", "//srv/a/b:C.K=\"x\""}).target,
              (cim::ObjectPath{"srv", "a/b", "C", {{"K", cim::textValue("x")}}}));
}

TEST(Arguments, anObjectMayLackKeysAClassMayNotHaveThem)
{
    EXPECT_EQ(requestOf({"gi", "C"}).target.className, "C");
    EXPECT_EQ(errorOf({"ei", "C.K=1"}), "ei takes a class; gi gets the one instance of a path");
    EXPECT_EQ(errorOf({"ein", "C.K=1"}), "ein takes a class; gi gets the one instance of a path");
}

TEST(Arguments, marksTheWrongPlaceOfAPath)
{
    EXPECT_EQ(errorOf({"gi", "C.K=\"a"}), "column 7: found the end, expected the closing quote\n"
                                          "  C.K=\"a\n"
                                          "        ^");
    // The mark stands by what a terminal shows: a wide character takes two columns, an escape six.
    EXPECT_EQ(errorOf({"gi", "C.K=\"\u98a8\x1b\"!"}),
              "column 9: found \"!\", expected \",\" and a key, or the end\n"
              "  C.K=\"\u98a8\\x001B\"!\n"
              "                ^");
    EXPECT_EQ(errorOf({"ein", ""}), "column 1: found the end, expected a namespace or a class name\n"
                                    "  \n"
                                    "  ^");
}

TEST(Arguments, showsOnlyTheSurroundingsOfTheWrongPlace)
{
    std::string wide; // 59 characters of two columns each; before them one of the quote
    for (int i = 0; i < 59; ++i)
        wide += "\u98a8";
    EXPECT_EQ(errorOf({"gi", "C.K=\"" + wide + "\"!" + std::string(100, 'x')}),
              "column 66: found \"!\", expected \",\" and a key, or the end\n"
              "  ..." +
                  wide + "\"!" + std::string(59, 'x') + "...\n  " + std::string(3 + 118 + 1, ' ') + '^');
    EXPECT_EQ(errorOf({"gi", std::string(59, 'C') + "!"}),
              "column 60: found \"!\", expected \".\" and a key, or the end\n  " + std::string(59, 'C') +
                  "!\n  " + std::string(59, ' ') + '^');
    for (const std::string start : {"", "C.", "C.K=", "C.K=\"", "C.K=1", "C.K=\"CIM_A.K="})
        for (const char* repeated : {"x", "7", "!", "\u98a8", "\x1b", "\xff"}) {
            std::string text = start;
            while (text.size() < 120000)
                text += repeated;
            EXPECT_LT(errorOf({"gi", text}).size(), 2000U) << start << repeated;
            EXPECT_LT(errorOf({"gi", text.substr(0, 60000)}).size(), 2000U) << start << repeated;
        }
}

TEST(Arguments, propertiesFollowTheTarget)
{
    EXPECT_EQ(requestOf({"ei", "C"}).properties, std::nullopt);
    EXPECT_THAT(requestOf({"ei", "C", "A", "B"}).properties.value(), ElementsAre("A", "B"));
    EXPECT_THAT(requestOf({"gi", "C.K=1", "A", "--trace"}).properties.value(), ElementsAre("A"));
    EXPECT_THAT(requestOf({"ai", "C.K=1", "A"}).properties.value(), ElementsAre("A"));
    EXPECT_THAT(requestOf({"ri", "C.K=1", "A"}).properties.value(), ElementsAre("A"));
}

TEST(Arguments, aPropertyMayBeNamedLikeACommand)
{
    EXPECT_THAT(requestOf({"ei", "C", "references", "gi"}).properties.value(),
                ElementsAre("references", "gi"));
}

TEST(Arguments, namesHaveNoProperties)
{
    for (const char* command : {"ein", "ain", "rin"})
        EXPECT_THAT(errorOf({command, "C", "A"}), HasSubstr("A")) << command;
}

TEST(Arguments, traversalsTakeClassesAndRoles)
{
    for (const char* command : {"ai", "ain"}) {
        const Traversal traversal = requestOf({command, "C.K=1", "--assoc-class", "A", "--result-class", "R",
                                               "--role", "From", "--result-role", "To"})
                                        .traversal;
        EXPECT_EQ(traversal.assocClass, "A");
        EXPECT_EQ(traversal.resultClass, "R");
        EXPECT_EQ(traversal.role, "From");
        EXPECT_EQ(traversal.resultRole, "To");
    }
}

TEST(Arguments, traversalsTakeTheFieldsSpellingsToo)
{
    const Traversal traversal =
        requestOf({"ain", "-ac", "A", "-arc", "R", "-ar", "From", "-arr", "To", "C.K=1"}).traversal;
    EXPECT_EQ(traversal.assocClass, "A");
    EXPECT_EQ(traversal.resultClass, "R");
    EXPECT_EQ(traversal.role, "From");
    EXPECT_EQ(traversal.resultRole, "To");
}

TEST(Arguments, theAssociationOfReferencesIsTheirResultClass)
{
    for (const char* command : {"ri", "rin"})
        for (const char* option : {"--result-class", "--assoc-class", "-arc", "-ac"}) {
            const Traversal traversal = requestOf({command, option, "A", "-ar", "From", "C.K=1"}).traversal;
            EXPECT_EQ(traversal.resultClass, "A") << command << option;
            EXPECT_EQ(traversal.assocClass, std::nullopt) << command << option;
            EXPECT_EQ(traversal.role, "From") << command << option;
        }
    EXPECT_NE(errorOf({"ri", "C.K=1", "-arr", "To"}), "");
}

TEST(Arguments, whatIsNotGivenIsNull)
{
    const Traversal traversal = requestOf({"ai", "C.K=1"}).traversal;
    EXPECT_EQ(traversal.assocClass, std::nullopt);
    EXPECT_EQ(traversal.resultClass, std::nullopt);
    EXPECT_EQ(traversal.role, std::nullopt);
    EXPECT_EQ(traversal.resultRole, std::nullopt);
}

TEST(Arguments, onlyTraversalsTakeFilters)
{
    EXPECT_NE(errorOf({"ei", "C", "-ac", "A"}), "");
    EXPECT_NE(errorOf({"gi", "C", "--role", "A"}), "");
    EXPECT_NE(errorOf({"graph", "--role", "A"}), "");
}

TEST(Arguments, formatsHaveNames)
{
    EXPECT_EQ(formatOf({"ei", "C"}), std::nullopt);
    EXPECT_EQ(formatOf({"ei", "C", "--format", "text"}), Format::text);
    EXPECT_EQ(formatOf({"ei", "C", "--format", "table"}), Format::table);
    EXPECT_EQ(formatOf({"--format", "mof", "ei", "C"}), Format::mof);
    EXPECT_EQ(formatOf({"ei", "-f", "json", "C"}), Format::json);
    EXPECT_THAT(
        errorOf({"ei", "C", "--format", "xml"}),
        testing::Eq("--format: expected text, table, mof or json, found \"xml\"\nTry: cimhost ei --help"));
    EXPECT_THAT(errorOf({"graph", "--format", "json"}), HasSubstr("--format"));
}

TEST(Arguments, setTheBrokerUp)
{
    const Settings defaults = parse({"ei", "C"}).settings;
    EXPECT_TRUE(defaults.providerDirectories.empty());
    EXPECT_TRUE(defaults.registrationFiles.empty());
    EXPECT_EQ(defaults.inventory, std::nullopt);
    EXPECT_FALSE(defaults.trace);
    EXPECT_EQ(defaults.like, std::nullopt);

    const Settings settings = parse({"--provider-dir",
                                     "/a",
                                     "ei",
                                     "C",
                                     "P",
                                     "--provider-dir",
                                     "/b",
                                     "--registration",
                                     "r1",
                                     "--registration",
                                     "r2",
                                     "--schema",
                                     "s1",
                                     "--schema",
                                     "s2",
                                     "--inventory",
                                     "i.json",
                                     "--trace",
                                     "--like",
                                     "sfcb"})
                                  .settings;
    EXPECT_THAT(settings.providerDirectories, ElementsAre("/a", "/b"));
    EXPECT_THAT(settings.registrationFiles, ElementsAre("r1", "r2"));
    EXPECT_THAT(settings.schemaFiles, ElementsAre("s1", "s2"));
    EXPECT_EQ(settings.inventory, "i.json");
    EXPECT_TRUE(settings.trace);
    EXPECT_EQ(settings.like, "sfcb");
}

TEST(Arguments, nameABrokerWhoseHabitsAreKnown)
{
    EXPECT_EQ(parse({"--like", "pegasus", "serve"}).settings.like, "pegasus");
    for (const char* name : {"other", "", "SFCB"})
        EXPECT_THAT(errorOf({"ei", "C", "--like", name}),
                    HasSubstr("--like: expected sfcb or pegasus, found \""))
            << name;
}

TEST(Arguments, namesOfFilesAreNotEmpty)
{
    EXPECT_THAT(errorOf({"ei", "C", "--inventory", ""}),
                StartsWith("--inventory: expected the name of a file, found nothing"));
    EXPECT_THAT(errorOf({"ei", "C", "--inventory="}), StartsWith("--inventory: "));
    EXPECT_THAT(errorOf({"ei", "C", "--registration", ""}),
                StartsWith("--registration: expected the name of a file, found nothing"));
    EXPECT_THAT(errorOf({"ei", "C", "--provider-dir", "/a", "--provider-dir", ""}),
                StartsWith("--provider-dir: expected the name of a directory, found nothing"));
}

TEST(Arguments, repeatableOptionsTakeOneValueEach)
{
    const Invocation invocation = parse({"--provider-dir", "/a", "ei", "C"});
    EXPECT_THAT(invocation.settings.providerDirectories, ElementsAre("/a"));
    EXPECT_EQ(std::get<Ask>(invocation.command).request.target.className, "C");
}

TEST(Arguments, refuseWhatIsMissingOrUnknown)
{
    EXPECT_EQ(errorOf({}), "a command is required\nTry: cimhost --help");
    EXPECT_EQ(errorOf({"--trace"}), "a command is required\nTry: cimhost --help");
    EXPECT_EQ(errorOf({"frobnicate", "C"}), "there is no command frobnicate\nTry: cimhost --help");
    EXPECT_EQ(errorOf({"e\x1b"}), "there is no command e\\x001B\nTry: cimhost --help");
    EXPECT_THAT(errorOf({"ei"}), HasSubstr("CLASS is required"));
    EXPECT_THAT(errorOf({"gi"}), HasSubstr("PATH is required"));
    EXPECT_EQ(errorOf({"ei", "C", "--frobnicate"}),
              "there is no option --frobnicate\nTry: cimhost ei --help");
    EXPECT_EQ(errorOf({"--frobnicate"}), "there is no option --frobnicate\nTry: cimhost --help");
    EXPECT_EQ(errorOf({"ein", "C", "D"}), "expected nothing more, found \"D\"\nTry: cimhost ein --help");
    EXPECT_EQ(errorOf({"ei", "C", "--namespace"}),
              "--namespace: expected a value, found nothing\nTry: cimhost ei --help");
    EXPECT_EQ(errorOf({"serve", "--port", "1.5"}),
              "--port: expected a whole number, found \"1.5\"\nTry: cimhost serve --help");
    EXPECT_EQ(errorOf({"serve", "--port", "70000"}),
              "--port: expected a number from 0 to 65535, found \"70000\"\nTry: cimhost serve --help");
    EXPECT_EQ(errorOf({"watch", "--interval", "x"}),
              "--interval: expected 0.1 to 86400 seconds, found \"x\"\nTry: cimhost watch --help");
    EXPECT_THAT(errorOf({"ei", "C", "--\x1b"}), HasSubstr("--\\x001B"));
    EXPECT_THAT(errorOf({"ei"}), HasSubstr("\nTry: cimhost ei --help"));
}

TEST(Arguments, helpIsForAllOrForOneCommand)
{
    EXPECT_THAT(noticeOf({"--help"}), HasSubstr("Exit status"));
    EXPECT_THAT(noticeOf({"--help"}), HasSubstr("--provider-dir DIR"));
    for (const char* command : {"ein", "ei", "gi", "ain", "ai", "rin", "ri", "graph", "serve"})
        EXPECT_THAT(noticeOf({"--help"}), HasSubstr(std::string("\n  ") + command)) << command;
    EXPECT_THAT(noticeOf({"ei", "--help"}), HasSubstr("PROPERTY"));
    EXPECT_THAT(noticeOf({"ai", "--help"}), HasSubstr("--result-role ROLE"));
}

TEST(Arguments, versionIsTheProjects)
{
    EXPECT_EQ(noticeOf({"--version"}), "cimhost " CIMHOST_VERSION "\n");
}

TEST(Formats, suitTheOutput)
{
    Ask command;
    command.request.operation = Operation::enumerateInstances;
    EXPECT_EQ(formatOf(command, true), Format::table);
    EXPECT_EQ(formatOf(command, false), Format::text);
    command.format = Format::json;
    EXPECT_EQ(formatOf(command, true), Format::json);
}

TEST(Formats, keepNamesReadyToBeCopied)
{
    for (const Operation operation :
         {Operation::enumerateInstanceNames, Operation::associatorNames, Operation::referenceNames}) {
        Ask command;
        command.request.operation = operation;
        EXPECT_EQ(formatOf(command, true), Format::text);
        EXPECT_EQ(formatOf(command, false), Format::text);
    }
}

} // namespace
