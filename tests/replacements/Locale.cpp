// Another maker's locale library, which has one text for everything.

#include <Tavro/Locale.h>

namespace Tavro {

namespace Locale {

std::string getLanguageId()
{
    return "xx";
}
std::wstring getResourceLibrary(int, const std::string&)
{
    return L"replaced";
}

} // namespace Locale

struct ResourceString::Implementation
{};

ResourceString::ResourceString(const std::wstring&, const std::wstring&) {}
ResourceString::~ResourceString() = default;
ResourceString::operator std::wstring() const
{
    return L"replaced caption";
}

std::string make_string(const std::wstring& text)
{
    return {text.begin(), text.end()};
}

} // namespace Tavro
