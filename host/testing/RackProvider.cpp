/// \file
/// A provider for the tests of the command line: a rack with two lamps and the association between them, a
/// class that always fails and one that breaks the interface. A file named by CIMT_INVENTORY has other lamps,
/// for tests that change them: lines of `lamp ID HEALTH ALARMSTATE`; `error TEXT`, which is then the answer;
/// `print TEXT`, which goes to standard error; `crash` and `hang`, which the process then does.

#include "testing/ProviderParts.h"

#include <array>
#include <cstdlib>
#include <fstream>
#include <initializer_list>
#include <iostream>
#include <sstream>
#include <string>
#include <vector>

#include <strings.h>
#include <unistd.h>

using namespace sample;

namespace {

struct Lamp
{
    std::string deviceId;
    std::string name;
    CMPIUint16 health;
    std::vector<CMPIUint16> operationalStatus;
    CMPIUint16 alarmState;
};

struct Inventory
{
    std::vector<Lamp> lamps;
    std::string error;
};

Lamp lampOf(std::istream& words)
{
    Lamp lamp{};
    words >> lamp.deviceId >> lamp.health >> lamp.alarmState;
    lamp.name = lamp.deviceId.substr(0, lamp.deviceId.find(':'));
    lamp.operationalStatus = lamp.health == 5 ? std::vector<CMPIUint16>{2, 11} : std::vector<CMPIUint16>{3};
    return lamp;
}

Inventory read(std::istream& file)
{
    Inventory inventory;
    for (std::string line; std::getline(file, line);) {
        std::istringstream words(line);
        std::string kind;
        words >> kind;
        if (kind == "lamp")
            inventory.lamps.push_back(lampOf(words));
        else if (kind == "error")
            inventory.error = line.substr(kind.size() + 1);
        else if (kind == "print")
            std::cerr << line.substr(kind.size() + 1) << std::endl;
        else if (kind == "crash")
            std::abort();
        else if (kind == "hang")
            pause();
    }
    return inventory;
}

Inventory inventory()
{
    if (const char* const file = std::getenv("CIMT_INVENTORY")) {
        std::ifstream stream(file);
        return read(stream);
    }
    return {{{"Fan 1:/bay[0]", "Fan 1", 5, {2, 11}, 1},
             {"L\u00fcfter \"2\", a=b\\c", "L\u00fcfter 2", 10, {3, 5}, 3}},
            ""};
}

std::vector<Lamp> lamps()
{
    return inventory().lamps;
}

constexpr const char* rackName = "rack-1";

bool hasClass(const CMPIObjectPath* path, const char* className)
{
    return strcasecmp(textOf(path->ft->getClassName(path, nullptr)).c_str(), className) == 0;
}

CMPIObjectPath* rackPath(const CMPIObjectPath* request)
{
    CMPIObjectPath* path = newPath(request, "CIMT_RackSystem");
    path->ft->addKey(path, "Name", chars(rackName), CMPI_chars);
    return path;
}

CMPIObjectPath* lampPath(const CMPIObjectPath* request, const Lamp& lamp)
{
    CMPIObjectPath* path = newPath(request, "CIMT_Lamp");
    path->ft->addKey(path, "CreationClassName", chars("CIMT_Lamp"), CMPI_chars);
    path->ft->addKey(path, "DeviceID", chars(lamp.deviceId.c_str()), CMPI_chars);
    return path;
}

CMPIInstance* rackInstance(const CMPIObjectPath* request, const char** properties)
{
    std::array<const char*, 2> keys{"Name", nullptr};
    CMPIInstance* instance = broker->eft->newInstance(broker, rackPath(request), nullptr);
    instance->ft->setPropertyFilter(instance, properties, keys.data());
    instance->ft->setProperty(instance, "Name", chars(rackName), CMPI_chars);
    instance->ft->setProperty(instance, "ElementName", chars("Rack <1> & \"co\""), CMPI_chars);
    CMPIValue enabled{};
    enabled.uint16 = 2;
    instance->ft->setProperty(instance, "EnabledState", &enabled, CMPI_uint16);
    return instance;
}

void setNumber(CMPIInstance* instance, const char* name, CMPIUint16 number)
{
    CMPIValue value{};
    value.uint16 = number;
    instance->ft->setProperty(instance, name, &value, CMPI_uint16);
}

CMPIInstance* lampInstance(const CMPIObjectPath* request, const char** properties, const Lamp& lamp)
{
    std::array<const char*, 3> keys{"CreationClassName", "DeviceID", nullptr};
    CMPIInstance* instance = broker->eft->newInstance(broker, lampPath(request, lamp), nullptr);
    instance->ft->setPropertyFilter(instance, properties, keys.data());
    instance->ft->setProperty(instance, "CreationClassName", chars("CIMT_Lamp"), CMPI_chars);
    instance->ft->setProperty(instance, "DeviceID", chars(lamp.deviceId.c_str()), CMPI_chars);
    instance->ft->setProperty(instance, "Name", chars(lamp.name.c_str()), CMPI_chars);
    setNumber(instance, "HealthState", lamp.health);

    CMPIValue states{};
    const auto count = static_cast<CMPICount>(lamp.operationalStatus.size());
    states.array = broker->eft->newArray(broker, count, CMPI_uint16, nullptr);
    for (CMPICount index = 0; index < count; ++index) {
        CMPIValue state{};
        state.uint16 = lamp.operationalStatus[index];
        states.array->ft->setElementAt(states.array, index, &state, CMPI_uint16);
    }
    instance->ft->setProperty(instance, "OperationalStatus", &states, CMPI_uint16A);
    setNumber(instance, "AlarmState", lamp.alarmState);
    return instance;
}

void setReference(CMPIInstance* instance, const char* name, CMPIObjectPath* path)
{
    CMPIValue value{};
    value.ref = path;
    instance->ft->setProperty(instance, name, &value, CMPI_ref);
}

CMPIObjectPath* linkPath(const CMPIObjectPath* request, const Lamp& lamp)
{
    CMPIObjectPath* path = newPath(request, "CIMT_RackLamp");
    CMPIValue end{};
    end.ref = rackPath(request);
    path->ft->addKey(path, "GroupComponent", &end, CMPI_ref);
    end.ref = lampPath(request, lamp);
    path->ft->addKey(path, "PartComponent", &end, CMPI_ref);
    return path;
}

CMPIInstance* linkInstance(const CMPIObjectPath* request, const Lamp& lamp)
{
    CMPIInstance* instance = broker->eft->newInstance(broker, linkPath(request, lamp), nullptr);
    setReference(instance, "GroupComponent", rackPath(request));
    setReference(instance, "PartComponent", lampPath(request, lamp));
    return instance;
}

CMPIStatus enumerateInstanceNames(CMPIInstanceMI* /*mi*/, const CMPIContext* /*ctx*/,
                                  const CMPIResult* result, const CMPIObjectPath* request)
{
    if (hasClass(request, "CIMT_Broken"))
        return failure(CMPI_RC_ERR_FAILED, "broken on purpose\x1b[2J");
    if (hasClass(request, "CIMT_Careless"))
        result->ft->returnObjectPath(result, nullptr);
    if (hasClass(request, "CIMT_RackSystem"))
        result->ft->returnObjectPath(result, rackPath(request));
    for (const Lamp& lamp : lamps()) {
        if (hasClass(request, "CIMT_Lamp"))
            result->ft->returnObjectPath(result, lampPath(request, lamp));
        if (hasClass(request, "CIMT_RackLamp"))
            result->ft->returnObjectPath(result, linkPath(request, lamp));
    }
    result->ft->returnDone(result);
    return ok;
}

CMPIStatus enumerateInstances(CMPIInstanceMI* /*mi*/, const CMPIContext* /*ctx*/, const CMPIResult* result,
                              const CMPIObjectPath* request, const char** properties)
{
    if (hasClass(request, "CIMT_Broken")) {
        result->ft->returnInstance(result, rackInstance(request, properties));
        return failure(CMPI_RC_ERR_FAILED, "broken on purpose\x1b[2J");
    }
    const char* const file = std::getenv("CIMT_INVENTORY");
    say(std::string("inventory ") + (file == nullptr ? "unset" : file), CMPI_LEV_VERBOSE);
    const Inventory found = inventory();
    if (!found.error.empty())
        return failure(CMPI_RC_ERR_FAILED, found.error.c_str());
    if (hasClass(request, "CIMT_RackSystem"))
        result->ft->returnInstance(result, rackInstance(request, properties));
    for (const Lamp& lamp : found.lamps) {
        if (hasClass(request, "CIMT_Lamp"))
            result->ft->returnInstance(result, lampInstance(request, properties, lamp));
        if (hasClass(request, "CIMT_RackLamp"))
            result->ft->returnInstance(result, linkInstance(request, lamp));
    }
    result->ft->returnDone(result);
    return ok;
}

CMPIStatus getInstance(CMPIInstanceMI* /*mi*/, const CMPIContext* /*ctx*/, const CMPIResult* result,
                       const CMPIObjectPath* request, const char** properties)
{
    if (request->ft->getKeyCount(request, nullptr) == 0)
        return failure(CMPI_RC_ERR_FAILED, "At least one key should be passed");
    CMPIStatus status{};
    const CMPIData key = request->ft->getKey(request, "DeviceID", &status);
    const std::string wanted = status.rc == CMPI_RC_OK ? textOf(key.value.string) : "";
    for (const Lamp& lamp : lamps())
        if (wanted == lamp.deviceId)
            result->ft->returnInstance(result, lampInstance(request, properties, lamp));
    result->ft->returnDone(result);
    return ok;
}

CMPIStatus cleanupAssociation(CMPIAssociationMI* /*mi*/, const CMPIContext* /*ctx*/,
                              CMPIBoolean /*terminating*/)
{
    return ok;
}

bool refuses(const CMPIObjectPath* request)
{
    return textOf(request->ft->getNameSpace(request, nullptr)) == "root/refusing";
}

/// Shows what came of the options of the command line.
void traceArguments(std::initializer_list<const char*> arguments, const char** properties)
{
    std::string text;
    for (const char* argument : arguments)
        text += (text.empty() ? "" : " ") + std::string(argument == nullptr ? "-" : argument);
    for (; properties != nullptr && *properties != nullptr; ++properties)
        text += std::string(" +") + *properties;
    say(text);
}

CMPIStatus associators(CMPIAssociationMI* /*mi*/, const CMPIContext* /*ctx*/, const CMPIResult* result,
                       const CMPIObjectPath* request, const char* assocClass, const char* resultClass,
                       const char* role, const char* resultRole, const char** properties)
{
    traceArguments({assocClass, resultClass, role, resultRole}, properties);
    if (refuses(request))
        return failure(CMPI_RC_ERR_FAILED, "which association?");
    if (hasClass(request, "CIMT_Lamp"))
        result->ft->returnInstance(result, rackInstance(request, properties));
    if (hasClass(request, "CIMT_RackSystem"))
        for (const Lamp& lamp : lamps())
            result->ft->returnInstance(result, lampInstance(request, properties, lamp));
    return ok;
}

CMPIStatus associatorNames(CMPIAssociationMI* /*mi*/, const CMPIContext* /*ctx*/, const CMPIResult* result,
                           const CMPIObjectPath* request, const char* assocClass, const char* resultClass,
                           const char* role, const char* resultRole)
{
    traceArguments({assocClass, resultClass, role, resultRole}, nullptr);
    if (refuses(request))
        return failure(CMPI_RC_ERR_FAILED, "which association?");
    if (hasClass(request, "CIMT_Lamp"))
        result->ft->returnObjectPath(result, rackPath(request));
    return ok;
}

CMPIStatus references(CMPIAssociationMI* /*mi*/, const CMPIContext* /*ctx*/, const CMPIResult* result,
                      const CMPIObjectPath* request, const char* resultClass, const char* role,
                      const char** properties)
{
    traceArguments({resultClass, role}, properties);
    if (refuses(request))
        return failure(CMPI_RC_ERR_FAILED, "which association?");
    for (const Lamp& lamp : lamps())
        result->ft->returnInstance(result, linkInstance(request, lamp));
    return ok;
}

CMPIStatus referenceNames(CMPIAssociationMI* /*mi*/, const CMPIContext* /*ctx*/, const CMPIResult* result,
                          const CMPIObjectPath* request, const char* resultClass, const char* role)
{
    traceArguments({resultClass, role}, nullptr);
    if (refuses(request))
        return failure(CMPI_RC_ERR_FAILED, "which association?");
    result->ft->returnObjectPath(result, linkPath(request, lamps().front()));
    return ok;
}

} // namespace

extern "C" CMPIInstanceMI* Rack_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* /*ctx*/,
                                                  CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("Rack");
    table.enumerateInstanceNames = enumerateInstanceNames;
    table.enumerateInstances = enumerateInstances;
    table.getInstance = getInstance;
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    return &mi;
}

extern "C" CMPIAssociationMI* Rack_Create_AssociationMI(const CMPIBroker* mb, const CMPIContext* /*ctx*/,
                                                        CMPIStatus* /*rc*/)
{
    static CMPIAssociationMIFT table{
        200, 200, "Rack", cleanupAssociation, associators, associatorNames, references, referenceNames};
    static CMPIAssociationMI mi{nullptr, &table};
    broker = mb;
    return &mi;
}
