#include "Tavro/Locale.h"

#include "Catalogue.h"

namespace Tavro {

std::wstring Locale::getResourceLibrary(int library, const std::string& language)
{
    return catalogueName(library, language);
}

// A caption is asked for with every object. So the one pointer that this class has is that to a text which the catalogues
// keep, in the place of one to an implementation of its own: nothing is allocated, and nothing is deleted.
struct ResourceString::Implementation
{};

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
    : implementation_(
          reinterpret_cast<Implementation*>(const_cast<std::wstring*>(&findText(library, messageId))))
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
