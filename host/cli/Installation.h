/// \file
/// Where the providers and their registrations are.
#ifndef CIMHOST_CLI_INSTALLATION_H
#define CIMHOST_CLI_INSTALLATION_H

#include "broker/Registration.h"
#include "cli/Command.h"
#include "schema/Classes.h"

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace cimhost::cli {

/// What the program finds itself in.
struct Surroundings
{
    std::filesystem::path programDirectory;       ///< the folder of the executable
    std::optional<std::string> providerDirs;      ///< CIMHOST_PROVIDER_DIR
    std::optional<std::string> registrationFiles; ///< CIMHOST_REGISTRATION
    std::optional<std::string> schemaFiles{};     ///< CIMHOST_SCHEMA
};

/// Those of this process.
Surroundings readSurroundings();

/// The directories of the command line; without any, those of the environment; without these, the
/// provider directory of the installed tree that the executable stands in, or else the library
/// directory of the build tree. None, if there is none of these.
std::vector<std::string> findProviderDirectories(const Settings& settings, const Surroundings& surroundings);

/// The directory of registrations in the tree that the executable stands in, installed or built, if there is
/// one.
std::optional<std::filesystem::path> findSchemaDirectory(const Surroundings& surroundings);

/// The files of the command line; without any, those of the environment; without these, every .reg
/// file, by name, in the schema directory.
/// \throws UsageError  there is none
std::vector<std::string> findRegistrationFiles(const Settings& settings, const Surroundings& surroundings);

/// The classes of all files.
/// \throws RegistrationError  also for a file without any class, and for a class that two files register
/// with the same provider
Registration readRegistrations(const std::vector<std::string>& files);

/// The files of the command line; without any, those of the environment; without these, every .mof file, by
/// name, in the schema directory and in its folder `cimhost`, where the classes are that a broker brings
/// itself. None, if there is none of these.
std::vector<std::string> findSchemaFiles(const Settings& settings, const Surroundings& surroundings);

/// The classes of all files.
/// \throws schema::MofError  also for a class that two files declare
schema::Classes readClasses(const std::vector<std::string>& files);

} // namespace cimhost::cli

#endif
