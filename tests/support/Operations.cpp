#include "Operations.h"

#include "EntryPoints.h"

#include <array>
#include <cstddef>

namespace {

using CreateInstanceMI = CMPIInstanceMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
using CreateAssociationMI = CMPIAssociationMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

constexpr auto glimmark = "TAVRO_Glimmark";
constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";
constexpr auto computerSystem = "TAVRO_ComputerSystem";
constexpr auto elementCapabilities = "TAVRO_GlimmarkElementCapabilities";
constexpr auto systemDevice = "TAVRO_GlimmarkSystemDevice";

Operation enumerateNames(CreateInstanceMI create, const std::string& className)
{
    return {className + "_EnumInstanceNames", [=](const RequestHandles& request) {
                CMPIInstanceMI* const mi = create(request.broker, request.ctx, nullptr);
                const CMPIObjectPath* const path = request.path(className, "", "");
                return mi->ft->enumerateInstanceNames(mi, request.ctx, request.rslt, path);
            }};
}

Operation enumerate(CreateInstanceMI create, const std::string& className)
{
    return {className + "_EnumInstances", [=](const RequestHandles& request) {
                CMPIInstanceMI* const mi = create(request.broker, request.ctx, nullptr);
                const CMPIObjectPath* const path = request.path(className, "", "");
                return mi->ft->enumerateInstances(mi, request.ctx, request.rslt, path, nullptr);
            }};
}

/// \param way  for the operation's name  \param key  empty: without keys
Operation get(CreateInstanceMI create, const std::string& className, const std::string& way,
              const std::string& key, const std::string& value)
{
    return {className + "_GetInstance_" + way, [=](const RequestHandles& request) {
                CMPIInstanceMI* const mi = create(request.broker, request.ctx, nullptr);
                const CMPIObjectPath* const path = request.path(className, key, value);
                return mi->ft->getInstance(mi, request.ctx, request.rslt, path, nullptr);
            }};
}

CMPIStatus traverse(CMPIAssociationMI* mi, std::size_t operation, const RequestHandles& request,
                    const CMPIObjectPath* from, const char* assocClass)
{
    const CMPIAssociationMIFT& table = *mi->ft;
    switch (operation) {
    case 0:
        return table.associators(mi, request.ctx, request.rslt, from, assocClass, nullptr, nullptr, nullptr,
                                 nullptr);
    case 1:
        return table.associatorNames(mi, request.ctx, request.rslt, from, assocClass, nullptr, nullptr,
                                     nullptr);
    case 2:
        return table.references(mi, request.ctx, request.rslt, from, nullptr, nullptr, nullptr);
    default:
        return table.referenceNames(mi, request.ctx, request.rslt, from, nullptr, nullptr);
    }
}

void addTraversals(std::vector<Operation>& all, CreateAssociationMI create, const char* assocClass,
                   const std::string& from)
{
    const std::array<const char*, 4> names{"Associators", "AssociatorNames", "References", "ReferenceNames"};
    for (std::size_t i = 0; i < names.size(); ++i) {
        all.push_back(
            {std::string(assocClass) + "_" + names[i] + "_From_" + from, [=](const RequestHandles& request) {
                 CMPIAssociationMI* const mi = create(request.broker, request.ctx, nullptr);
                 const CMPIObjectPath* const path = request.path(from, "Name", "x");
                 return traverse(mi, i, request, path, assocClass);
             }});
    }
}

} // namespace

void PrintTo(const Operation& operation, std::ostream* stream)
{
    *stream << operation.name;
}

std::vector<Operation> allOperations()
{
    const CreateInstanceMI devices = &GlimmarkProfileProvider_Create_InstanceMI;
    const CreateInstanceMI shared = &GlimmarkCapabilitiesProvider_Create_InstanceMI;
    const CreateInstanceMI elements = &GlimmarkElementCapabilitiesProvider_Create_InstanceMI;
    const CreateInstanceMI systems = &GlimmarkSystemDeviceProvider_Create_InstanceMI;
    std::vector<Operation> all = {
        enumerateNames(devices, glimmark),
        enumerate(devices, glimmark),
        get(devices, glimmark, "ByIdentifier", "DeviceID", "b:/2"),
        get(devices, glimmark, "ByPath", "Name", "b"),
        get(devices, glimmark, "WithoutKeys", "", ""),
        enumerateNames(shared, capabilities),
        enumerate(shared, capabilities),
        get(shared, capabilities, "ByIdentifier", "InstanceID", "TAVRO:GlimmarkCapabilities1"),
        get(shared, capabilities, "ByPath", "Name", "x"),
        enumerateNames(elements, elementCapabilities),
        enumerate(elements, elementCapabilities),
        get(elements, elementCapabilities, "ByPath", "ManagedElement", "x"),
        enumerateNames(systems, systemDevice),
        enumerate(systems, systemDevice),
        get(systems, systemDevice, "ByPath", "PartComponent", "x"),
    };
    for (const char* from : {glimmark, capabilities})
        addTraversals(all, &GlimmarkElementCapabilitiesProvider_Create_AssociationMI, elementCapabilities,
                      from);
    for (const char* from : {glimmark, computerSystem})
        addTraversals(all, &GlimmarkSystemDeviceProvider_Create_AssociationMI, systemDevice, from);
    return all;
}
