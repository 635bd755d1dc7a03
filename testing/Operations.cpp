#include "testing/Operations.h"

#include "cim/Json.h"
#include "cim/Values.h"

#include <Tavro/Common.h>

#include <array>
#include <cstddef>

namespace cim = cimhost::cim;

namespace {

using CreateInstanceMI = EntryPoints::CreateInstanceMI;
using CreateAssociationMI = EntryPoints::CreateAssociationMI;

constexpr auto glimmark = "TAVRO_Glimmark";
constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";
constexpr auto computerSystem = "TAVRO_ComputerSystem";
constexpr auto elementCapabilities = "TAVRO_GlimmarkElementCapabilities";
constexpr auto systemDevice = "TAVRO_GlimmarkSystemDevice";
constexpr auto unrelated = "CIM_AlarmDevice";

Operation enumerateNames(CreateInstanceMI create, const std::string& className)
{
    const cim::ObjectPath classPath{"", "", className, {}};
    return {className + "_EnumInstanceNames", [=](const RequestHandles& request) {
                CMPIInstanceMI* const mi = create(request.broker, request.ctx, nullptr);
                const CMPIObjectPath* const path = request.path(classPath);
                return mi->ft->enumerateInstanceNames(mi, request.ctx, request.rslt, path);
            }};
}

Operation enumerate(CreateInstanceMI create, const std::string& className)
{
    const cim::ObjectPath classPath{"", "", className, {}};
    return {className + "_EnumInstances", [=](const RequestHandles& request) {
                CMPIInstanceMI* const mi = create(request.broker, request.ctx, nullptr);
                const CMPIObjectPath* const path = request.path(classPath);
                return mi->ft->enumerateInstances(mi, request.ctx, request.rslt, path, nullptr);
            }};
}

using Keys = std::vector<cim::Key>;

cim::Key key(const std::string& name, const std::string& text)
{
    return {name, cim::textValue(text)};
}

cim::Key key(const std::string& name, const cim::ObjectPath& path)
{
    return {name, cim::referenceValue(path)};
}

cim::ObjectPath indicatorPath()
{
    return {"",
            "",
            glimmark,
            {key("CreationClassName", glimmark), key("DeviceID", "b:/2"),
             key("SystemCreationClassName", computerSystem), key("SystemName", Tavro::getSystemName())}};
}

cim::ObjectPath capabilitiesPath()
{
    return {"", "", capabilities, {key("InstanceID", "TAVRO:GlimmarkCapabilities1")}};
}

cim::ObjectPath computerSystemPath()
{
    return {"", "", computerSystem, {key("CreationClassName", computerSystem), key("Name", "one")}};
}

/// \param way  for the operation's name
Operation get(CreateInstanceMI create, const std::string& className, const std::string& way, const Keys& keys)
{
    const cim::ObjectPath wanted{"", "", className, keys};
    return {className + "_GetInstance_" + way, [=](const RequestHandles& request) {
                CMPIInstanceMI* const mi = create(request.broker, request.ctx, nullptr);
                const CMPIObjectPath* const path = request.path(wanted);
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
    const cim::ObjectPath source{"", "", from, {key("Name", "x")}};
    for (std::size_t i = 0; i < names.size(); ++i) {
        all.push_back(
            {std::string(assocClass) + "_" + names[i] + "_From_" + from, [=](const RequestHandles& request) {
                 CMPIAssociationMI* const mi = create(request.broker, request.ctx, nullptr);
                 const CMPIObjectPath* const path = request.path(source);
                 return traverse(mi, i, request, path, assocClass);
             }});
    }
}

void addFixed(std::vector<Operation>& all, CreateInstanceMI create, const std::string& className)
{
    using Run = CMPIStatus (*)(CMPIInstanceMI*, const RequestHandles&);
    const auto add = [&](const std::string& name, Run run) {
        all.push_back({className + "_" + name, [=](const RequestHandles& request) {
                           return run(create(request.broker, request.ctx, nullptr), request);
                       }});
    };
    add("Cleanup", [](CMPIInstanceMI* mi, const RequestHandles& request) {
        return mi->ft->cleanup(mi, request.ctx, 0);
    });
    add("CreateInstance", [](CMPIInstanceMI* mi, const RequestHandles& request) {
        return mi->ft->createInstance(mi, request.ctx, request.rslt, nullptr, nullptr);
    });
    add("ModifyInstance", [](CMPIInstanceMI* mi, const RequestHandles& request) {
        return mi->ft->modifyInstance(mi, request.ctx, request.rslt, nullptr, nullptr, nullptr);
    });
    add("DeleteInstance", [](CMPIInstanceMI* mi, const RequestHandles& request) {
        return mi->ft->deleteInstance(mi, request.ctx, request.rslt, nullptr);
    });
    add("ExecQuery", [](CMPIInstanceMI* mi, const RequestHandles& request) {
        return mi->ft->execQuery(mi, request.ctx, request.rslt, nullptr, nullptr, nullptr);
    });
}

Operation associationCleanup(CreateAssociationMI create, const std::string& className)
{
    return {className + "_AssociationCleanup", [=](const RequestHandles& request) {
                CMPIAssociationMI* const mi = create(request.broker, request.ctx, nullptr);
                return mi->ft->cleanup(mi, request.ctx, 0);
            }};
}

} // namespace

void PrintTo(const Operation& operation, std::ostream* stream)
{
    *stream << operation.name;
}

std::vector<Operation> allOperations(const EntryPoints& of)
{
    std::vector<Operation> all = {
        enumerateNames(of.glimmarks, glimmark),
        enumerate(of.glimmarks, glimmark),
        get(of.glimmarks, glimmark, "ByIdentifier", {key("DeviceID", "b:/2")}),
        get(of.glimmarks, glimmark, "ByPath", {key("Name", "b")}),
        get(of.glimmarks, glimmark, "WithoutKeys", {}),
        enumerateNames(of.capabilities, capabilities),
        enumerate(of.capabilities, capabilities),
        get(of.capabilities, capabilities, "ByIdentifier", capabilitiesPath().keys),
        get(of.capabilities, capabilities, "ByPath", {key("Name", "x")}),
        get(of.capabilities, capabilities, "WithoutKeys", {}),
        enumerateNames(of.elementCapabilities, elementCapabilities),
        enumerate(of.elementCapabilities, elementCapabilities),
        get(of.elementCapabilities, elementCapabilities, "ByPath",
            {key("ManagedElement", indicatorPath()), key("Capabilities", capabilitiesPath())}),
        get(of.elementCapabilities, elementCapabilities, "OfNothing", {key("ManagedElement", "x")}),
        get(of.elementCapabilities, elementCapabilities, "WithoutKeys", {}),
        enumerateNames(of.systemDevices, systemDevice),
        enumerate(of.systemDevices, systemDevice),
        get(of.systemDevices, systemDevice, "ByPath",
            {key("GroupComponent", computerSystemPath()), key("PartComponent", indicatorPath())}),
        get(of.systemDevices, systemDevice, "OfNothing", {key("PartComponent", "x")}),
        get(of.systemDevices, systemDevice, "WithoutKeys", {}),
    };
    for (const char* from : {glimmark, capabilities, unrelated})
        addTraversals(all, of.elementCapabilitiesTraversal, elementCapabilities, from);
    for (const char* from : {glimmark, computerSystem, unrelated})
        addTraversals(all, of.systemDevicesTraversal, systemDevice, from);
    return all;
}

std::vector<Operation> fixedOperations(const EntryPoints& of)
{
    std::vector<Operation> all;
    addFixed(all, of.glimmarks, glimmark);
    addFixed(all, of.capabilities, capabilities);
    addFixed(all, of.elementCapabilities, elementCapabilities);
    addFixed(all, of.systemDevices, systemDevice);
    all.push_back(associationCleanup(of.elementCapabilitiesTraversal, elementCapabilities));
    all.push_back(associationCleanup(of.systemDevicesTraversal, systemDevice));
    return all;
}

bool operator==(const Outcome& a, const Outcome& b)
{
    return a.answer.status.code == b.answer.status.code &&
           a.answer.status.message == b.answer.status.message && a.answer.paths == b.answer.paths &&
           a.answer.instances == b.answer.instances && a.doneCount == b.doneCount;
}

void PrintTo(const Outcome& outcome, std::ostream* stream)
{
    *stream << cim::toText(cim::toJson(outcome.answer.status)) << ", " << outcome.doneCount << " times done";
    for (const cim::ObjectPath& path : outcome.answer.paths)
        *stream << '\n' << cim::toText(cim::toJson(path));
    for (const cim::Instance& instance : outcome.answer.instances)
        *stream << '\n' << cim::toText(cim::toJson(instance));
}

Outcome ask(cimhost::Broker& broker, const Operation& operation)
{
    cimhost::Request request(broker);
    const auto path = [&](const cim::ObjectPath& wanted) {
        cim::ObjectPath inNameSpace = wanted;
        inNameSpace.nameSpace = "root/cimv2";
        return request.path(inNameSpace);
    };
    const CMPIStatus status = operation.run({broker.cmpiBroker(), request.context(), request.result(), path});
    return {request.answer(status), request.doneCount()};
}
