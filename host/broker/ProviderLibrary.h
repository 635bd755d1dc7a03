/// \file
/// A provider's shared object.
#ifndef CIMHOST_BROKER_PROVIDERLIBRARY_H
#define CIMHOST_BROKER_PROVIDERLIBRARY_H

#include <stdexcept>
#include <string>
#include <vector>

namespace cimhost {

/// A provider that cannot be used; what() says why in one line.
class ProviderError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

class ProviderLibrary
{
public:
    /// Loads libLOCATION.so from the first directory that has it, every symbol of it resolved.
    /// \throws ProviderError
    ProviderLibrary(const std::string& location, const std::vector<std::string>& directories);
    /// Unloads it. Under a sanitizer it stays loaded: its reports need the library's symbols.
    ~ProviderLibrary();
    ProviderLibrary(const ProviderLibrary&) = delete;
    ProviderLibrary& operator=(const ProviderLibrary&) = delete;

    /// The function of that name.
    /// \throws ProviderError  when there is none
    template <class Function>
    [[nodiscard]] Function* function(const std::string& name) const
    {
        return reinterpret_cast<Function*>(symbol(name));
    }

    /// Leaves it loaded when this object goes.
    void keepLoaded() { keepLoaded_ = true; }

private:
    [[nodiscard]] void* symbol(const std::string& name) const;

    std::string fileName_;
    void* handle_ = nullptr;
    bool keepLoaded_ = false;
};

} // namespace cimhost

#endif
