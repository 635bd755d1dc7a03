#include "cli/Arguments.h"

#include "broker/Habits.h"
#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cli/metrics/AlarmDevices.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cmath>
#include <cstdlib>
#include <functional>
#include <map>
#include <sstream>
#include <string_view>
#include <utility>

#include <CLI/CLI.hpp>

namespace cimhost::cli {

namespace {

constexpr const char* footer = R"(Object paths are written as the commands print them:
  root/cimv2:CLASS.Key="value",Key2=42,Flag=TRUE
Quote them for the shell: 'CLASS.Key="value"'. Without a namespace, that of --namespace is meant.

Examples:
  cimhost classes                          what there is to ask
  cimhost ein CLASS                        the names of all instances
  cimhost ei CLASS Name HealthState        two properties of all instances
  cimhost gi 'CLASS.Key="value"'           one instance
  cimhost ai -ac ASSOC 'CLASS.Key="value"' what an association ties to it
  cimhost graph | dot -Tsvg > graph.svg    the whole picture
  cimhost serve                            for CIM clients on this machine
  cimhost watch                            what the installation is for, live
  cimhost metrics                          alarm devices, for Prometheus

Environment:
  CIMHOST_PROVIDER_DIR   directories of provider libraries, separated by colons
  CIMHOST_REGISTRATION   registration files, separated by colons
  CIMHOST_SCHEMA         files of class declarations, separated by colons

Exit status: 0 answered; 1 answered with an error status, or the answer could not be written;
2 wrong usage.)";

/// How the field's clients spell the options of a traversal. No such name of several letters after
/// one dash can be declared: it would be read as several options of one letter.
constexpr std::array<std::pair<const char*, const char*>, 4> fieldSpellings{{
    {"-ac", "--assoc-class"},
    {"-arc", "--result-class"},
    {"-ar", "--role"},
    {"-arr", "--result-role"},
}};

void translateFieldSpellings(std::vector<std::string>& arguments)
{
    const auto end = std::find(arguments.begin(), arguments.end(), "--");
    for (const auto& [spelling, option] : fieldSpellings)
        std::replace(arguments.begin(), end, std::string(spelling), std::string(option));
}

/// Of CIM-XML over HTTP without encryption, as registered with IANA (wbem-http).
constexpr std::uint16_t standardPort = 5988;

constexpr double leastLimit = 1;   ///< seconds
constexpr double mostLimit = 3600; ///< seconds

constexpr double leastInterval = 0.1;    ///< seconds
constexpr double mostInterval = 86400.0; ///< seconds

/// What the options and positionals write into.
struct Arguments
{
    std::string target;
    std::string nameSpace = "root/cimv2";
    std::vector<std::string> properties;
    std::string format;
    OperationRequest request;
    Serve serve{"127.0.0.1", standardPort};
    std::string watched; ///< empty: what the installation says
    double interval = 2; ///< seconds
    bool hasMetrics = false;
    std::string measured = alarmDeviceClass;
    double limit = 30;  ///< seconds
    std::string output; ///< empty: none
    bool isWide = false;
    Settings settings;
};

/// What an operation takes besides the common options.
enum class Target
{
    classPath,
    objectPath,
};
enum class Filters
{
    none,
    associators, ///< association class, result class and both roles
    references,  ///< the association class, which is the operation's result class, and one role
};

struct QuestionEntry
{
    Operation operation;
    const char* name;
    const char* alias;
    const char* description;
    Target target;
    Filters filters;
};

constexpr std::array questionEntries{
    QuestionEntry{Operation::enumerateInstanceNames, "ein", "enumerate-instance-names",
                  "Enumerate the names of a class's instances", Target::classPath, Filters::none},
    QuestionEntry{Operation::enumerateInstances, "ei", "enumerate-instances", "Enumerate a class's instances",
                  Target::classPath, Filters::none},
    QuestionEntry{Operation::getInstance, "gi", "get-instance", "Get one instance", Target::objectPath,
                  Filters::none},
    QuestionEntry{Operation::associatorNames, "ain", "associator-names",
                  "Names of the objects that associations tie to an object", Target::objectPath,
                  Filters::associators},
    QuestionEntry{Operation::associators, "ai", "associators",
                  "The objects that associations tie to an object", Target::objectPath, Filters::associators},
    QuestionEntry{Operation::referenceNames, "rin", "reference-names",
                  "Names of the association instances that refer to an object", Target::objectPath,
                  Filters::references},
    QuestionEntry{Operation::references, "ri", "references",
                  "The association instances that refer to an object", Target::objectPath,
                  Filters::references},
};

const std::map<std::string, Format>& formats()
{
    static const std::map<std::string, Format> names{
        {"text", Format::text}, {"table", Format::table}, {"mof", Format::mof}, {"json", Format::json}};
    return names;
}

/// The text around the place of the error, in a line of its own with a mark under the place.
std::string markPlace(std::string_view text, const cim::ParseError& error)
{
    constexpr std::size_t most = 60; // characters on either side
    std::string_view before = text.substr(0, error.offset());
    const std::size_t excess = error.column() > most ? error.column() - 1 - most : 0;
    for (std::size_t i = 0; i < excess; ++i)
        cim::takeCharacter(before);
    const std::string shown = (excess > 0 ? "..." : "") + cim::printable(before);
    return "\n  " + shown + cim::excerpt(text.substr(error.offset()), most) + "\n  " +
           std::string(cim::displayWidth(shown), ' ') + '^';
}

cim::ObjectPath readTarget(const std::string& text, const std::string& nameSpace)
{
    try {
        cim::ObjectPath path = cim::parseObjectPath(text);
        if (path.nameSpace.empty())
            path.nameSpace = nameSpace;
        return path;
    } catch (const cim::ParseError& error) {
        throw UsageError(std::string(error.what()) + markPlace(text, error));
    }
}

/// As in "a, b or c".
std::string joinedByOr(const std::vector<std::string>& words)
{
    std::string text;
    for (std::size_t i = 0; i < words.size(); ++i)
        text += (i == 0 ? "" : i + 1 < words.size() ? ", " : " or ") + words[i];
    return text;
}

std::string expectedInstead(const std::string& expected, const std::string& found)
{
    return "expected " + expected + ", found \"" + cim::excerpt(found) + '"';
}

/// The checks of an option's value.
CLI::Validator oneOf(std::vector<std::string> words)
{
    const auto check = [words = std::move(words)](const std::string& value) {
        return std::find(words.begin(), words.end(), value) != words.end()
                   ? std::string()
                   : expectedInstead(joinedByOr(words), value);
    };
    return {check, ""};
}

/// \param expected  what the message says of the numbers
CLI::Validator between(double least, double most, const char* expected)
{
    const auto check = [=](const std::string& value) {
        char* end = nullptr;
        const double number = std::strtod(value.c_str(), &end);
        const bool isNumber =
            !value.empty() && *end == '\0' && number >= least && number <= most; // nor is NaN one
        return isNumber ? std::string() : expectedInstead(expected, value);
    };
    return {check, ""};
}

/// An empty one is a shell's variable that was not set, more often than not.
CLI::Validator named(const char* what)
{
    const auto check = [what](const std::string& value) {
        return value.empty() ? std::string("expected the name of a ") + what + ", found nothing"
                             : std::string();
    };
    return {check, ""};
}

void addCommonOptions(CLI::App& app, Arguments& arguments)
{
    Settings& settings = arguments.settings;
    app.add_option("-n,--namespace", arguments.nameSpace, "Namespace of paths without one")
        ->type_name("NAMESPACE")
        ->capture_default_str();
    app.add_option("--provider-dir", settings.providerDirectories,
                   "Directory of provider libraries; repeatable")
        ->type_name("DIR")
        ->check(named("directory"))
        ->allow_extra_args(false);
    app.add_option("--registration", settings.registrationFiles, "Registration of providers; repeatable")
        ->type_name("FILE")
        ->check(named("file"))
        ->allow_extra_args(false);
    app.add_option("--schema", settings.schemaFiles, "Declarations of classes, in MOF; repeatable")
        ->type_name("FILE")
        ->check(named("file"))
        ->allow_extra_args(false);
    app.add_option("--inventory", settings.inventory, "Hardware inventory for the providers")
        ->type_name("FILE")
        ->check(named("file"));
    app.add_option("--like", settings.like, "Behave as a real broker does to providers and clients")
        ->type_name("BROKER")
        ->check(oneOf(namesOfHabits()));
    app.add_flag("--trace", settings.trace, "Show what providers trace and log, on standard error");
    app.add_option("-f,--format", arguments.format,
                   "How answers are shown; without it as text, and instances on a terminal as a table")
        ->type_name("FORMAT")
        ->check(oneOf({"text", "table", "mof", "json"}));
}

void addFilters(CLI::App& command, Filters filters, Traversal& traversal)
{
    if (filters == Filters::none)
        return;
    const bool references = filters == Filters::references;
    command.add_option("--role", traversal.role, "The object's role in the association, -ar")
        ->type_name("ROLE");
    command
        .add_option(references ? "--result-class,--assoc-class" : "--result-class", traversal.resultClass,
                    references ? "Class of the association, -arc or -ac" : "Class of the objects found, -arc")
        ->type_name("CLASS");
    if (references)
        return;
    command.add_option("--assoc-class", traversal.assocClass, "Class of the association, -ac")
        ->type_name("CLASS");
    command.add_option("--result-role", traversal.resultRole, "Role of the objects found, -arr")
        ->type_name("ROLE");
}

void addWide(CLI::App& command, bool& isWide)
{
    command.add_flag("--wide", isWide, "Show tables whole on a terminal too, however wide they are");
}

/// A command, with what all of them have.
CLI::App& addCommand(CLI::App& app, const char* name, const char* description)
{
    CLI::App& command = *app.add_subcommand(name, description);
    command.fallthrough();
    command.group("Commands");
    command.footer("More options, for all commands: cimhost --help");
    return command;
}

void addQuestion(CLI::App& app, const QuestionEntry& entry, Arguments& arguments)
{
    CLI::App& command = addCommand(app, entry.name, entry.description);
    command.alias(entry.alias);
    const bool isClass = entry.target == Target::classPath;
    command
        .add_option(isClass ? "CLASS" : "PATH", arguments.target,
                    isClass ? "The class, such as root/cimv2:CLASS" : "The object's path")
        ->type_name("")
        ->required();
    if (!answersPaths(entry.operation))
        command.add_option("PROPERTY", arguments.properties, "Properties wanted; without any, all")
            ->type_name("");
    addFilters(command, entry.filters, arguments.request.traversal);
    addWide(command, arguments.isWide);
}

void addServe(CLI::App& app, Serve& serve, bool& hasMetrics)
{
    CLI::App& command = addCommand(
        app, "serve", "Answer CIM clients over HTTP, for development: no authentication, no encryption");
    command.add_option("--address", serve.address, "Address of this machine to listen on")
        ->type_name("ADDRESS")
        ->check(named("network address"))
        ->capture_default_str();
    command.add_option("--port", serve.port, "Port to listen on; 0 for any that is free")
        ->type_name("PORT")
        ->check(between(0, 65535, "a number from 0 to 65535"))
        ->capture_default_str();
    command.add_flag("--metrics", hasMetrics, "Answer GET /metrics for Prometheus too");
}

void addWatch(CLI::App& app, Arguments& arguments)
{
    CLI::App& command = addCommand(app, "watch", "Show a class's instances live, and what changes");
    command
        .add_option("CLASS", arguments.watched,
                    "The class, such as root/cimv2:CLASS; without it that of the installation")
        ->type_name("");
    command.add_option("--interval", arguments.interval, "Seconds from one look to the next")
        ->type_name("SECONDS")
        ->check(between(leastInterval, mostInterval, "0.1 to 86400 seconds"))
        ->capture_default_str();
    addWide(command, arguments.isWide);
}

void addMetrics(CLI::App& app, Arguments& arguments)
{
    CLI::App& command =
        addCommand(app, "metrics", "Write the alarm devices in the text format of Prometheus");
    command.add_option("CLASS", arguments.measured, "Their class, such as root/cimv2:CLASS")
        ->type_name("")
        ->capture_default_str();
    command.add_option("--output", arguments.output, "File that is replaced in one step")
        ->type_name("FILE")
        ->check(named("file"));
    command.add_option("--limit", arguments.limit, "Seconds that asking may take")
        ->type_name("SECONDS")
        ->check(between(leastLimit, mostLimit, "1 to 3600 seconds"))
        ->capture_default_str();
}

/// The class that a command takes.
cim::ObjectPath readClass(const std::string& command, const std::string& text, const std::string& nameSpace)
{
    cim::ObjectPath path = readTarget(text, nameSpace);
    if (!path.keys.empty())
        throw UsageError(command + " takes a class; gi gets the one instance of a path");
    return path;
}

std::chrono::milliseconds millisecondsOf(double seconds)
{
    constexpr double millisecondsASecond = 1000;
    return std::chrono::milliseconds(std::llround(seconds * millisecondsASecond));
}

Metrics metricsOf(const Arguments& arguments)
{
    return {readClass("metrics", arguments.measured, arguments.nameSpace), millisecondsOf(arguments.limit),
            arguments.output.empty() ? std::nullopt : std::optional(arguments.output)};
}

Watch watchOf(const Arguments& arguments)
{
    return {arguments.watched.empty() ? cim::ObjectPath{"", arguments.nameSpace, "", {}}
                                      : readClass("watch", arguments.watched, arguments.nameSpace),
            millisecondsOf(arguments.interval), arguments.isWide};
}

Ask questionOf(const QuestionEntry& entry, Arguments& arguments)
{
    OperationRequest& request = arguments.request;
    request.operation = entry.operation;
    request.target = entry.target == Target::classPath
                         ? readClass(entry.name, arguments.target, arguments.nameSpace)
                         : readTarget(arguments.target, arguments.nameSpace);
    if (!arguments.properties.empty())
        request.properties = arguments.properties;
    Ask ask{request, {}, arguments.isWide};
    if (!arguments.format.empty())
        ask.format = formats().at(arguments.format);
    return ask;
}

/// Which only questions take.
void refuseFormat(const std::string& command, const std::string& format)
{
    static const std::map<std::string, const char*> forms{
        {"classes", "writes a table"},
        {"graph", "writes DOT"},
        {"metrics", "writes the text format of Prometheus"},
        {"serve", "writes XML"},
        {"watch", "shows a table, or a line for each change"}};
    if (!format.empty())
        throw UsageError("--format has no meaning for " + command + ", which " + forms.at(command));
}

/// The command that was given, with what the parser alone cannot judge.
std::variant<Invocation, Measurement, Notice> commandOf(const CLI::App& app, Arguments& arguments)
{
    const Settings& settings = arguments.settings;
    const std::string name = app.get_subcommands().front()->get_name();
    const auto* entry = std::find_if(questionEntries.begin(), questionEntries.end(),
                                     [&](const QuestionEntry& candidate) { return candidate.name == name; });
    if (entry != questionEntries.end())
        return Invocation{questionOf(*entry, arguments), settings};
    refuseFormat(name, arguments.format);
    if (name == "metrics")
        return Measurement{metricsOf(arguments), settings};
    if (name == "graph")
        return Invocation{DrawGraph{arguments.nameSpace}, settings};
    if (name == "watch")
        return Invocation{watchOf(arguments), settings};
    if (name == "classes")
        return Invocation{ListClasses{}, settings};
    if (arguments.hasMetrics)
        arguments.serve.metrics = readClass("serve", arguments.measured, arguments.nameSpace);
    return Invocation{arguments.serve, settings};
}

/// What is wrong, in one line.
std::string describe(const CLI::App& app, const CLI::ParseError& error)
{
    const std::vector<std::string> unknown = app.remaining(true);
    if (!unknown.empty() && unknown.front().front() == '-')
        return "there is no option " + cim::excerpt(unknown.front());
    if (app.get_subcommands().empty())
        return unknown.empty() ? "a command is required"
                               : "there is no command " + cim::excerpt(unknown.front());
    if (!unknown.empty())
        return expectedInstead("nothing more", unknown.front());
    const std::string text = error.what();
    if (dynamic_cast<const CLI::ArgumentMismatch*>(&error) != nullptr)
        return cim::printable(text.substr(0, text.find(':'))) + ": expected a value, found nothing";
    if (dynamic_cast<const CLI::ConversionError*>(&error) != nullptr) { // "Could not convert: OPTION = VALUE"
        const std::size_t name = text.find(": ") + 2;
        const std::size_t value = text.find(" = ", name);
        return cim::printable(text.substr(name, value - name)) + ": " +
               expectedInstead("a whole number", text.substr(value + 3));
    }
    return cim::printable(text);
}

/// Who says more.
std::string helpOf(const CLI::App& app)
{
    const auto commands = app.get_subcommands();
    return "cimhost " + (commands.empty() ? "" : commands.front()->get_name() + ' ') + "--help";
}

/// The help or version that was asked for, or the error.
Notice noticeOf(const CLI::App& app, const CLI::ParseError& error)
{
    std::ostringstream out;
    std::ostringstream err;
    if (app.exit(error, out, err) != 0)
        throw UsageError(describe(app, error) + "\nTry: " + helpOf(app));
    return {out.str()};
}

} // namespace

std::variant<Invocation, Measurement, Notice> parseArguments(std::vector<std::string> arguments)
{
    Arguments result;
    CLI::App app("Asks CIM providers, loaded into this process, what a CIM client asks.", "cimhost");
    app.footer(footer);
    app.set_version_flag("--version", "cimhost " CIMHOST_VERSION);
    app.get_formatter()->label("SUBCOMMAND", "COMMAND");
    app.require_subcommand(1);
    addCommonOptions(app, result);
    for (const QuestionEntry& entry : questionEntries)
        addQuestion(app, entry, result);
    addCommand(app, "classes", "List the classes that can be asked, with their namespaces and providers");
    addCommand(app, "graph", "Write a namespace's instances as a Graphviz graph");
    addServe(app, result.serve, result.hasMetrics);
    addWatch(app, result);
    addMetrics(app, result);

    translateFieldSpellings(arguments);
    std::reverse(arguments.begin(), arguments.end()); // the parser takes them off the back
    try {
        app.parse(std::move(arguments));
    } catch (const CLI::ParseError& error) {
        return noticeOf(app, error);
    }
    return commandOf(app, result);
}

} // namespace cimhost::cli
