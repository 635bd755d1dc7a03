/// \file
/// A CMPI instance provider for the class TAVRO_ComputerSystem: a stand-in. On a maker's server the maker's
/// own provider serves the class; where there is none, this one gives the indicators a system to belong to.
/// It knows the systems' names and nothing else of them, and it is not meant to grow.
///
/// A broker finds it as provider TavroComputerSystemProvider in libTavroComputerSystem.so.

#include "Cmpi.h"
#include "SystemNames.h"

#include <array>
#include <atomic>
#include <exception>
#include <string>

#include <Tavro/Common.h>
#include <Tavro/Locale.h>

namespace Tavro::ComputerSystem {
namespace {

constexpr const char* className = "TAVRO_ComputerSystem";

// Values of the CIM schema.
constexpr CMPIUint16 operationalStatusOk = 2;
constexpr CMPIUint16 enabledStateEnabled = 2;
constexpr CMPIUint16 dedicatedUnknown = 1;

/// Written by the factory function, read by the operations, on any thread.
std::atomic<const CMPIBroker*> theBroker{nullptr};

CMPIObjectPath* pathOf(const std::string& name, const std::string& nameSpace)
{
    CMPIObjectPath* const path = Cmpi::newObjectPath(theBroker, nameSpace, className);
    Cmpi::setHostname(path, getSystemName());
    Cmpi::addKey(path, "CreationClassName", className);
    Cmpi::addKey(path, "Name", name);
    return path;
}

std::string caption()
{
    constexpr int library = 1;
    const ResourceString text(Locale::getResourceLibrary(library, Locale::getLanguageId()),
                              L"MSGID_COMPUTERSYSTEM_CAPTION");
    return make_string(text);
}

/// \param path        from pathOf
/// \param properties  those wanted besides the keys, ended by a null pointer; null for all. The broker keeps
///                    the others out by the filter.
CMPIInstance* instanceAt(const CMPIObjectPath* path, const std::string& name, const char** properties)
{
    CMPIInstance* const instance = Cmpi::newInstance(theBroker, path);
    std::array<const char*, 3> keys = {"CreationClassName", "Name", nullptr};
    Cmpi::setPropertyFilter(instance, properties, keys.data());

    Cmpi::setProperty(instance, "CreationClassName", className);
    Cmpi::setProperty(instance, "Name", name);
    Cmpi::setProperty(instance, "Caption", caption());
    Cmpi::setProperty(instance, "Description", "Computer system, served by a stand-in provider");
    Cmpi::setProperty(instance, "ElementName", name);
    Cmpi::setProperty(instance, "OperationalStatus", Cmpi::newArray(theBroker, {operationalStatusOk}));
    Cmpi::setProperty(instance, "EnabledState", enabledStateEnabled);
    Cmpi::setProperty(instance, "Dedicated", Cmpi::newArray(theBroker, {dedicatedUnknown}));
    return instance;
}

void enumerateInstanceNames(const CMPIResult* result, const CMPIObjectPath* classPath)
{
    const std::string nameSpace = Cmpi::nameSpaceOf(classPath);
    for (const std::string& name : systemNames())
        Cmpi::returnObjectPath(result, pathOf(name, nameSpace));
    Cmpi::returnDone(result);
}

void enumerateInstances(const CMPIResult* result, const CMPIObjectPath* classPath, const char** properties)
{
    const std::string nameSpace = Cmpi::nameSpaceOf(classPath);
    for (const std::string& name : systemNames())
        Cmpi::returnInstance(result, instanceAt(pathOf(name, nameSpace), name, properties));
    Cmpi::returnDone(result);
}

void getInstance(const CMPIResult* result, const CMPIObjectPath* instancePath, const char** properties)
{
    const std::string nameSpace = Cmpi::nameSpaceOf(instancePath);
    for (const std::string& name : systemNames()) {
        const CMPIObjectPath* const path = pathOf(name, nameSpace);
        if (isObjPathsEqual(instancePath, path, false)) {
            Cmpi::returnInstance(result, instanceAt(path, name, properties));
            Cmpi::returnDone(result);
            return;
        }
    }
    throw Cmpi::Failure(CMPI_RC_ERR_NOT_FOUND, "There is no TAVRO_ComputerSystem with these keys");
}

/// Runs an operation; no exception gets into the broker: one written in C, whose frames may have no unwind
/// tables, would be ended by it. The provider library lets them pass, since that is how its brokers know it.
template <class Operation>
CMPIStatus statusOf(Operation operation) noexcept
{
    try {
        operation();
        return {CMPI_RC_OK, nullptr};
    } catch (const Cmpi::Failure& failure) {
        return Cmpi::failed(theBroker, failure.code(), failure.what());
    } catch (const std::exception& failure) {
        return Cmpi::failed(theBroker, CMPI_RC_ERR_FAILED, failure.what());
    }
}

// The function table. Its argument types are left to the CMPI headers in use, whose older ones leave out a
// `const` here and there.

template <class Name>
const char** listOf(Name** properties)
{
    return const_cast<const char**>(properties);
}

constexpr auto notSupported = [](auto...) { return CMPIStatus{CMPI_RC_ERR_NOT_SUPPORTED, nullptr}; };

CMPIInstanceMIFT functions = {
    CMPIVersion200,
    CMPIVersion200,
    const_cast<char*>("TavroComputerSystemProvider"),
    [](auto...) { // cleanup
        return CMPIStatus{CMPI_RC_OK, nullptr};
    },
    [](auto*, auto*, auto* result, auto* classPath) {
        return statusOf([&] { enumerateInstanceNames(result, classPath); });
    },
    [](auto*, auto*, auto* result, auto* classPath, auto** properties) {
        return statusOf([&] { enumerateInstances(result, classPath, listOf(properties)); });
    },
    [](auto*, auto*, auto* result, auto* instancePath, auto** properties) {
        return statusOf([&] { getInstance(result, instancePath, listOf(properties)); });
    },
    notSupported, // createInstance
    notSupported, // modifyInstance
    notSupported, // deleteInstance
    notSupported, // execQuery
};

} // namespace
} // namespace Tavro::ComputerSystem

/// The factory function.
/// \param broker  replaces that of an earlier call
/// \param rc      may be null
/// \return a record with static storage; null, and the reason in `rc`, without a broker
extern "C" __attribute__((visibility("default"))) CMPIInstanceMI*
TavroComputerSystemProvider_Create_InstanceMI(const CMPIBroker* broker, const CMPIContext* /*ctx*/,
                                              CMPIStatus* rc)
{
    static CMPIInstanceMI provider = {nullptr, &Tavro::ComputerSystem::functions};
    if (rc != nullptr)
        *rc = {broker != nullptr ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE, nullptr};
    if (broker == nullptr)
        return nullptr;
    Tavro::ComputerSystem::theBroker = broker;
    return &provider;
}
