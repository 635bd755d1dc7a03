#include "Escape.h"

#include <spdlog/fmt/fmt.h>

namespace MVLog {

std::string withControlCharactersEscaped(std::string_view text)
{
    std::string escaped;
    escaped.reserve(text.size());
    for (const char character : text) {
        const auto code = static_cast<unsigned char>(character);
        if (code < 0x20 || code == 0x7F)
            escaped += fmt::format("\\x{:02X}", code);
        else
            escaped += character;
    }
    return escaped;
}

} // namespace MVLog
