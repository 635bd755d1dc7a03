#include "broker/ProviderLibrary.h"

#include <algorithm>
#include <filesystem>

#include <dlfcn.h>

namespace cimhost {

namespace {

// A sanitizer reports by the names of the library, when the process ends.
#ifdef GLIMMARK_SANITIZED
constexpr bool unloads = false;
#else
constexpr bool unloads = true;
#endif

std::string findFile(const std::string& location, const std::vector<std::string>& directories)
{
    const std::string name = "lib" + location + ".so";
    std::string searched;
    for (const std::string& directory : directories) {
        const std::filesystem::path file = std::filesystem::path(directory) / name;
        std::error_code ignored;
        if (std::filesystem::exists(file, ignored))
            // With a folder in its name, the loader does not search for it.
            return std::filesystem::absolute(file, ignored).string();
        searched += (searched.empty() ? "" : ", ") + directory;
    }
    throw ProviderError(directories.empty() ? name + " was not found: there is no provider directory"
                                            : name + " was not found in " + searched);
}

std::string loaderError()
{
    const char* const text = dlerror();
    return text == nullptr ? "the loader gives no reason" : text;
}

} // namespace

ProviderLibrary::ProviderLibrary(const std::string& location, const std::vector<std::string>& directories)
    : fileName_(findFile(location, directories)),
      handle_(dlopen(fileName_.c_str(), RTLD_NOW | RTLD_LOCAL))
{
    if (handle_ == nullptr)
        throw ProviderError(fileName_ + " cannot be loaded: " + loaderError());
}

ProviderLibrary::~ProviderLibrary()
{
    if (unloads && !keepLoaded_)
        dlclose(handle_);
}

void* ProviderLibrary::symbol(const std::string& name) const
{
    void* const found = dlsym(handle_, name.c_str());
    if (found == nullptr)
        throw ProviderError(fileName_ + " has no entry point " + name);
    return found;
}

} // namespace cimhost
