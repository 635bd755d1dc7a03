/// \file
/// The texts of all resource libraries.
#ifndef TAVRO_CATALOGUE_H
#define TAVRO_CATALOGUE_H

#include <optional>
#include <string>
#include <string_view>

namespace Tavro {

/// The name under which the texts of a resource library in a language are asked for, such as
/// "2/en_US". Anything may stand in `language`, it is only looked up.
std::wstring catalogueName(int library, const std::string& language);

/// The text of a message from the catalogue with that name; in English where the language has none;
/// nothing where English has none either or where the name is not one of catalogueName's.
std::optional<std::wstring_view> findText(std::wstring_view catalogue, std::wstring_view messageId);

} // namespace Tavro

#endif
