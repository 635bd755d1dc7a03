/// \file
/// The log of the process: one for both channels.
#ifndef MVLOG_LOG_H
#define MVLOG_LOG_H

#include <string>

namespace MVLog {

struct Line
{
    const char* channel;  ///< not null
    const char* function; ///< may be null
    const char* file;     ///< may be null
    int line;
    const std::string& category;
    int level;
    const std::string& text;
};

/// Writes the line if its level asks for it. May be called at any time, from any thread.
void write(const Line& line);

} // namespace MVLog

#endif
