/// \file
#ifndef TAVRO_FILENODESOURCE_H
#define TAVRO_FILENODESOURCE_H

#include "Node.h"

#include <string>
#include <vector>

namespace Tavro {

/// The nodes that stand in an inventory file, then those of the sources that it names. A file that cannot be
/// read or is no inventory has none, and one error line in the log says why. Throws nothing but
/// std::bad_alloc.
std::vector<Node> readNodesOfFile(const std::string& file);

} // namespace Tavro

#endif
