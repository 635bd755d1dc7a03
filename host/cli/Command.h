/// \file
/// What a command line asks for.
#ifndef CIMHOST_CLI_COMMAND_H
#define CIMHOST_CLI_COMMAND_H

#include "broker/OperationRequest.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace cimhost::cli {

/// What the program returns to its caller.
enum ExitStatus : int
{
    exitAnswered = 0,
    exitError = 1, ///< the answer has an error status, or could not be written
    exitUsage = 2, ///< the command line, or a file that it names, is wrong
};

enum class Format
{
    text,  ///< paths as a command line takes them, instances as lists of NAME = VALUE
    table, ///< for people
    mof,
    json, ///< for programs
};

/// Asks one question and shows the answer.
struct Ask
{
    OperationRequest request;
    std::optional<Format> format; ///< nothing: the one that suits the operation and the output
    bool isWide = false;          ///< tables are whole, however wide the terminal is
};

/// Draws the instances of a namespace.
struct DrawGraph
{
    std::string nameSpace;
};

/// Lists what is registered.
struct ListClasses
{};

/// Answers the clients of a network address until a signal ends it.
struct Serve
{
    std::string address;    ///< an IPv4 or IPv6 address of this machine
    std::uint16_t port = 0; ///< 0: any that is free
    /// The class whose instances are shown to Prometheus too; nothing: none are.
    std::optional<cim::ObjectPath> metrics{};
};

/// Shows the instances of a class live until a signal ends it.
struct Watch
{
    cim::ObjectPath target;             ///< the class, with a namespace; unnamed: that of the installation
    std::chrono::milliseconds interval; ///< from one answer to the next question
    bool isWide = false;                ///< the table is whole; the terminal shows its beginning
};

using Command = std::variant<Ask, DrawGraph, ListClasses, Serve, Watch>;

/// Shows the alarm devices to Prometheus; apart from the commands, as it has an answer even where there is no broker.
struct Metrics
{
    cim::ObjectPath target;            ///< the class, with a namespace
    std::chrono::milliseconds limit;   ///< how long asking may take
    std::optional<std::string> output; ///< the file that is replaced; nothing: standard output
};

/// What the broker is to be started with.
struct Settings
{
    std::vector<std::string> providerDirectories; ///< none: the default ones
    std::vector<std::string> registrationFiles;   ///< none: the default ones
    std::vector<std::string> schemaFiles;         ///< none: the default ones
    std::optional<std::string> inventory;         ///< file for the providers; nothing: theirs
    bool trace = false;
    std::optional<std::string> like; ///< the broker whose habits to have; nothing: none
};

/// The format asked for, or without one: text for paths, ready to be copied into the next command; for
/// instances a table on a terminal and text elsewhere.
Format formatOf(const Ask& ask, bool isTerminal);

} // namespace cimhost::cli

#endif
