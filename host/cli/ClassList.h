/// \file
/// What there is to ask.
#ifndef CIMHOST_CLI_CLASSLIST_H
#define CIMHOST_CLI_CLASSLIST_H

#include "broker/Registration.h"
#include "cli/FittedTable.h"

#include <string>

namespace cimhost::cli {

/// A row for each namespace and class: the provider, its library, and which questions it answers.
/// \param width  of the terminal
std::string classTable(const Registration& registration, std::size_t width = anyWidth);

} // namespace cimhost::cli

#endif
