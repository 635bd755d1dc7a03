/// \file
/// A program that judges a file.
#ifndef CIMHOST_CLI_CHECKINGPROGRAM_H
#define CIMHOST_CLI_CHECKINGPROGRAM_H

#include <string>

namespace cimhost::cli {

/// Runs the program with the name of the file as its argument.
/// \return the first line of what it prints, printable, where it exits with 1: what is wrong with the file. Empty, where
/// it exits otherwise or cannot be run
std::string complaintOf(const std::string& program, const std::string& file);

} // namespace cimhost::cli

#endif
