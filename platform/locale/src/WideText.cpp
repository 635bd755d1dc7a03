#include "Tavro/Locale.h"

#include <algorithm>
#include <array>
#include <cstddef>

#include <utf8proc.h>

namespace Tavro {
namespace {

constexpr utf8proc_int32_t replacementCharacter = 0xFFFD;

bool isAscii(wchar_t character)
{
    return static_cast<char32_t>(character) < 0x80;
}

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
    // Most texts are ASCII from one end to the other, which is UTF-8 as it stands.
    auto rest = std::find_if_not(text.begin(), text.end(), isAscii);
    std::string utf8(text.begin(), rest);
    for (; rest != text.end(); ++rest)
        appendUtf8(utf8, static_cast<char32_t>(*rest));
    return utf8;
}

} // namespace Tavro
