#include "SysfsNodeSource.h"

#include "ErrorLine.h"

#include <cstdlib>
#include <string_view>
#include <system_error>

namespace Tavro {
namespace {

std::string rootOfSysfs()
{
    const char* const root = secure_getenv("TAVRO_SYSFS_ROOT");
    return root == nullptr || *root == '\0' ? "/sys" : root;
}

void complain(const std::string& directory, int errorCode)
{
    logError({static_cast<const char*>(__func__), "SysfsNodeSource.cpp", __LINE__},
             directory + ": expected a directory of sysfs: " + std::generic_category().message(errorCode));
}

} // namespace

SysfsDirectory Sysfs::open(const std::string& place)
{
    const std::string rootPath = rootOfSysfs();
    if (!root_ && !root_.emplace(rootPath).isOpen())
        complain(rootPath, root_->errorCode());

    const std::string folder = place.substr(std::string_view("/sys/").size());
    SysfsDirectory directory(*root_, folder);
    if (root_->isOpen() && !directory.isOpen() && !directory.isAbsent())
        complain(rootPath + '/' + folder, directory.errorCode());
    return directory;
}

} // namespace Tavro
