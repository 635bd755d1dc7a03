// The factory: records to CMPI instances and object paths, and the far end of an association.

#include "Cmpi.h"
#include "GlimmarkFactory.h"
#include "InventoryCollection.h"
#include "Names.h"
#include "RequestPaths.h"
#include "RequestedProperties.h"
#include "Trace.h"

#include <Tavro/Common.h>
#include <Tavro/Locale.h>

#include <cstdint>
#include <cstring>
#include <utility>

namespace Tavro::GlimmarkProvider {

const std::string loggerGlimmarkObjFactory("Mavrel.GlimmarkObjFactory");

namespace {

const TraceModule traceModule{"GlimmarkObjFactory.cpp", loggerGlimmarkObjFactory};

// What a builder returns.
constexpr int success = 0;
constexpr int nothingFound = 1;
constexpr int notMade = 2;

// A list of records is walked only up to its length modulo 65,536: clients rely on a list never being
// longer than what 16 bits count.
template <class Record>
std::uint16_t countOf(const std::vector<Record>& records)
{
    return static_cast<std::uint16_t>(records.size());
}

/// \return null when the array could not be made
CMPIArray* newArrayOf(const CMPIBroker* broker, const std::vector<std::uint16_t>& values, CMPIStatus* rc)
{
    const std::uint16_t count = countOf(values);
    CMPIArray* const array = Cmpi::newArray(broker, count, CMPI_uint16, rc);
    for (std::uint16_t i = 0; i < count; ++i)
        Cmpi::setElementAt(array, i, values.at(i));
    return array;
}

/// A new instance on a new path of the request; null, or without a handle, when either could not be made.
CMPIInstance* newInstanceOf(const CMPIBroker* broker, const CMPIObjectPath* ref, const char* className,
                            CMPIStatus* rc)
{
    // No status for the two calls that make objects: their failure shows in what they return.
    const CMPIObjectPath* const path =
        Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, rc), className, nullptr);
    if (!Cmpi::exists(path))
        return nullptr;
    setOrigin(path, ref, rc);
    return Cmpi::newInstance(broker, path, nullptr);
}

std::string caption()
{
    constexpr int providerTexts = 2; // number of the resource library
    const std::string language = Locale::getLanguageId();
    const std::wstring library = Locale::getResourceLibrary(providerTexts, language);
    const ResourceString text(library, L"MSGID_ALARMDEVICE_CAPTION");
    return make_string(text);
}

/// Sets keys on a path or on an instance: the same names and values in the same order.
template <class Set>
void forEachGlimmarkKey(const Glimmark& glimmark, Set set)
{
    set("CreationClassName", GlimmarkClass);
    set("DeviceID", glimmark.getDeviceID());
    set("SystemCreationClassName", ComputerSystemClass);
    set("SystemName", getSystemName());
}

/// Sets the properties asked for that are no keys.
/// \return false when the array of the operational status could not be made; those after it are not set
bool setGlimmarkProperties(const CMPIBroker* broker, const CMPIInstance* instance, const Glimmark& glimmark,
                           const RequestedProperties& requested, CMPIStatus* rc)
{
    const auto set = [&](const char* name, auto value) {
        if (requested.include(name))
            Cmpi::setProperty(instance, name, value());
    };
    // An indicator has no description or name of its own: all three carry the element name.
    const auto elementName = [&] { return glimmark.getElementName(); };

    set("Caption", caption);
    set("Description", elementName);
    set("Name", elementName);
    set("ElementName", elementName);
    set("RequestedState", [&] { return static_cast<CMPIUint16>(glimmark.getRequestedState()); });
    set("HealthState", [&] { return static_cast<CMPIUint16>(glimmark.getHealthState()); });
    if (requested.include("OperationalStatus")) {
        CMPIArray* const statuses = newArrayOf(broker, glimmark.getOperationalStatus(), rc);
        if (statuses == nullptr) {
            // The runs of blanks, here and in the texts below, are part of the texts: clients and
            // administrators' log filters match them as they are.
            Cmpi::reportFailure(
                broker, GlimmarkProfileProvider, rc,
                "Create Array for Property                         OperationalStatus failed.",
                "Create Array for Property Operat                        ionalStatus failed.");
            return false;
        }
        Cmpi::setProperty(instance, "OperationalStatus", statuses);
    }
    set("AudibleAlarm", [&] { return glimmark.getAudibleAlarm(); });
    set("VisibleAlarm", [&] { return glimmark.getVisibleAlarm(); });
    set("MotionAlarm", [&] { return glimmark.getMotionAlarm(); });
    set("AlarmState", [&] { return CMPIUint16{glimmark.getAlarmState()}; });
    return true;
}

