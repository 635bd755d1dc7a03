// Names of LEDs, which anybody may have chosen: shown in words that are never empty and always printable.

#include "FuzzTarget.h"

#include "LedName.h"
#include "Words.h"

#include <utf8proc.h>

namespace {

void requirePrintable(const std::string& text)
{
    utf8proc_ssize_t position = 0;
    const auto size = static_cast<utf8proc_ssize_t>(text.size());
    const auto* const bytes = reinterpret_cast<const utf8proc_uint8_t*>(text.data());
    while (position < size) {
        utf8proc_int32_t character = -1;
        const utf8proc_ssize_t length = utf8proc_iterate(bytes + position, size - position, &character);
        Fuzz::require(length > 0, "what is shown is UTF-8");
        Fuzz::require(utf8proc_category(character) != UTF8PROC_CATEGORY_CC, "no control character is shown");
        position += length;
    }
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string name = Fuzz::textOf(data, size);
    const std::string words = Tavro::describeLed(name);
    Fuzz::require(!words.empty(), "a LED has a description");
    requirePrintable(words);
    requirePrintable(Tavro::inWords(name));

    const std::string printed = Tavro::printable(name);
    requirePrintable(printed);
    Fuzz::require(printed.size() >= name.size() && printed.empty() == name.empty(), "nothing is lost");
    return 0;
}
