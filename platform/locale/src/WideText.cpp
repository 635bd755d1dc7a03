#include "Tavro/Locale.h"

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
    std::string utf8(text.size(), '\0');
    std::size_t done = 0;
    for (; done < text.size() && isAscii(text[done]); ++done)
        utf8[done] = static_cast<char>(text[done]);
    utf8.resize(done);
    for (; done < text.size(); ++done)
        appendUtf8(utf8, static_cast<char32_t>(text[done]));
    return utf8;
}

} // namespace Tavro
