#include "Tavro/Locale.h"

#include "Catalogue.h"

namespace Tavro {

std::wstring Locale::getResourceLibrary(int library, const std::string& language)
{
    return catalogueName(library, language);
}

// The pointer is that to a text of the library, which is nobody's to delete: nothing is allocated for one that is asked
// for over and over.
struct ResourceString::Implementation
{};

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
    : implementation_(
          reinterpret_cast<Implementation*>(const_cast<std::wstring*>(findText(library, messageId))))
{}

ResourceString::~ResourceString()
{
    (void)implementation_.release();
}

ResourceString::operator std::wstring() const
{
    return *reinterpret_cast<const std::wstring*>(implementation_.get());
}

} // namespace Tavro
