/// \file
/// Reads what msgfmt made of a language's texts.
#ifndef TAVRO_MESSAGECATALOGUE_H
#define TAVRO_MESSAGECATALOGUE_H

#include <map>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Tavro {

/// The content is not that of a message catalogue; what() says where and what was expected there.
class CatalogueError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// Texts by message. A message with a context has the context, the byte 4 and its id for a key, as
/// GNU gettext has it. The entry with the empty key is the catalogue's own description.
using Messages = std::map<std::string, std::wstring, std::less<>>;

/// Reads a catalogue in GNU gettext's binary format (.mo), of either byte order and of any revision
/// whose major number is 0; texts are UTF-8. Messages without a text are left out.
/// \throw CatalogueError
Messages readMessages(std::string_view content);

} // namespace Tavro

#endif