void setCapabilitiesProperties(const CMPIBroker* broker, const CMPIInstance* instance,
                               GlimmarkCapabilities& glimmarkCap, const RequestedProperties& requested,
                               CMPIStatus* rc)
{
    if (!requested.include("RequestedAlarmStatesSupported"))
        return;
    CMPIArray* const states = newArrayOf(broker, glimmarkCap.getAlarmStatesSupported(), rc);
    if (states == nullptr) {
        // "array" in the status, "Array" in the trace: both are meant.
        Cmpi::reportFailure(
            broker, GlimmarkCapabilitiesProvider, rc,
            "Creating array for Property                         RequestedAlarmStatesSupported failed.",
            "Creating Array for Property                         RequestedAlarmStatesSupported failed.");
        return;
    }
    Cmpi::setProperty(instance, "RequestedAlarmStatesSupported", states);
}

/// The record whose key is the text of a broker's string; `map.end()` where there is none.
template <class Map>
typename Map::const_iterator findKey(const Map& map, const CMPIString* key, CMPIStatus* rc)
{
    const char* const text = Cmpi::characters(key, rc);
    return text != nullptr ? map.find(text) : map.end();
}

} // namespace

GlimmarkFactory::GlimmarkFactory() = default;

GlimmarkFactory::GlimmarkFactory(bool collectDevices, bool collectCapabilities)
{
    if (collectDevices && getGlimmarkInstances(glimmarks) == 0)
        _createGlimmarkMap();
    if (collectCapabilities && getGlimmarkCapabilitiesInstances(capabilities) == 0)
        _createCapabilitiesMap();
}

GlimmarkFactory::~GlimmarkFactory() = default;

int GlimmarkFactory::getNumberOfInstances() const
{
    return static_cast<int>(glimmarkMap.size());
}

void GlimmarkFactory::_createGlimmarkMap()
{
    const std::uint16_t count = countOf(glimmarks);
    for (std::uint16_t i = 0; i < count; ++i) {
        Glimmark& glimmark = glimmarks[i];
        // The last one of an identifier wins. Nobody reads the list any more: its records are moved.
        glimmarkMap[glimmark.getDeviceID()] = std::move(glimmark);
    }
}

void GlimmarkFactory::_createCapabilitiesMap()
{
    const std::uint16_t count = countOf(capabilities);
    for (std::uint16_t i = 0; i < count; ++i) {
        GlimmarkCapabilities record = capabilities[i];
        const std::string key = record.getInstanceID(); // stored in the record too, before it is copied
        capabilitiesMap[key] = record;
    }
}

CMPIInstance* GlimmarkFactory::makeGlimmarkInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                    Glimmark glimmark, const char** properties,
                                                    bool isObjPath, CMPIStatus* rc) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " glimmark=", &glimmark,
                             " properties=", properties, " isObjPath=", isObjPath, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "makeGlimmarkInstance");
    flow.entering(parameters());

    CMPIInstance* const instance = newInstanceOf(broker, ref, GlimmarkClass, rc);
    if (Cmpi::exists(instance)) {
        const char* keys[] = {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName",
                              nullptr};
        Cmpi::setPropertyFilter(instance, properties, keys);
        forEachGlimmarkKey(
            glimmark, [&](const char* name, const auto& value) { Cmpi::setProperty(instance, name, value); });
        const RequestedProperties requested(properties, isObjPath);
        if (!setGlimmarkProperties(broker, instance, glimmark, requested, rc))
            return instance; // meant: no EXITING line, and the half-filled instance is handed on
    }
    flow.exiting(parameters());
    return instance;
}

int GlimmarkFactory::getAllGlimmarkCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                 const char** properties, bool isObjPath,
                                                 std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " properties=", properties,
                             " isObjPath=", isObjPath, " instances=", &instances, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "getAllGlimmarkCMPIInstances");
    flow.entering(parameters());
    for (const auto& [deviceID, glimmark] : glimmarkMap)
        instances.push_back(makeGlimmarkInstance(broker, ref, glimmark, properties, isObjPath, rc));
    flow.exiting(parameters());
    return success;
}

