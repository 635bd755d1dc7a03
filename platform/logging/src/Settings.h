/// \file
/// What the environment says about the log.
#ifndef MVLOG_SETTINGS_H
#define MVLOG_SETTINGS_H

#include <cstdint>
#include <functional>
#include <limits>
#include <string>
#include <vector>

namespace MVLog {

/// Above every level that a line may have: a channel from there up is off.
constexpr std::int64_t off = std::int64_t{std::numeric_limits<int>::max()} + 1;

/// Where lines go.
struct Output
{
    enum Kind
    {
        standardError,
        file,
        syslog,
        journal,
    };

    Kind kind = standardError;
    std::string path;          ///< of the file or of the daemon's socket; empty for standard error
    const char* variable = ""; ///< that asked for it
};

inline bool operator==(const Output& left, const Output& right)
{
    return left.kind == right.kind && left.path == right.path;
}

struct ChannelSettings
{
    std::int64_t leastLevel; ///< of the lines that are written, or `off`
    Output output;
};

struct Settings
{
    ChannelSettings log{6000, {}};
    ChannelSettings trace{off, {}};
    std::vector<std::string> categories; ///< those written, `*` at an end for any ending; none: all
    std::vector<std::string> complaints; ///< one sentence for each variable that could not be used
};

/// The value of an environment variable, or null.
using Environment = std::function<const char*(const char* name)>;

/// Reads the variables that MVLogger.h tells of.
Settings readSettings(const Environment& environment);

/// Whether lines of that category are written.
bool isWanted(const std::vector<std::string>& categories, const std::string& category);

} // namespace MVLog

#endif
