/// \file
/// The texts of all resource libraries.
#ifndef TAVRO_CATALOGUE_H
#define TAVRO_CATALOGUE_H

#include <string>

namespace Tavro {

/// The name under which the texts of a resource library in a language are asked for, such as
/// "2/en_US". Anything may stand in `language`, it is only looked up.
std::wstring catalogueName(int library, const std::string& language);

/// The text of a message from the catalogue with that name: in the language, else in the language without
/// its last part (zh_Hans_CN, zh_Hans, zh), else in English; the message id itself where English has none
/// either or where the name is not one of catalogueName's. It lives until the library is unloaded.
///
/// Each catalogue is read once, when it is first asked for. One that cannot be read or is broken
/// gives one error line in the log and counts as empty.
const std::wstring& findText(const std::wstring& catalogue, const std::wstring& messageId);

} // namespace Tavro

#endif