int GlimmarkFactory::getOneGlimmarkCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                CMPIString* key, const char** properties,
                                                std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " key=", key, " properties=", properties,
                             " instances=", &instances, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "getOneGlimmarkCMPIInstance");
    flow.entering(parameters());
    const auto found = findKey(glimmarkMap, key, rc);
    if (found == glimmarkMap.end())
        return nothingFound; // meant: no EXITING line, no status
    instances.push_back(makeGlimmarkInstance(broker, ref, found->second, properties, false, rc));
    flow.exiting(parameters());
    return success;
}

int GlimmarkFactory::getAllGlimmarkCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                std::vector<CMPIObjectPath*>& objectPaths,
                                                CMPIStatus* status) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " objectPaths=", &objectPaths,
                             " status=", status);
    };
    const FunctionTrace flow(traceModule, "getAllGlimmarkCMPIObjPaths");
    flow.entering(parameters());
    if (glimmarkMap.empty()) {
        // For information only: a server without indicators is no fault.
        Cmpi::trace(broker, CMPI_LEV_INFO, GlimmarkProfileProvider, "***No instance found***");
        return nothingFound;
    }
    for (const auto& [deviceID, glimmark] : glimmarkMap) {
        CMPIObjectPath* const path =
            Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, status), GlimmarkClass, status);
        if (!Cmpi::exists(path)) {
            // The trace names a class that this system does not have; log filters know it so.
            Cmpi::reportFailure(broker, GlimmarkProfileProvider, status, "Create CMPIObjectPath failed.",
                                "Create CMPIObjectPath                     failed for RecordLogClass.");
            return notMade;
        }
        setOrigin(path, ref, status);
        forEachGlimmarkKey(glimmark,
                           [&](const char* name, const auto& value) { Cmpi::addKey(path, name, value); });
        objectPaths.push_back(path);
    }
    flow.exiting(parameters());
    return success;
}

CMPIInstance* GlimmarkFactory::makeGlimmarkCapabilitiesInstance(const CMPIBroker* broker,
                                                                const CMPIObjectPath* ref,
                                                                GlimmarkCapabilities glimmarkCap,
                                                                const char** properties, bool isObjPath,
                                                                CMPIStatus* rc) const
{
    const auto parameters = [&] {
        // " IsObjPath=" with a capital I, unlike the other builders: meant, log filters know it so.
        return parameterList(" broker=", broker, " ref=", ref, " glimmarkCap=", &glimmarkCap,
                             " properties=", properties, " IsObjPath=", isObjPath, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "makeGlimmarkCapabilitiesInstance");
    flow.entering(parameters());

    CMPIInstance* const instance = newInstanceOf(broker, ref, GlimmarkCapabilitiesClass, rc);
    if (Cmpi::exists(instance)) {
        const char* keys[] = {"InstanceID", nullptr};
        Cmpi::setPropertyFilter(instance, properties, keys);
        Cmpi::setProperty(instance, "InstanceID", glimmarkCap.getInstanceID());
        const RequestedProperties requested(properties, isObjPath);
        setCapabilitiesProperties(broker, instance, glimmarkCap, requested, rc);
    }
    // Unlike the alarm device builder, a failed array does not cost the EXITING line.
    flow.exiting(parameters());
    return instance;
}

int GlimmarkFactory::getAllGlimmarkCapabilitiesCMPIInstances(const CMPIBroker* broker,
                                                             const CMPIObjectPath* ref,
                                                             const char** properties, bool isObjPath,
                                                             std::vector<CMPIInstance*>& instances,
                                                             CMPIStatus* rc) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " properties=", properties,
                             " isObjPath=", isObjPath, " instances=", &instances, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "getAllGlimmarkCapabilitiesCMPIInstances");
    flow.entering(parameters());
    for (const auto& [instanceID, record] : capabilitiesMap)
        instances.push_back(makeGlimmarkCapabilitiesInstance(broker, ref, record, properties, isObjPath, rc));
    flow.exiting(parameters());
    return success;
}

int GlimmarkFactory::getOneGlimmarkCapabilitiesCMPIInstance(const CMPIBroker* broker,
                                                            const CMPIObjectPath* ref, CMPIString* key,
                                                            const char** properties,
                                                            std::vector<CMPIInstance*>& instances,
                                                            CMPIStatus* rc) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " key=", key, " properties=", properties,
                             " instances=", &instances, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "getOneGlimmarkCapabilitiesCMPIInstance");
    flow.entering(parameters());
    const auto found = findKey(capabilitiesMap, key, rc);
    if (found == capabilitiesMap.end())
        return nothingFound; // meant: no EXITING line, no status
    instances.push_back(makeGlimmarkCapabilitiesInstance(broker, ref, found->second, properties, false, rc));
    flow.exiting(parameters());
    return success;
}

