#include "cim/Utf8.h"

#include <algorithm>
#include <array>
#include <cstdio>

#include <utf8proc.h>

namespace cimhost::cim {

namespace {

constexpr char32_t replacementCharacter = 0xFFFD;

std::string escapeOf(char32_t character)
{
    switch (character) {
    case '\b':
        return "\\b";
    case '\t':
        return "\\t";
    case '\n':
        return "\\n";
    case '\f':
        return "\\f";
    case '\r':
        return "\\r";
    default:
        break;
    }
    std::array<char, 8> text{};
    std::snprintf(text.data(), text.size(), "\\x%04X", static_cast<unsigned int>(character));
    return text.data();
}

} // namespace

std::optional<char32_t> takeCharacter(std::string_view& text)
{
    utf8proc_int32_t character = 0;
    const auto* bytes = reinterpret_cast<const utf8proc_uint8_t*>(text.data());
    const utf8proc_ssize_t length =
        utf8proc_iterate(bytes, static_cast<utf8proc_ssize_t>(text.size()), &character);
    text.remove_prefix(length > 0 ? static_cast<std::size_t>(length) : 1);
    return length > 0 ? std::optional(static_cast<char32_t>(character)) : std::nullopt;
}

void appendCharacter(std::string& text, char32_t character)
{
    std::array<utf8proc_uint8_t, 4> bytes{};
    const utf8proc_ssize_t length =
        utf8proc_encode_char(static_cast<utf8proc_int32_t>(character), bytes.data());
    text.append(bytes.begin(), bytes.begin() + length);
}

bool isControl(char32_t character)
{
    switch (utf8proc_category(static_cast<utf8proc_int32_t>(character))) {
    case UTF8PROC_CATEGORY_CC:
    case UTF8PROC_CATEGORY_ZL:
    case UTF8PROC_CATEGORY_ZP:
        return true;
    default:
        break;
    }
    const bool mark = character == 0x061C || character == 0x200E || character == 0x200F;
    const bool embedding = character >= 0x202A && character <= 0x202E;
    const bool isolate = character >= 0x2066 && character <= 0x2069;
    return mark || embedding || isolate;
}

std::string printable(std::string_view text)
{
    std::string result;
    while (!text.empty()) {
        const char32_t character = takeCharacter(text).value_or(replacementCharacter);
        if (isControl(character))
            result += escapeOf(character);
        else
            appendCharacter(result, character);
    }
    return result;
}

std::string excerpt(std::string_view text, std::size_t most)
{
    std::string_view rest = text;
    for (; most > 0 && !rest.empty(); --most)
        takeCharacter(rest);
    const std::string beginning = printable(text.substr(0, text.size() - rest.size()));
    return rest.empty() ? beginning : beginning + "...";
}

std::string escaped(std::string_view text, std::string_view quoted)
{
    std::string result;
    for (const char byte : text) {
        if (byte == '\\' || quoted.find(byte) != std::string_view::npos)
            result += '\\';
        result += byte;
    }
    return printable(result);
}

std::size_t displayWidth(std::string_view text)
{
    std::size_t width = 0;
    while (!text.empty()) {
        const char32_t character = takeCharacter(text).value_or(replacementCharacter);
        width += static_cast<std::size_t>(
            std::max(0, utf8proc_charwidth(static_cast<utf8proc_int32_t>(character))));
    }
    return width;
}

} // namespace cimhost::cim
