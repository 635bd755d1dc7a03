#include "Settings.h"

#include <algorithm>
#include <charconv>
#include <optional>
#include <string_view>
#include <system_error>

namespace MVLog {
namespace {

constexpr const char* syslogSocket = "/dev/log";
constexpr const char* journalSocket = "/run/systemd/journal/socket";

/// Empty where the variable is unset.
std::string_view valueOf(const Environment& environment, const char* name)
{
    const char* const value = environment(name);
    return value == nullptr ? std::string_view() : std::string_view(value);
}

std::string complaint(const char* name, std::string_view value, const std::string& expected)
{
    return std::string(name) + " is \"" + std::string(value) + "\", expected " + expected;
}

std::optional<std::int64_t> parseLevel(std::string_view text)
{
    if (text == "off")
        return off;
    int level = 0;
    const char* const end = text.data() + text.size();
    const auto [parsedEnd, error] = std::from_chars(text.data(), end, level);
    if (error != std::errc() || parsedEnd != end || level < 0)
        return std::nullopt;
    return level;
}

void readLevel(const Environment& environment, const char* name, std::int64_t& level, Settings& settings)
{
    const std::string_view text = valueOf(environment, name);
    if (text.empty())
        return;
    if (const std::optional<std::int64_t> parsed = parseLevel(text))
        level = *parsed;
    else
        settings.complaints.push_back(complaint(name, text,
                                                "a whole number from 0 to " + std::to_string(off - 1) +
                                                    " or off; taking " +
                                                    (level == off ? "off" : std::to_string(level))));
}

std::optional<Output> parseOutput(std::string_view text)
{
    const std::string_view::size_type colon = text.find(':');
    const std::string_view kind = text.substr(0, colon);
    const std::string path(colon == std::string_view::npos ? std::string_view() : text.substr(colon + 1));
    if (colon != std::string_view::npos && path.empty())
        return std::nullopt;

    if (kind == "stderr" && path.empty())
        return Output{Output::standardError, "", ""};
    if (kind == "file" && !path.empty())
        return Output{Output::file, path, ""};
    if (kind == "syslog")
        return Output{Output::syslog, path.empty() ? syslogSocket : path, ""};
    if (kind == "journal")
        return Output{Output::journal, path.empty() ? journalSocket : path, ""};
    return std::nullopt;
}

void readOutput(const Environment& environment, const char* name, Output& output, Settings& settings)
{
    const std::string_view text = valueOf(environment, name);
    if (text.empty())
        return;
    if (const std::optional<Output> parsed = parseOutput(text))
        output = {parsed->kind, parsed->path, name};
    else
        settings.complaints.push_back(complaint(
            name, text, "stderr, file:PATH, syslog, syslog:SOCKET, journal or journal:SOCKET; not used"));
}

std::vector<std::string> splitAtCommas(std::string_view list)
{
    std::vector<std::string> items;
    while (!list.empty()) {
        const std::string_view item = list.substr(0, list.find(','));
        if (!item.empty())
            items.emplace_back(item);
        list.remove_prefix(std::min(item.size() + 1, list.size()));
    }
    return items;
}

} // namespace

Settings readSettings(const Environment& environment)
{
    Settings settings;
    readLevel(environment, "MVLOG_LEVEL", settings.log.leastLevel, settings);
    readLevel(environment, "MVLOG_TRACE_LEVEL", settings.trace.leastLevel, settings);

    if (const std::string_view file = valueOf(environment, "MVLOG_FILE"); !file.empty())
        settings.log.output = {Output::file, std::string(file), "MVLOG_FILE"};
    readOutput(environment, "MVLOG_OUTPUT", settings.log.output, settings);
    settings.trace.output = settings.log.output;
    readOutput(environment, "MVLOG_TRACE_OUTPUT", settings.trace.output, settings);

    settings.categories = splitAtCommas(valueOf(environment, "MVLOG_CATEGORIES"));
    return settings;
}

bool isWanted(const std::vector<std::string>& categories, const std::string& category)
{
    const auto matches = [&](const std::string& pattern) {
        if (pattern.back() != '*')
            return category == pattern;
        const std::size_t size = pattern.size() - 1;
        return category.compare(0, size, pattern, 0, size) == 0;
    };
    return categories.empty() || std::any_of(categories.begin(), categories.end(), matches);
}

} // namespace MVLog
