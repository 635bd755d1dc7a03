/// \file
/// Loading as brokers load providers: into the one space of names that all of the process share.
#ifndef TESTS_NEIGHBOURS_LOAD_H
#define TESTS_NEIGHBOURS_LOAD_H

#include <stdexcept>
#include <string>

#include <dlfcn.h>

/// \throws std::runtime_error  where the file cannot be loaded
inline void* load(const std::string& file, int flags)
{
    void* const library = dlopen(file.c_str(), flags);
    return library != nullptr ? library : throw std::runtime_error(dlerror());
}

/// Loads first one library, then the other. \param neighbour  a file, or "none" \param mode  "now" or "lazy"
/// \return the other
inline void* loadBeside(const std::string& neighbour, const std::string& file, const std::string& mode)
{
    const int flags = RTLD_GLOBAL | (mode == "lazy" ? RTLD_LAZY : RTLD_NOW);
    if (neighbour != "none")
        load(neighbour, flags);
    return load(file, flags);
}

/// \throws std::runtime_error  where the library has none of that name
inline void* symbolOf(void* library, const std::string& name)
{
    void* const found = dlsym(library, name.c_str());
    return found != nullptr ? found : throw std::runtime_error("no symbol " + name);
}

#endif
