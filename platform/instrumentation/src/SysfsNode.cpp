#include "SysfsNode.h"

#include "SysfsAttributes.h"
#include "Tavro/NodeLexicon.h"
#include "Words.h"

#include <filesystem>
#include <memory>
#include <optional>
#include <utility>

namespace Tavro {

std::string devicePath(const SysfsDirectory& directory, const std::string& folder, const std::string& name)
{
    const std::optional<std::string> target = directory.linkTarget(name);
    // Kernels built for old programs have the device itself there.
    return target ? (std::filesystem::path(folder) / *target).lexically_normal().string()
                  : folder + '/' + name;
}

Node indicatorNode(std::string description, std::string devicePath, const std::string& displayPath)
{
    Node node;
    node.kind = NodeLexicon::DiagnosticIndicator;
    node.description = std::move(description);
    node.path = std::move(devicePath);
    node.status = unknownStatus;
    node.alarmState = unknownState;
    node.displayText = std::make_unique<const std::string>(printable(displayPath));
    return node;
}

} // namespace Tavro
