/// \file
/// Log lines of the management software.
///
/// By default every line from level 6000 up goes to standard error. Two environment variables, read
/// once, at the first line of the process, say otherwise:
///
///     MVLOG_LEVEL  the least level that is written, a whole number from 0; 3000 adds the flow lines
///     MVLOG_FILE   the file that lines are appended to, in place of standard error
///
/// A value that cannot be used, or a file that cannot be opened, is complained of once on standard
/// error; the default holds in its place. An empty variable counts as unset.
#ifndef MVLOG_MVLOGGER_H
#define MVLOG_MVLOGGER_H

#include <string>

namespace MVLog {

/// Both functions may be called from any thread at any time, also before main and while static
/// objects are destroyed. A line is written whole, with its control characters escaped. Nothing but
/// std::bad_alloc is thrown: a line that cannot be written is lost, and the first such loss is
/// complained of on standard error.
///
/// \param function, file, line  where the line comes from; the texts may be null
/// \param category              the module, such as "Mavrel.Glimmark"
/// \param level                 the higher the graver: 3000 flow of calls, 6000 error
/// \param reserved              and the two numbers after it: not used, null and 0
/// \param text                  the message
class MVLogger
{
public:
    /// Writes to the log channel.
    static void logLevelMessage(const char* function, const char* file, int line, const std::string& category,
                                int level, const char* reserved, int, int, const std::string& text);

    /// Writes to the trace channel.
    static void traceLevelMessage(const char* function, const char* file, int line,
                                  const std::string& category, int level, const char* reserved, int, int,
                                  const std::string& text);
};

} // namespace MVLog

#endif
