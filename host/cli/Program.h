/// \file
/// The program without the process around it.
#ifndef CIMHOST_CLI_PROGRAM_H
#define CIMHOST_CLI_PROGRAM_H

#include "cli/Command.h"
#include "cli/Installation.h"

#include <cstddef>
#include <iosfwd>
#include <optional>
#include <string>
#include <vector>

namespace cimhost::cli {

struct Ending
{
    ExitStatus status;
    bool isOneDocument = false; ///< whether the output is of no use where only its beginning is read
};

/// Does what the command line asks for and never throws: errors are lines on `err`.
/// \param arguments   without the program's name
/// \param columns    of the terminal that `out` is; nothing: it is none
Ending run(const std::vector<std::string>& arguments, const Surroundings& surroundings,
           std::optional<std::size_t> columns, std::ostream& out, std::ostream& err);

} // namespace cimhost::cli

#endif
