/// \file
/// The log of the process.
#ifndef MVLOG_LOG_H
#define MVLOG_LOG_H

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <string>

namespace MVLog {

enum class Channel : std::size_t
{
    log,
    trace,
};

struct Line
{
    const char* function; ///< may be null
    const char* file;     ///< may be null
    int line;
    const std::string& category;
    int level;
    const std::string& text;
};

/// By channel, the least level that is written; the least number of all until the settings are read. Set up
/// at compile time and without destructor, so that objects constructed earlier or destroyed later than
/// anything of this library can log.
extern std::array<std::atomic<std::int64_t>, 2> leastLevels;

/// Writes the line if its level and category ask for it. May be called at any time, from any thread.
void writeUnlessDropped(Channel channel, const Line& line);

/// The same. A line that nobody listens to costs the comparison of two numbers.
inline void write(Channel channel, const Line& line)
{
    if (line.level >= leastLevels[static_cast<std::size_t>(channel)].load(std::memory_order_relaxed))
        writeUnlessDropped(channel, line);
}

} // namespace MVLog

#endif
