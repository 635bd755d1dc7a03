#include "cli/Installation.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/Arguments.h"
#include "schema/MofReader.h"

#include <algorithm>
#include <cstdlib>
#include <initializer_list>
#include <sstream>
#include <system_error>

namespace cimhost::cli {

namespace {

namespace fs = std::filesystem;

std::optional<std::string> environmentVariable(const char* name)
{
    const char* value = std::getenv(name);
    return value != nullptr && *value != '\0' ? std::optional<std::string>(value) : std::nullopt;
}

std::vector<std::string> splitAtColons(const std::string& list)
{
    std::vector<std::string> parts;
    std::istringstream stream(list);
    for (std::string part; std::getline(stream, part, ':');)
        if (!part.empty())
            parts.push_back(part);
    return parts;
}

/// The first of these directories, given from the program's, that there is.
std::optional<fs::path> findDirectory(const fs::path& programDirectory,
                                      std::initializer_list<const char*> candidates)
{
    for (const char* candidate : candidates) {
        std::error_code ignored;
        const fs::path directory = (programDirectory / candidate).lexically_normal();
        if (fs::is_directory(directory, ignored))
            return directory;
    }
    return std::nullopt;
}

/// By name.
std::vector<std::string> filesIn(const fs::path& directory, const char* extension)
{
    std::vector<std::string> files;
    std::error_code error;
    for (fs::directory_iterator entry(directory, error), end; !error && entry != end; entry.increment(error))
        if (entry->path().extension() == extension)
            files.push_back(entry->path().string());
    std::sort(files.begin(), files.end());
    return files;
}

void append(const Registration& added, const std::string& file, Registration& all)
{
    for (const RegisteredClass& entry : added.classes) {
        const bool repeated =
            std::any_of(all.classes.begin(), all.classes.end(), [&](const RegisteredClass& other) {
                return cim::sameName(other.className, entry.className) && other.provider == entry.provider;
            });
        if (repeated)
            throw RegistrationError(cim::printable(file) + ": [" + entry.className +
                                    "] is registered with the provider " + entry.provider +
                                    " in another file already");
    }
    all.classes.insert(all.classes.end(), added.classes.begin(), added.classes.end());
}

} // namespace

Surroundings readSurroundings()
{
    std::error_code ignored;
    return {fs::read_symlink("/proc/self/exe", ignored).parent_path(),
            environmentVariable("CIMHOST_PROVIDER_DIR"), environmentVariable("CIMHOST_REGISTRATION"),
            environmentVariable("CIMHOST_SCHEMA")};
}

std::vector<std::string> findProviderDirectories(const Settings& settings, const Surroundings& surroundings)
{
    if (!settings.providerDirectories.empty())
        return settings.providerDirectories;
    if (surroundings.providerDirs)
        return splitAtColons(*surroundings.providerDirs);
    const std::optional<fs::path> directory =
        findDirectory(surroundings.programDirectory, {CIMHOST_PROVIDERDIR_FROM_BIN, "../lib"});
    return directory ? std::vector<std::string>{directory->string()} : std::vector<std::string>{};
}

std::optional<std::filesystem::path> findSchemaDirectory(const Surroundings& surroundings)
{
    return findDirectory(surroundings.programDirectory, {CIMHOST_SCHEMADIR_FROM_BIN, "../schema"});
}

std::vector<std::string> findRegistrationFiles(const Settings& settings, const Surroundings& surroundings)
{
    if (!settings.registrationFiles.empty())
        return settings.registrationFiles;
    if (surroundings.registrationFiles)
        return splitAtColons(*surroundings.registrationFiles);
    const std::optional<fs::path> directory = findSchemaDirectory(surroundings);
    std::vector<std::string> files = directory ? filesIn(*directory, ".reg") : std::vector<std::string>{};
    if (files.empty())
        throw UsageError("no registration of providers is installed beside the program; name a file with "
                         "--registration or CIMHOST_REGISTRATION");
    return files;
}

Registration readRegistrations(const std::vector<std::string>& files)
{
    Registration all;
    for (const std::string& file : files) {
        const Registration added = readRegistrationFile(file);
        if (added.classes.empty())
            throw RegistrationError("no class is registered in " + cim::printable(file));
        append(added, file, all);
    }
    return all;
}

std::vector<std::string> findSchemaFiles(const Settings& settings, const Surroundings& surroundings)
{
    if (!settings.schemaFiles.empty())
        return settings.schemaFiles;
    if (surroundings.schemaFiles)
        return splitAtColons(*surroundings.schemaFiles);
    const std::optional<fs::path> directory = findSchemaDirectory(surroundings);
    if (!directory)
        return {};
    std::vector<std::string> files = filesIn(*directory, ".mof");
    for (std::string& file : filesIn(*directory / "cimhost", ".mof"))
        files.push_back(std::move(file));
    return files;
}

schema::Classes readClasses(const std::vector<std::string>& files)
{
    std::vector<schema::Class> all;
    for (const std::string& file : files)
        for (schema::Class& declaration : schema::readMofFile(file).classes)
            all.push_back(std::move(declaration));
    return schema::Classes(std::move(all));
}

} // namespace cimhost::cli
