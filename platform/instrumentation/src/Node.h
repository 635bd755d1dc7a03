/// \file
#ifndef TAVRO_NODE_H
#define TAVRO_NODE_H

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
    std::optional<std::string> displayText; ///< what people are shown for the path; nothing: the path itself
};

} // namespace Tavro

#endif
