#include "CatalogueDirectory.h"

#include <filesystem>
#include <system_error>

#include <dlfcn.h>

namespace Tavro {
namespace {

namespace fs = std::filesystem;

/// The directory of the shared object that this function is in.
fs::path libraryDirectory()
{
    Dl_info object{};
    if (dladdr(reinterpret_cast<const void*>(&libraryDirectory), &object) == 0)
        return {};
    std::error_code ignored;
    return fs::canonical(object.dli_fname, ignored).parent_path();
}

} // namespace

std::string installedCatalogues()
{
    const fs::path library = libraryDirectory();
    const fs::path installed = (library / TAVRO_LOCALEDIR_FROM_LIBDIR).lexically_normal();
    std::error_code ignored;
    if (fs::is_directory(installed, ignored))
        return installed.string();
    return (library / TAVRO_LOCALEDIR_FROM_BUILT_LIBRARY).lexically_normal().string();
}

} // namespace Tavro
