/// \file
/// The English texts are part of the library, so that there is always one language.
#ifndef TAVRO_ENGLISHCATALOGUE_H
#define TAVRO_ENGLISHCATALOGUE_H

#include <string_view>

namespace Tavro {

/// The content of the English message catalogue; the build makes it of catalogues/en.po.
extern const std::string_view englishCatalogue;

} // namespace Tavro

#endif
