#include "Tavro/Locale.h"

#include "Catalogue.h"

namespace Tavro {

std::wstring Locale::getResourceLibrary(int library, const std::string& language)
{
    return catalogueName(library, language);
}

struct ResourceString::Implementation
{
    const std::wstring* found; ///< in a catalogue; null: nobody has a text
    std::wstring messageId;    ///< only where nobody has
};

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
    : implementation_(new Implementation{findText(library, messageId), {}})
{
    if (implementation_->found == nullptr)
        implementation_->messageId = messageId;
}

ResourceString::~ResourceString() = default;

ResourceString::operator std::wstring() const
{
    return implementation_->found != nullptr ? *implementation_->found : implementation_->messageId;
}

} // namespace Tavro
