// The factory: records to CMPI instances and object paths, and the far end of an association.

#include "Cmpi.h"
#include "Counted.h"
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

const std::wstring captionMessage(L"MSGID_ALARMDEVICE_CAPTION");

// What a builder returns.
constexpr int success = 0;
constexpr int nothingFound = 1;
constexpr int notMade = 2;

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
    const ResourceString text(library, captionMessage);
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
            // Deliberate: the runs of blanks, here and in the texts below; log filters match them.
            // Test: GlimmarkFactoryTest.WithoutTheArrayTheInstanceIsHandedBackHalfFilledAndTheFailureReported.
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
        // Deliberate: "array" in the status, "Array" in the trace; log filters match them.
        // Test: CapabilitiesObjectsTest.WithoutTheArrayTheInstanceCarriesItsKeyAndTheFailureIsReported.
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
    for (Glimmark& glimmark : Counted(glimmarks)) {
        // The last one of an identifier wins. Nobody reads the list any more: its records are moved.
        glimmarkMap.insert_or_assign(glimmark.getDeviceID(), std::move(glimmark));
    }
    glimmarks = std::vector<Glimmark>();
}

void GlimmarkFactory::_createCapabilitiesMap()
{
    for (GlimmarkCapabilities& record : Counted(capabilities)) {
        const std::string key = record.getInstanceID(); // stored in the record too, before it is copied
        capabilitiesMap[key] = record;
    }
}

CMPIInstance* GlimmarkFactory::makeGlimmarkInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                    Glimmark glimmark, const char** properties,
                                                    bool isObjPath, CMPIStatus* rc) const
{
    const FunctionTrace flow(traceModule, "makeGlimmarkInstance", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " glimmark=", &glimmark,
                             " properties=", properties, " isObjPath=", isObjPath, " rc=", rc);
    });

    CMPIInstance* const instance = newInstanceOf(broker, ref, GlimmarkClass, rc);
    if (Cmpi::exists(instance)) {
        const char* keys[] = {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName",
                              nullptr};
        Cmpi::setPropertyFilter(instance, properties, keys);
        forEachGlimmarkKey(
            glimmark, [&](const char* name, const auto& value) { Cmpi::setProperty(instance, name, value); });
        const RequestedProperties requested(properties, isObjPath);
        // Deliberate: no EXITING line, and the half-filled instance is handed on; clients get what could be
        // made.
        // Test: GlimmarkFactoryTest.WithoutTheArrayTheInstanceIsHandedBackHalfFilledAndTheFailureReported.
        if (!setGlimmarkProperties(broker, instance, glimmark, requested, rc))
            return instance;
    }
    flow.exiting();
    return instance;
}

int GlimmarkFactory::getAllGlimmarkCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                 const char** properties, bool isObjPath,
                                                 std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const
{
    const FunctionTrace flow(traceModule, "getAllGlimmarkCMPIInstances", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " properties=", properties,
                             " isObjPath=", isObjPath, " instances=", &instances, " rc=", rc);
    });
    for (const auto& [deviceID, glimmark] : glimmarkMap)
        instances.push_back(makeGlimmarkInstance(broker, ref, glimmark, properties, isObjPath, rc));
    flow.exiting();
    return success;
}

int GlimmarkFactory::getOneGlimmarkCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                CMPIString* key, const char** properties,
                                                std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const
{
    const FunctionTrace flow(traceModule, "getOneGlimmarkCMPIInstance", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " key=", key, " properties=", properties,
                             " instances=", &instances, " rc=", rc);
    });
    const auto found = findKey(glimmarkMap, key, rc);
    // Deliberate: no EXITING line, no status; the operation's caller, a broker, says "not found".
    // Test: GlimmarkFactoryTest.OneInstanceIsNotFoundByAnythingElse.
    if (found == glimmarkMap.end())
        return nothingFound;
    instances.push_back(makeGlimmarkInstance(broker, ref, found->second, properties, false, rc));
    flow.exiting();
    return success;
}

int GlimmarkFactory::getAllGlimmarkCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                std::vector<CMPIObjectPath*>& objectPaths,
                                                CMPIStatus* status) const
{
    const FunctionTrace flow(traceModule, "getAllGlimmarkCMPIObjPaths", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " objectPaths=", &objectPaths,
                             " status=", status);
    });
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
    flow.exiting();
    return success;
}

CMPIInstance* GlimmarkFactory::makeGlimmarkCapabilitiesInstance(const CMPIBroker* broker,
                                                                const CMPIObjectPath* ref,
                                                                GlimmarkCapabilities glimmarkCap,
                                                                const char** properties, bool isObjPath,
                                                                CMPIStatus* rc) const
{
    const FunctionTrace flow(traceModule, "makeGlimmarkCapabilitiesInstance", [&] {
        // Deliberate: " IsObjPath=" with a capital I, unlike the other builders; log filters know it so.
        // Test: CapabilitiesObjectsTest.InstanceIsTraced.
        return parameterList(" broker=", broker, " ref=", ref, " glimmarkCap=", &glimmarkCap,
                             " properties=", properties, " IsObjPath=", isObjPath, " rc=", rc);
    });

    CMPIInstance* const instance = newInstanceOf(broker, ref, GlimmarkCapabilitiesClass, rc);
    if (Cmpi::exists(instance)) {
        const char* keys[] = {"InstanceID", nullptr};
        Cmpi::setPropertyFilter(instance, properties, keys);
        Cmpi::setProperty(instance, "InstanceID", glimmarkCap.getInstanceID());
        const RequestedProperties requested(properties, isObjPath);
        setCapabilitiesProperties(broker, instance, glimmarkCap, requested, rc);
    }
    // Deliberate: unlike the alarm device builder, a failed array does not cost the EXITING line; log filters
    // count on it.
    // Test: CapabilitiesObjectsTest.WithoutTheArrayTheInstanceCarriesItsKeyAndTheFailureIsReported.
    flow.exiting();
    return instance;
}

