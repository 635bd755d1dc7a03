#include "SysfsNodeSource.h"

#include "Enclosures.h"
#include "ErrorLine.h"
#include "Leds.h"
#include "SysfsDirectory.h"

#include <cstdlib>
#include <string>
#include <system_error>

namespace Tavro {
namespace {

std::string rootOfSysfs()
{
    const char* const root = std::getenv("TAVRO_SYSFS_ROOT");
    return root == nullptr || *root == '\0' ? "/sys" : root;
}

void complain(const std::string& directory, int errorCode)
{
    logError({static_cast<const char*>(__func__), "SysfsNodeSource.cpp", __LINE__},
             directory + ": expected a directory of sysfs: " + std::generic_category().message(errorCode));
}

void appendNodes(SysfsClass sysfsClass, const SysfsDirectory& directory, std::vector<Node>& nodes)
{
    switch (sysfsClass) {
    case SysfsClass::Leds:
        appendLeds(directory, nodes);
        break;
    case SysfsClass::Enclosures:
        appendEnclosures(directory, nodes);
        break;
    }
}

} // namespace

std::vector<Node> SysfsNodeSource::read() const
{
    const std::string rootPath = rootOfSysfs();
    const SysfsDirectory root(rootPath);
    if (!root.isOpen()) {
        complain(rootPath, root.errorCode());
        return {};
    }
    std::vector<Node> nodes;
    for (const SysfsClass sysfsClass : classes_) {
        const SysfsDirectory directory(root, folderOf(sysfsClass));
        if (directory.isOpen())
            appendNodes(sysfsClass, directory, nodes);
        else if (!directory.isAbsent())
            complain(std::string(rootPath).append("/").append(folderOf(sysfsClass)), directory.errorCode());
    }
    return nodes;
}

} // namespace Tavro
