/// \file
/// Text that goes into a log line.
#ifndef MVLOG_ESCAPE_H
#define MVLOG_ESCAPE_H

#include <string>
#include <string_view>

namespace MVLog {

/// The text with every character escaped that acts instead of being seen (control characters, ends of lines and
/// paragraphs, those that turn the direction of writing), as MOF does, and U+FFFD in the place of each byte that is not
/// UTF-8: one line stays one line and says what it seems to say, and a terminal is sent no commands. Backslashes stay
/// as they are.
std::string printable(std::string_view text);

} // namespace MVLog

#endif
