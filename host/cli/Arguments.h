/// \file
/// Reads the command line.
#ifndef CIMHOST_CLI_ARGUMENTS_H
#define CIMHOST_CLI_ARGUMENTS_H

#include "cli/Command.h"

#include <stdexcept>
#include <string>
#include <variant>
#include <vector>

namespace cimhost::cli {

/// A command line that cannot be followed, or a file named there that cannot be used; what() says
/// what is wrong, in one line or with the place marked under it.
class UsageError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// A command line that can be followed.
struct Invocation
{
    Command command;
    Settings settings;
};

/// The alarm devices are to be shown.
struct Measurement
{
    Metrics metrics;
    Settings settings;
};

/// Text to print instead of doing anything: the help or the version.
struct Notice
{
    std::string text;
};

/// \param arguments  without the program's name. The single-dash spellings of the field's clients,
/// `-ac`, `-arc`, `-ar` and `-arr`, stand for `--assoc-class`, `--result-class`, `--role` and
/// `--result-role`
/// \throws UsageError
std::variant<Invocation, Measurement, Notice> parseArguments(std::vector<std::string> arguments);

} // namespace cimhost::cli

#endif