int GlimmarkFactory::getAllGlimmarkCapabilitiesCMPIObjPaths(const CMPIBroker* broker,
                                                            const CMPIObjectPath* ref,
                                                            std::vector<CMPIObjectPath*>& objectPaths,
                                                            CMPIStatus* status) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " objectPaths=", &objectPaths,
                             " status=", status);
    };
    const FunctionTrace flow(traceModule, "getAllGlimmarkCapabilitiesCMPIObjPaths");
    flow.entering(parameters());
    if (capabilitiesMap.empty()) {
        // A warning, unlike the alarm devices': a system always has its capabilities.
        Cmpi::trace(broker, CMPI_LEV_WARNING, GlimmarkCapabilitiesProvider, "***No instance found***");
        return nothingFound;
    }
    for (const auto& [instanceID, record] : capabilitiesMap) {
        CMPIObjectPath* const path =
            Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, status), GlimmarkCapabilitiesClass, status);
        if (!Cmpi::exists(path)) {
            // No full stop in the status, unlike the alarm devices': meant.
            Cmpi::reportFailure(
                broker, GlimmarkCapabilitiesProvider, status, "Create CMPIObjectPath failed",
                "Create CMPIObjectPath failed for                     GlimmarkCapabilities class");
            return notMade;
        }
        setOrigin(path, ref, status);
        GlimmarkCapabilities copy = record;
        Cmpi::addKey(path, "InstanceID", copy.getInstanceID());
        objectPaths.push_back(path);
    }
    flow.exiting(parameters());
    return success;
}

namespace {

/// One way through an association: from a class by an association class to the far end's class.
struct Route
{
    const char* sourceClass;
    const char* assocClass;
    const char* targetClass;
    const char* provider;
    const char* traceText;
};

constexpr Route routes[] = {
    {ComputerSystemClass, GlimmarkSystemDeviceClass, GlimmarkClass, GlimmarkSystemDeviceProvider,
     "Target Class is GlimmarkClass"},
    {GlimmarkClass, GlimmarkSystemDeviceClass, ComputerSystemClass, GlimmarkSystemDeviceProvider,
     "Target Class is ComputerSystemClass"},
    {GlimmarkClass, GlimmarkElementCapabilitiesClass, GlimmarkCapabilitiesClass,
     GlimmarkElementCapabilitiesProvider, "Target Class is GlimmarkCapabilitiesClass"},
    {GlimmarkCapabilitiesClass, GlimmarkElementCapabilitiesClass, GlimmarkClass,
     GlimmarkElementCapabilitiesProvider, "Target Class is GlimmarkClass"},
};

/// Exact, letter case included; a null text equals nothing.
bool equals(const char* text, const char* name)
{
    return text != nullptr && std::strcmp(text, name) == 0;
}

} // namespace

const char* GlimmarkFactory::get_assoc_targetClass_Name(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                        const char* assocClass, const char* resultClass,
                                                        CMPIStatus* rc) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " _RefLeftClass=", assocClass,
                             " _RefRightClass=", resultClass, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "get_assoc_targetClass_Name");
    flow.entering(parameters());
    for (const Route& route : routes) {
        // The class of the path is read afresh for each route.
        if (equals(Cmpi::classNameOf(ref, rc), route.sourceClass) && equals(assocClass, route.assocClass)) {
            Cmpi::trace(broker, CMPI_LEV_INFO, route.provider, route.traceText);
            flow.exiting(parameters());
            return route.targetClass;
        }
    }
    return nullptr; // meant: no EXITING line
}

CMPIObjectPath* GlimmarkFactory::get_assoc_targetClass_ObjectPath(const CMPIBroker* broker,
                                                                  const CMPIObjectPath* ref,
                                                                  const char* assocClass,
                                                                  const char* resultClass,
                                                                  CMPIStatus* rc) const
{
    const auto parameters = [&] {
        return parameterList(" broker=", broker, " ref=", ref, " _RefLeftClass=", assocClass,
                             " _RefRightClass=", resultClass, " rc=", rc);
    };
    const FunctionTrace flow(traceModule, "get_assoc_targetClass_ObjectPath");
    flow.entering(parameters());
    CMPIObjectPath* path = nullptr;
    if (const char* target = get_assoc_targetClass_Name(broker, ref, assocClass, resultClass, rc)) {
        path = Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, rc), target, rc);
        setOrigin(path, ref, rc);
    }
    flow.exiting(parameters());
    return path;
}

} // namespace Tavro::GlimmarkProvider
