/// \file
/// What a command line asks for.
#ifndef CIMHOST_CLI_COMMAND_H
#define CIMHOST_CLI_COMMAND_H

#include "broker/Broker.h"
#include "cim/Model.h"

#include <optional>
#include <string>
#include <vector>

namespace cimhost::cli {

/// What the program returns to its caller.
enum ExitStatus : int
{
    exitAnswered = 0,
    exitError = 1, ///< the answer has an error status, or could not be written
    exitUsage = 2, ///< the command line, or a file that it names, is wrong
};

enum class Operation
{
    enumerateInstanceNames,
    enumerateInstances,
    getInstance,
    associators,
    associatorNames,
    references,
    referenceNames,
    graph,
};

enum class Format
{
    text,  ///< paths as a command line takes them, instances as lists of NAME = VALUE
    table, ///< for people
    mof,
    json, ///< for programs
};

/// One request, and how its answer is to be shown.
struct Command
{
    Operation operation = Operation::enumerateInstanceNames;
    /// The class or object asked for, with a namespace; of a graph the namespace only.
    cim::ObjectPath target;
    Traversal traversal;
    cim::PropertyList properties;
    std::optional<Format> format; ///< nothing: the one that suits the operation and the output
};

/// What the broker is to be started with.
struct Settings
{
    std::vector<std::string> providerDirectories; ///< none: the default ones
    std::vector<std::string> registrationFiles;   ///< none: the default ones
    std::optional<std::string> inventory;         ///< file for TAVRO_INVENTORY; nothing: as it is
    bool trace = false;
};

/// Whether the answer consists of paths; otherwise it consists of instances.
bool answersPaths(Operation operation);

/// The format of the command, or without one: text for paths, ready to be copied into the next command;
/// for instances a table on a terminal and text elsewhere.
Format formatOf(const Command& command, bool isTerminal);

} // namespace cimhost::cli

#endif
