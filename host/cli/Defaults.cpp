#include "cli/Defaults.h"

#include "cim/RegularFile.h"
#include "cim/Utf8.h"
#include "cli/Arguments.h"
#include "cli/CheckingProgram.h"

#include <cstdlib>
#include <filesystem>
#include <map>
#include <optional>
#include <sstream>
#include <string_view>
#include <system_error>
#include <variant>

namespace cimhost::cli {

namespace {

namespace fs = std::filesystem;

constexpr const char* fileName = "cimhost.conf";
constexpr std::size_t mostBytes = 65536;

std::optional<fs::path> findFile(const std::vector<std::string>& registrationFiles,
                                 const Surroundings& surroundings)
{
    std::vector<fs::path> directories;
    directories.reserve(registrationFiles.size() + 1);
    for (const std::string& file : registrationFiles)
        directories.push_back(fs::path(file).parent_path());
    if (const std::optional<fs::path> schema = findSchemaDirectory(surroundings))
        directories.push_back(*schema);
    for (const fs::path& directory : directories) {
        std::error_code ignored;
        if (fs::exists(directory / fileName, ignored))
            return directory / fileName;
    }
    return std::nullopt;
}

std::string_view trimmed(std::string_view text)
{
    constexpr std::string_view blanks = " \t\r";
    const std::size_t start = text.find_first_not_of(blanks);
    return start == std::string_view::npos ? ""
                                           : text.substr(start, text.find_last_not_of(blanks) + 1 - start);
}

Defaults parse(const std::string& text, const std::string& name)
{
    Defaults defaults;
    const std::map<std::string_view, std::string*> entries{
        {"watch", &defaults.watchedClass},
        {"inventory-variable", &defaults.inventoryVariable},
        {"inventory-check", &defaults.inventoryCheck}};
    std::istringstream lines(text);
    int number = 0;
    for (std::string line; std::getline(lines, line);) {
        ++number;
        const std::string_view content = trimmed(line);
        if (content.empty() || content.front() == '#')
            continue;
        const std::size_t colon = content.find(':');
        const auto entry = entries.find(trimmed(content.substr(0, colon)));
        const std::string_view value =
            colon == std::string_view::npos ? std::string_view() : trimmed(content.substr(colon + 1));
        if (entry == entries.end() || value.empty())
            throw UsageError(
                name + ':' + std::to_string(number) +
                ": expected watch, inventory-variable or inventory-check, a colon and a value, found \"" +
                cim::excerpt(content) + '"');
        *entry->second = value;
    }
    return defaults;
}

} // namespace

Defaults readDefaults(const std::vector<std::string>& registrationFiles, const Surroundings& surroundings)
{
    const std::optional<fs::path> file = findFile(registrationFiles, surroundings);
    if (!file)
        return {};
    const std::string name = cim::printable(file->string());
    try {
        Defaults defaults = parse(cim::RegularFile(file->string()).read(mostBytes), name);
        if (!defaults.inventoryCheck.empty())
            defaults.inventoryCheck =
                (file->parent_path() / defaults.inventoryCheck).lexically_normal().string();
        return defaults;
    } catch (const cim::FileError& error) {
        throw UsageError("cannot read " + name + ": " + error.what());
    }
}

Command complete(Command command, const Defaults& defaults)
{
    auto* const watch = std::get_if<Watch>(&command);
    if (watch == nullptr || !watch->target.className.empty())
        return command;
    if (defaults.watchedClass.empty())
        throw UsageError(
            "watch needs a class: there is no cimhost.conf beside the registrations that names one");
    watch->target.className = defaults.watchedClass;
    return command;
}

void useInventory(const std::string& file, const Defaults& defaults)
{
    if (defaults.inventoryVariable.empty())
        throw UsageError(
            "--inventory has no meaning here: there is no cimhost.conf beside the registrations that names "
            "the environment variable which the providers read it from");
    try {
        const cim::RegularFile readable(file);
    } catch (const cim::FileError& error) {
        throw UsageError("cannot read the inventory " + cim::printable(file) + ": " + error.what());
    }
    const std::string complaint =
        defaults.inventoryCheck.empty() ? "" : complaintOf(defaults.inventoryCheck, file);
    if (!complaint.empty())
        throw UsageError("no inventory: " + cim::printable(file) + ": " + complaint);
    setenv(defaults.inventoryVariable.c_str(), file.c_str(), 1);
}

} // namespace cimhost::cli
