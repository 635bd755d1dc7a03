/// \file
#ifndef TAVRO_FILENODESOURCE_H
#define TAVRO_FILENODESOURCE_H

#include "NodeSource.h"

namespace Tavro {

/// The inventory file named by the environment variable TAVRO_INVENTORY.
class FileNodeSource : public NodeSource
{
public:
    [[nodiscard]] std::vector<Node> read() const override;
    /// The path as it stands in the file, where people wrote it.
    [[nodiscard]] std::string displayText(const std::string& path) const override;
};

} // namespace Tavro

#endif
