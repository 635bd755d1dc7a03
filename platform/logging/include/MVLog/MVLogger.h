/// \file
/// Log lines of the management software.
///
/// There are two channels, log and trace. By default every line of the log from level 6000 up goes to
/// standard error, and the trace is off. Environment variables, read once, at the first line of the process,
/// say otherwise:
///
///     MVLOG_LEVEL         the least level of the log that is written, a whole number from 0, or off;
///                         3000 adds the flow lines
///     MVLOG_OUTPUT        where the log goes: stderr, file:PATH, syslog, journal; after syslog and journal
///                         may stand :SOCKET for another socket than the system's
///     MVLOG_FILE          as MVLOG_OUTPUT=file:PATH, which goes before it
///     MVLOG_TRACE_LEVEL   the least level of the trace that is written; off if unset
///     MVLOG_TRACE_OUTPUT  where the trace goes; where the log goes, if unset
///     MVLOG_CATEGORIES    the categories that are written, of both channels, separated by commas; * at
///                         the end stands for any ending; all, if unset
///
/// A value that cannot be used, or an output that cannot be opened, is complained of once on standard
/// error; the default holds in its place, for an output standard error. An empty variable counts as unset.
///
/// No variable counts in a program that runs with more rights than its caller's (secure_getenv). A file's name may
/// be no symbolic link.
///
/// A file that was moved away or removed is made anew at the next line. Lines beyond what a destination takes
/// are lost.
#ifndef MVLOG_MVLOGGER_H
#define MVLOG_MVLOGGER_H

#include <string>

namespace MVLog {

/// Both functions may be called from any thread at any time, also before main and while static
/// objects are destroyed, and in a child of fork(). A line is written whole, with the characters escaped that drive a
/// terminal or turn the direction of writing, and U+FFFD in the place of bytes that are not UTF-8. Nothing but
/// std::bad_alloc is thrown: a line that cannot be written is lost, and the first such loss of a destination
/// is complained of on standard error. A line below its channel's level costs a comparison.
///
/// Of both:
/// - function, file, line: where the line comes from; the texts may be null
/// - category: the module, such as "Mavrel.Glimmark"
/// - level: the higher the graver: 3000 flow of calls, 6000 error
/// - reserved, and the two numbers after it: not used, null and 0
/// - text: the message
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
