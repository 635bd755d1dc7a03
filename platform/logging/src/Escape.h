/// \file
/// Text that goes into a log line.
#ifndef MVLOG_ESCAPE_H
#define MVLOG_ESCAPE_H

#include <string>
#include <string_view>

namespace MVLog {

/// Control characters as \xHH: one line stays one line, and a terminal is sent no commands.
std::string withControlCharactersEscaped(std::string_view text);

} // namespace MVLog

#endif
