#include "Settings.h"

#include <charconv>
#include <cstdlib>
#include <limits>
#include <optional>
#include <string_view>
#include <system_error>

namespace MVLog {
namespace {

/// Empty where the variable is unset.
std::string_view environment(const char* name)
{
    const char* const value = std::getenv(name);
    return value == nullptr ? std::string_view() : std::string_view(value);
}

std::optional<int> parseLevel(std::string_view text)
{
    int level = 0;
    const char* const end = text.data() + text.size();
    const auto [parsedEnd, error] = std::from_chars(text.data(), end, level);
    if (error != std::errc() || parsedEnd != end || level < 0)
        return std::nullopt;
    return level;
}

} // namespace

Settings readSettings()
{
    Settings settings;
    settings.file = environment("MVLOG_FILE");

    const std::string_view levelText = environment("MVLOG_LEVEL");
    if (levelText.empty())
        return settings;
    if (const std::optional<int> level = parseLevel(levelText))
        settings.leastLevel = *level;
    else
        settings.complaints.push_back("MVLOG_LEVEL is \"" + std::string(levelText) +
                                      "\", expected a whole number from 0 to " +
                                      std::to_string(std::numeric_limits<int>::max()) + "; taking " +
                                      std::to_string(settings.leastLevel));
    return settings;
}

} // namespace MVLog
