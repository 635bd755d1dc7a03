/// \file
/// Names that programs gave, as people read them.
#ifndef TAVRO_WORDS_H
#define TAVRO_WORDS_H

#include <string>
#include <string_view>

namespace Tavro {

/// The text in UTF-8, with `\xHH` for each byte that is a backslash, no UTF-8, part of a character that acts
/// instead of being seen, or a blank at the end, where readers strip it. Different texts stay different.
std::string printable(std::string_view text);

/// The words that a name is made of, one blank between them, such as "Fan 1 Fault" for "fan1_fault",
/// "Array Device 03" for "ArrayDevice03" and "Caps Lock" for "capslock". Printable; empty where the name has
/// nothing but blanks, hyphens and underscores.
std::string inWords(std::string_view name);

} // namespace Tavro

#endif
