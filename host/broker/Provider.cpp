#include "broker/Provider.h"

#include "broker/Broker.h"
#include "broker/ProviderCall.h"
#include "broker/Scope.h"
#include "cim/Values.h"

#include <utility>

namespace cimhost {

namespace {

/// The oldest version of a function table with the slots that are called here.
constexpr CMPIVersion oldestVersion = 100;

template <class MI>
using Factory = MI*(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

struct Slot
{
    const char* name;
    bool present;
};

std::vector<Slot> slotsOf(const CMPIInstanceMIFT& table)
{
    return {{"cleanup", table.cleanup != nullptr},
            {"enumerateInstanceNames", table.enumerateInstanceNames != nullptr},
            {"enumerateInstances", table.enumerateInstances != nullptr},
            {"getInstance", table.getInstance != nullptr},
            {"createInstance", table.createInstance != nullptr},
            {"modifyInstance", table.modifyInstance != nullptr},
            {"deleteInstance", table.deleteInstance != nullptr},
            {"execQuery", table.execQuery != nullptr}};
}

std::vector<Slot> slotsOf(const CMPIAssociationMIFT& table)
{
    return {{"cleanup", table.cleanup != nullptr},
            {"associators", table.associators != nullptr},
            {"associatorNames", table.associatorNames != nullptr},
            {"references", table.references != nullptr},
            {"referenceNames", table.referenceNames != nullptr}};
}

/// \param entryPoint  what made it, for the message
template <class MI>
void check(const MI& mi, const std::string& entryPoint)
{
    if (mi.ft == nullptr)
        throw ProviderError(entryPoint + " answered with an interface without a function table");
    if (mi.ft->ftVersion < oldestVersion)
        throw ProviderError(entryPoint + " answered with a function table of version " +
                            std::to_string(mi.ft->ftVersion) + "; expected " + std::to_string(oldestVersion) +
                            " or newer");
    for (const Slot& slot : slotsOf(*mi.ft))
        if (!slot.present)
            throw ProviderError(entryPoint + " answered with a function table whose slot " + slot.name +
                                " is null");
}

/// What the provider says of its failure, in parentheses.
std::string reason(const CMPIStatus& status)
{
    const std::optional<std::string> message = read(status.msg);
    return " (status " + std::to_string(status.rc) + (message ? ": " + *message : "") + ")";
}

} // namespace

Provider::Provider(ProviderSurroundings& surroundings, std::string name, std::string location)
    : surroundings_(surroundings),
      name_(std::move(name)),
      location_(std::move(location))
{}

CMPIInstanceMI& Provider::instanceMI(const std::string& nameSpace)
{
    return get(instance_, "InstanceMI", nameSpace);
}

CMPIAssociationMI& Provider::associationMI(const std::string& nameSpace)
{
    return get(association_, "AssociationMI", nameSpace);
}

template <class MI>
MI& Provider::get(ManagementInterface<MI>& interface, const char* kind, const std::string& nameSpace)
{
    const std::lock_guard<std::recursive_mutex> lock(surroundings_.setUpMutex);
    try {
        return interface.get([&] { return create<MI>(kind, nameSpace); });
    } catch (const ProviderError& error) {
        throw ProviderError("the provider " + name_ + " cannot be used: " + error.what());
    }
}

template <class MI>
MI* Provider::create(const char* kind, const std::string& nameSpace)
{
    const std::string entryPoint = name_ + "_Create_" + kind;
    auto* const factory = library().function<Factory<MI>>(entryPoint);

    Core& core = surroundings_.core;
    // What a provider makes while it is set up is its to keep.
    const OutsideScopes lasting;
    ContextObject entries{{{"CMPIInitNameSpace", cim::textValue(nameSpace)}}};
    const CMPIContext* const context = make<ContextObject>(core, std::move(entries));

    CMPIStatus status{CMPI_RC_OK, nullptr};
    MI* const mi = callProvider(
        core, entryPoint, [&] { return factory(&core.cmpi, context, &status); },
        [&](const std::string& message) -> MI* { throw ProviderError(entryPoint + ": " + message); });
    if (mi == nullptr)
        throw ProviderError(entryPoint + " answered with no interface" + reason(status));
    check(*mi, entryPoint);
    return mi;
}

ProviderLibrary& Provider::library()
{
    if (!library_)
        library_.emplace(location_, surroundings_.directories);
    return *library_;
}

void Provider::cleanUp()
{
    cleanUp(instance_.made());
    cleanUp(association_.made());
}

template <class MI>
void Provider::cleanUp(MI* mi)
{
    if (mi == nullptr)
        return;
    Core& core = surroundings_.core;
    Request request(core.broker);
    const CMPIStatus status = callProvider(
        core, name_ + " cleanup", [&] { return mi->ft->cleanup(mi, request.context(), 1); },
        [](const std::string&) {
            return CMPIStatus{CMPI_RC_ERR_FAILED, nullptr};
        });
    if (status.rc == CMPI_RC_DO_NOT_UNLOAD || status.rc == CMPI_RC_NEVER_UNLOAD)
        library_->keepLoaded();
}

} // namespace cimhost
