#include "Escape.h"

#include <algorithm>
#include <array>
#include <cstddef>

#include <spdlog/fmt/fmt.h>

namespace MVLog {
namespace {

constexpr const char* replacementCharacter = "\xEF\xBF\xBD";

struct Character
{
    char32_t code;
    std::size_t size; ///< in bytes; 0: the text does not begin with a character
};

/// The first character of a text in UTF-8 that is not empty.
Character firstOf(std::string_view text)
{
    const auto byte = [text](std::size_t index) { return static_cast<unsigned char>(text[index]); };
    if (byte(0) < 0x80)
        return {byte(0), 1};
    // By size: the bits that tell it, their mask, the least code that takes so many bytes.
    struct Form
    {
        unsigned int mark, mask;
        char32_t least;
    };
    static constexpr std::array forms{Form{0xC0, 0xE0, 0x80}, Form{0xE0, 0xF0, 0x800},
                                      Form{0xF0, 0xF8, 0x10000}};
    for (std::size_t size = 2; size <= 4; ++size) {
        const Form& form = forms.at(size - 2);
        if ((byte(0) & form.mask) != form.mark || text.size() < size)
            continue;
        char32_t code = byte(0) & ~form.mask;
        for (std::size_t i = 1; i < size; ++i) {
            if ((byte(i) & 0xC0U) != 0x80)
                return {0, 0};
            code = code << 6U | (byte(i) & 0x3FU);
        }
        const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
        return {code, code < form.least || code > 0x10FFFF || isSurrogate ? 0 : size};
    }
    return {0, 0};
}

bool isControl(char32_t code)
{
    struct Range
    {
        char32_t first, last;
    };
    // C0; DEL and C1; marks, ends of lines, embeddings and isolates, by which the direction of writing turns.
    static constexpr std::array ranges{Range{0, 0x1F},        Range{0x7F, 0x9F},     Range{0x61C, 0x61C},
                                       Range{0x200E, 0x200F}, Range{0x2028, 0x202E}, Range{0x2066, 0x2069}};
    return std::any_of(ranges.begin(), ranges.end(),
                       [code](const Range& range) { return code >= range.first && code <= range.last; });
}

std::string escapeOf(char32_t code)
{
    switch (code) {
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
        return fmt::format("\\x{:04X}", static_cast<unsigned int>(code));
    }
}

} // namespace

std::string printable(std::string_view text)
{
    std::string result;
    result.reserve(text.size());
    while (!text.empty()) {
        const auto [code, size] = firstOf(text);
        if (size == 0)
            result += replacementCharacter;
        else if (isControl(code))
            result += escapeOf(code);
        else
            result += text.substr(0, size);
        text.remove_prefix(size == 0 ? 1 : size);
    }
    return result;
}

} // namespace MVLog
