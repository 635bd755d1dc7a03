/// \file
#ifndef TAVRO_NODE_H
#define TAVRO_NODE_H

#include <memory>
#include <optional>
#include <string>

namespace Tavro {

/// A node of the hardware inventory.
struct Node
{
    unsigned int kind = 0; ///< one of NodeLexicon::NodeType, or a kind that has no name there
    std::string description;
    std::string path;
    unsigned int status = 0;
    std::optional<unsigned int> alarmState;
    /// What people are shown for the path; null: the path itself. A pointer, since a file's many nodes have none.
    std::unique_ptr<const std::string> displayText;
};

} // namespace Tavro

#endif
