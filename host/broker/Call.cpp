#include "broker/Call.h"

#include "broker/HandleSpace.h"

#include <cstring>

namespace cimhost {

namespace {

/// Every envelope begins with its handle.
const void* handleOf(const void* envelope)
{
    const void* handle = nullptr;
    std::memcpy(&handle, envelope, sizeof handle);
    return handle;
}

} // namespace

Core& Call::broker(const CMPIBroker* broker)
{
    if (broker == nullptr)
        refuse(CMPI_RC_ERR_INVALID_HANDLE, "the broker is null");
    Core* const core = findCore(broker);
    if (core == nullptr)
        refuse(CMPI_RC_ERR_INVALID_HANDLE, "the broker is not one of this process");
    core_ = core;
    return *core;
}

Handle& Call::resolve(const void* object, const char* role)
{
    const auto refuseHandle = [&](const std::string& what) {
        refuse(CMPI_RC_ERR_INVALID_HANDLE, role + (" " + what));
    };
    if (object == nullptr)
        refuseHandle("is null");
    const void* const address = handleOf(object);
    if (address == nullptr)
        refuseHandle("has a null handle");
    Handle* const handle = HandleSpace::instance().find(address);
    const State state = handle == nullptr ? State::unused : handle->state.load(std::memory_order_acquire);
    switch (state) {
    case State::unused:
        refuseHandle("was not made by this broker");
        break;
    case State::released:
        refuseHandle("was released before");
        break;
    case State::ended:
        refuseHandle("belongs to a request that has ended");
        break;
    case State::live:
        break;
    }
    if (core_ != nullptr && core_ != handle->core)
        refuseHandle("was made by another broker");
    core_ = handle->core;
    return *handle;
}

Handle& Call::resolve(const void* object, const char* role, Kind kind)
{
    Handle& handle = resolve(object, role);
    if (handle.kind != kind)
        refuse(CMPI_RC_ERR_INVALID_HANDLE,
               std::string(role) + " is a " + typeName(handle.kind) + ", not a " + typeName(kind));
    return handle;
}

const char* Call::text(const char* text, const char* role)
{
    if (text == nullptr)
        refuse(CMPI_RC_ERR_INVALID_PARAMETER, std::string(role) + " is null");
    return text;
}

void Call::refuse(CMPIrc code, const std::string& why)
{
    Core* const told = core_ != nullptr ? core_ : Scope::currentCore();
    if (told != nullptr)
        told->tellMisuse(std::string(service_) + ": " + why);
    throw Refusal{code};
}

std::vector<std::string> takeNames(const char* const* names)
{
    std::vector<std::string> taken;
    for (; *names != nullptr; ++names)
        taken.emplace_back(*names);
    return taken;
}

} // namespace cimhost
