/// \file
/// A provider as the broker uses it: found in its library, set up on first use, cleaned up at the end.
#ifndef CIMHOST_BROKER_PROVIDER_H
#define CIMHOST_BROKER_PROVIDER_H

#include "broker/Core.h"
#include "broker/ProviderLibrary.h"

#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include <cmpift.h>

namespace cimhost {

/// What all providers of a broker share.
struct ProviderSurroundings
{
    Core& core;
    std::vector<std::string> directories;
    /// Held while a provider is set up. Recursive: a provider's factory function may make up-calls.
    std::recursive_mutex setUpMutex;
};

/// One management interface of a provider: its factory function is called once, whatever comes of it.
template <class MI>
class ManagementInterface
{
public:
    /// \param create  calls the factory function, or throws
    template <class Create>
    MI& get(const Create& create)
    {
        if (state_ == State::fresh) {
            state_ = State::beingMade;
            try {
                mi_ = create();
                state_ = State::ready;
            } catch (const std::exception& error) {
                error_ = error.what();
                state_ = State::failed;
            }
        }
        if (state_ == State::beingMade)
            throw ProviderError("its factory function has not returned yet");
        if (state_ == State::failed)
            throw ProviderError(error_);
        return *mi_;
    }

    /// Null when there is none.
    [[nodiscard]] MI* made() const { return mi_; }

private:
    enum class State
    {
        fresh,
        beingMade,
        ready,
        failed
    };

    State state_ = State::fresh;
    MI* mi_ = nullptr;
    std::string error_;
};

/// Safe to use from several threads at once.
class Provider
{
public:
    /// \param surroundings  must outlive the provider
    Provider(ProviderSurroundings& surroundings, std::string name, std::string location);

    /// Its management interfaces.
    /// \throws ProviderError  when it has none, the same every time
    CMPIInstanceMI& instanceMI(const std::string& nameSpace);
    CMPIAssociationMI& associationMI(const std::string& nameSpace);

    /// Tells the provider that the broker ends. It is not used any more.
    void cleanUp();

private:
    template <class MI>
    MI& get(ManagementInterface<MI>& interface, const char* kind, const std::string& nameSpace);
    template <class MI>
    MI* create(const char* kind, const std::string& nameSpace);
    template <class MI>
    void cleanUp(MI* mi);
    ProviderLibrary& library();

    ProviderSurroundings& surroundings_;
    std::string name_;
    std::string location_;
    std::optional<ProviderLibrary> library_;
    ManagementInterface<CMPIInstanceMI> instance_;
    ManagementInterface<CMPIAssociationMI> association_;
};

} // namespace cimhost

#endif
