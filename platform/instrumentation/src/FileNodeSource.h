/// \file
#ifndef TAVRO_FILENODESOURCE_H
#define TAVRO_FILENODESOURCE_H

#include "NodeSource.h"

#include <string>
#include <utility>

namespace Tavro {

/// An inventory file: the nodes that stand in it, then those of the sources that it names.
class FileNodeSource : public NodeSource
{
public:
    explicit FileNodeSource(std::string file) : file_(std::move(file)) {}

    [[nodiscard]] std::vector<Node> read() const override;

private:
    std::string file_;
};

} // namespace Tavro

#endif
