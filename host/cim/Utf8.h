/// \file
/// Text as it may go to a terminal. CIM text is UTF-8 and may come from anywhere; what is shown must
/// neither drive the terminal nor break the line that it stands in.
#ifndef CIMHOST_CIM_UTF8_H
#define CIMHOST_CIM_UTF8_H

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace cimhost::cim {

/// Takes the first character off `text`, which is not empty. Nothing: it does not begin with a
/// well-formed character; one byte is then taken off.
std::optional<char32_t> takeCharacter(std::string_view& text);

/// Appends the character in UTF-8.
void appendCharacter(std::string& text, char32_t character);

/// A character that acts instead of being seen: the control characters (C0, DEL, C1), line and
/// paragraph separators, and those that turn the direction of writing.
bool isControl(char32_t character);

/// The text with every such character escaped as MOF does (`\n`, `\x001B`), and U+FFFD in the place
/// of each byte that is not UTF-8. Backslashes stay as they are: this is for reading, not for parsing.
std::string printable(std::string_view text);

/// The printable beginning of a text, for a message: after `most` characters stands "..." for the rest.
std::string excerpt(std::string_view text, std::size_t most = 60);

/// As printable(), with the characters of `quoted` and the backslash escaped by a backslash too: the
/// inside of a MOF string or character literal.
std::string escaped(std::string_view text, std::string_view quoted);

/// How many columns of a terminal printable text takes: two for an East Asian wide character, none
/// for a combining one.
std::size_t displayWidth(std::string_view text);

} // namespace cimhost::cim

#endif
