#include "Catalogue.h"

#include <algorithm>
#include <array>

namespace Tavro {
namespace {

constexpr wchar_t separator = L'/';

struct Text
{
    std::wstring_view library;
    std::wstring_view messageId;
    std::wstring_view english;
};

constexpr std::array texts = {
    Text{L"2", L"MSGID_ALARMDEVICE_CAPTION", L"Diagnostic Indicator"},
};

} // namespace

std::wstring catalogueName(int library, const std::string& language)
{
    // Names of languages are ASCII; of anything else no catalogue exists, whatever it widens to.
    return std::to_wstring(library) + separator + std::wstring(language.begin(), language.end());
}

// Every language has the English texts so far: what follows the separator makes no difference yet.
std::optional<std::wstring_view> findText(std::wstring_view catalogue, std::wstring_view messageId)
{
    const std::wstring_view::size_type end = catalogue.find(separator);
    if (end == std::wstring_view::npos)
        return std::nullopt;
    const std::wstring_view library = catalogue.substr(0, end);

    const auto* const found = std::find_if(texts.begin(), texts.end(), [&](const Text& text) {
        return text.library == library && text.messageId == messageId;
    });
    if (found == texts.end())
        return std::nullopt;
    return found->english;
}

} // namespace Tavro
