#include "Tavro/Locale.h"

#include "Catalogue.h"

namespace Tavro {

std::wstring Locale::getResourceLibrary(int library, const std::string& language)
{
    return catalogueName(library, language);
}

struct ResourceString::Implementation
{
    std::wstring text;
};

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
    : implementation_(std::make_unique<Implementation>())
{
    implementation_->text = findText(library, messageId).value_or(messageId);
}

ResourceString::~ResourceString() = default;

ResourceString::operator std::wstring() const
{
    return implementation_->text;
}

} // namespace Tavro