int GlimmarkFactory::getAllGlimmarkCapabilitiesCMPIInstances(const CMPIBroker* broker,
                                                             const CMPIObjectPath* ref,
                                                             const char** properties, bool isObjPath,
                                                             std::vector<CMPIInstance*>& instances,
                                                             CMPIStatus* rc) const
{
    const FunctionTrace flow(traceModule, "getAllGlimmarkCapabilitiesCMPIInstances", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " properties=", properties,
                             " isObjPath=", isObjPath, " instances=", &instances, " rc=", rc);
    });
    for (const auto& [instanceID, record] : capabilitiesMap)
        instances.push_back(makeGlimmarkCapabilitiesInstance(broker, ref, record, properties, isObjPath, rc));
    flow.exiting();
    return success;
}

int GlimmarkFactory::getOneGlimmarkCapabilitiesCMPIInstance(const CMPIBroker* broker,
                                                            const CMPIObjectPath* ref, CMPIString* key,
                                                            const char** properties,
                                                            std::vector<CMPIInstance*>& instances,
                                                            CMPIStatus* rc) const
{
    const FunctionTrace flow(traceModule, "getOneGlimmarkCapabilitiesCMPIInstance", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " key=", key, " properties=", properties,
                             " instances=", &instances, " rc=", rc);
    });
    const auto found = findKey(capabilitiesMap, key, rc);
    // Deliberate: no EXITING line, no status, as for an alarm device.
    // Test: CapabilitiesObjectsTest.OneInstanceIsNotFoundByAnythingElse.
    if (found == capabilitiesMap.end())
        return nothingFound;
    instances.push_back(makeGlimmarkCapabilitiesInstance(broker, ref, found->second, properties, false, rc));
    flow.exiting();
    return success;
}

int GlimmarkFactory::getAllGlimmarkCapabilitiesCMPIObjPaths(const CMPIBroker* broker,
                                                            const CMPIObjectPath* ref,
                                                            std::vector<CMPIObjectPath*>& objectPaths,
                                                            CMPIStatus* status) const
{
    const FunctionTrace flow(traceModule, "getAllGlimmarkCapabilitiesCMPIObjPaths", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " objectPaths=", &objectPaths,
                             " status=", status);
    });
    if (capabilitiesMap.empty()) {
        // A warning, unlike the alarm devices': a system always has its capabilities.
        Cmpi::trace(broker, CMPI_LEV_WARNING, GlimmarkCapabilitiesProvider, "***No instance found***");
        return nothingFound;
    }
    for (const auto& [instanceID, record] : capabilitiesMap) {
        CMPIObjectPath* const path =
            Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, status), GlimmarkCapabilitiesClass, status);
        if (!Cmpi::exists(path)) {
            // Deliberate: no full stop in the status, unlike the alarm devices'; log filters match it.
            // Test: CapabilitiesObjectsTest.APathThatCannotBeMadeIsReported.
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
    flow.exiting();
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
    const FunctionTrace flow(traceModule, "get_assoc_targetClass_Name", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " _RefLeftClass=", assocClass,
                             " _RefRightClass=", resultClass, " rc=", rc);
    });
    for (const Route& route : routes) {
        // The class of the path is read afresh for each route.
        if (equals(Cmpi::classNameOf(ref, rc), route.sourceClass) && equals(assocClass, route.assocClass)) {
            Cmpi::trace(broker, CMPI_LEV_INFO, route.provider, route.traceText);
            flow.exiting();
            return route.targetClass;
        }
    }
    // Deliberate: no EXITING line; log filters count on it.
    // Test: UnknownWays.LeadNowhereWithoutATraceAndAnExit.
    return nullptr;
}

CMPIObjectPath* GlimmarkFactory::get_assoc_targetClass_ObjectPath(const CMPIBroker* broker,
                                                                  const CMPIObjectPath* ref,
                                                                  const char* assocClass,
                                                                  const char* resultClass,
                                                                  CMPIStatus* rc) const
{
    const FunctionTrace flow(traceModule, "get_assoc_targetClass_ObjectPath", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " _RefLeftClass=", assocClass,
                             " _RefRightClass=", resultClass, " rc=", rc);
    });
    CMPIObjectPath* path = nullptr;
    if (const char* target = get_assoc_targetClass_Name(broker, ref, assocClass, resultClass, rc)) {
        path = Cmpi::newObjectPath(broker, Cmpi::nameSpaceOf(ref, rc), target, rc);
        setOrigin(path, ref, rc);
    }
    flow.exiting();
    return path;
}

} // namespace Tavro::GlimmarkProvider
