/// \file
/// Where the message catalogues lie.
#ifndef TAVRO_CATALOGUEDIRECTORY_H
#define TAVRO_CATALOGUEDIRECTORY_H

#include <string>

namespace Tavro {

/// The folder that lies to this library's file as where both are installed or built, wherever that tree was
/// moved to. It need not exist.
std::string installedCatalogues();

} // namespace Tavro

#endif
