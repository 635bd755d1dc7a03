#include "Tavro/Locale.h"

#include <array>

#include <utf8proc.h>

namespace Tavro {
namespace {

constexpr utf8proc_int32_t replacementCharacter = 0xFFFD;

void appendUtf8(std::string& text, char32_t character)
{
    const auto codePoint = static_cast<utf8proc_int32_t>(character);
    std::array<utf8proc_uint8_t, 4> bytes{};
    const utf8proc_ssize_t count = utf8proc_encode_char(
        utf8proc_codepoint_valid(codePoint) ? codePoint : replacementCharacter, bytes.data());
    text.append(bytes.begin(), bytes.begin() + count);
}

} // namespace

std::string make_string(const std::wstring& text)
{
    std::string utf8;
    utf8.reserve(text.size());
    for (const wchar_t character : text)
        appendUtf8(utf8, static_cast<char32_t>(character));
    return utf8;
}

} // namespace Tavro
