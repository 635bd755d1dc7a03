/// \file
/// A log line in the form that each destination takes. The message handed in has the line's category for its
/// logger's name, its level among debug, info and error, and no control characters in its text.
#ifndef MVLOG_FORMATTERS_H
#define MVLOG_FORMATTERS_H

#include <memory>

#include <spdlog/formatter.h>

namespace MVLog {

/// A line of text with time, process and thread in front, and a newline.
std::unique_ptr<spdlog::formatter> lineFormatter();

/// As RFC 3164 has it and syslog(3) sends it: facility daemon, the program's name and process.
std::unique_ptr<spdlog::formatter> syslogFormatter();

/// In the systemd journal's native protocol, with the fields MESSAGE, PRIORITY, SYSLOG_IDENTIFIER, CODE_FILE,
/// CODE_LINE, CODE_FUNC and MVLOG_CATEGORY.
std::unique_ptr<spdlog::formatter> journalFormatter();

} // namespace MVLog

#endif
