// Another maker's locale library, whose texts say what they were asked for by.

#include <Tavro/Locale.h>

namespace Tavro {

namespace Locale {

std::string getLanguageId()
{
    return "xx";
}

std::wstring getResourceLibrary(int library, const std::string& language)
{
    return std::to_wstring(library) + L" in " + std::wstring(language.begin(), language.end());
}

} // namespace Locale

struct ResourceString::Implementation
{
    std::wstring text;
};

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
    : implementation_(new Implementation{L"replaced " + messageId + L" of " + library})
{}

ResourceString::~ResourceString() = default;
ResourceString::operator std::wstring() const
{
    return implementation_->text;
}

std::string make_string(const std::wstring& text)
{
    std::string narrow;
    for (const wchar_t character : text)
        narrow += static_cast<char>(character);
    return narrow;
}

} // namespace Tavro
