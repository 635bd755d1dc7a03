#include "SysfsNode.h"

#include "SysfsAttributes.h"
#include "Tavro/NodeLexicon.h"
#include "Words.h"

#include <filesystem>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>

namespace Tavro {
namespace {

constexpr std::string_view up = "../";

/// Where a link in a folder leads. The kernel's go up some folders and then down to the device.
std::string normalPath(const std::string& folder, std::string_view target)
{
    std::string_view base = folder;
    std::string_view down = target;
    while (down.substr(0, up.size()) == up && base.rfind('/') != std::string_view::npos) {
        down.remove_prefix(up.size());
        base = base.substr(0, base.rfind('/'));
    }
    if (down.empty() || down.front() == '/' || down.front() == '.' ||
        down.find("/.") != std::string_view::npos || down.find("//") != std::string_view::npos)
        return (std::filesystem::path(folder) / target).lexically_normal().string();
    return std::string(base).append("/").append(down);
}

} // namespace

std::string devicePath(const SysfsDirectory& directory, const std::string& folder, const std::string& name)
{
    const std::optional<std::string> target = directory.linkTarget(name);
    // Kernels built for old programs have the device itself there.
    return target ? normalPath(folder, *target) : folder + '/' + name;
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
