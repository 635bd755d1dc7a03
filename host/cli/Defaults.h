/// \file
/// What an installation of providers says of itself to this program, in a file `cimhost.conf` beside its
/// registrations:
///
///     # a comment
///     watch: CIM_AlarmDevice
///     inventory-variable: EXAMPLE_INVENTORY
///     inventory-check: ../libexec/example-check
///
/// Each entry may be left out, and so may the file.
#ifndef CIMHOST_CLI_DEFAULTS_H
#define CIMHOST_CLI_DEFAULTS_H

#include "cli/Command.h"
#include "cli/Installation.h"

#include <string>
#include <vector>

namespace cimhost::cli {

struct Defaults
{
    std::string watchedClass;      ///< `watch:` what the command watches without a class; empty: nothing
    std::string inventoryVariable; ///< `inventory-variable:` what --inventory sets; empty: nothing
    /// `inventory-check:` a program that judges inventories, as complaintOf() calls it; empty: none
    std::string inventoryCheck;
};

/// Reads the first such file: beside the registrations, in their order, then in the schema directory of the
/// tree that the executable stands in.
/// \throws UsageError  it cannot be read, or has another line
Defaults readDefaults(const std::vector<std::string>& registrationFiles, const Surroundings& surroundings);

/// The command with its class, where it leaves that to the installation.
/// \throws UsageError  which has none
Command complete(Command command, const Defaults& defaults);

/// Sets the environment variable of the inventory for the providers that will be loaded.
/// \throws UsageError  there is no such variable, or the file cannot be read, is no regular one, or no
/// inventory, as the installation's program judges; without one what it holds is the providers' concern
void useInventory(const std::string& file, const Defaults& defaults);

} // namespace cimhost::cli

#endif
