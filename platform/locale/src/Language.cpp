#include "Tavro/Locale.h"

#include <algorithm>
#include <cstddef>
#include <cstdlib>
#include <initializer_list>
#include <string_view>

namespace Tavro::Locale {
namespace {

constexpr std::string_view defaultLanguage = "en_US";

/// Such as de_DE.UTF-8@euro; empty when nothing is said.
std::string_view localeForMessages()
{
    for (const char* const name : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        const char* const value = secure_getenv(name);
        if (value != nullptr && *value != '\0')
            return value;
    }
    return {};
}

bool isLanguageCharacter(char character)
{
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           (character >= '0' && character <= '9') || character == '-' || character == '_';
}

bool isLanguage(std::string_view text)
{
    return !text.empty() && text != "C" && text != "POSIX" &&
           std::all_of(text.begin(), text.end(), isLanguageCharacter);
}

} // namespace

std::string getLanguageId()
{
    const std::string_view locale = localeForMessages();
    const auto* const end =
        std::find_if(locale.begin(), locale.end(), [](char c) { return c == '.' || c == '@'; });
    const std::string_view language = locale.substr(0, static_cast<std::size_t>(end - locale.begin()));
    return std::string(isLanguage(language) ? language : defaultLanguage);
}

} // namespace Tavro::Locale
