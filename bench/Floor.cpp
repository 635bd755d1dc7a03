#include "Floor.h"

#include "Names.h"

#include <MVLog/MVLogger.h>
#include <MVLog/MVMessageBuffer.h>
#include <Tavro/Common.h>
#include <Tavro/Instrumentation.h>
#include <Tavro/Locale.h>

#include <functional>
#include <map>
#include <vector>

namespace bench {

namespace {

using namespace Tavro::GlimmarkProvider; // the names of classes and providers

using Paths = std::vector<CMPIObjectPath*>;
using Instances = std::vector<CMPIInstance*>;

// Trace points.

struct Module
{
    const char* file;
    std::string category;
};

const Module records{"Glimmark.cpp", "Mavrel.Glimmark"};
const Module factory{"GlimmarkObjFactory.cpp", "Mavrel.GlimmarkObjFactory"};
const Module devices{"GlimmarkProvider.cpp", "Mavrel.GlimmarkProvider"};
const Module shared{"GlimmarkCapabilitiesProvider.cpp", "Mavrel.GlimmarkCapabilitiesProvider"};
const Module elements{"GlimmarkElementCapabilitiesProvider.cpp",
                      "Mavrel.GlimmarkElementCapabilitiesProvider"};
const Module systems{"GlimmarkSystemDeviceProvider.cpp", "Mavrel.GlimmarkSystemDeviceProvider"};

/// What stands in a parameter list where the library has an address of its own.
const int someObject = 0;
const void* const address = &someObject;
const char* const noText = nullptr;
const void* const noList = nullptr;

/// The flow lines of one function. A line's text is put together at its first use, with the addresses of that
/// time, and stays as it is.
class Flow
{
public:
    Flow(const Module& tracedModule, const char* tracedFunction)
        : module(tracedModule),
          function(tracedFunction)
    {}

    template <class... LabelsAndValues>
    void entering(const LabelsAndValues&... parameters)
    {
        point("ENTERING: ", enteringText, parameters...);
    }

    template <class... LabelsAndValues>
    void exiting(const LabelsAndValues&... parameters)
    {
        point("EXITING: ", exitingText, parameters...);
    }

private:
    static constexpr int level = 3000;
    static constexpr int line = 100;

    template <class... LabelsAndValues>
    void point(const char* kind, std::string& text, const LabelsAndValues&... parameters)
    {
        const std::string list = [&] {
            MVLog::MVMessageBuffer buffer;
            (buffer << ... << parameters);
            return buffer.str();
        }();
        if (text.empty())
            text = kind + std::string(function) + "() in " + module.file + " [Line: " + std::to_string(line) +
                   "],Parameters List: " + list;
        MVLog::MVLogger::logLevelMessage(function, module.file, line, module.category, level, nullptr, 0, 0,
                                         message(text));
        MVLog::MVLogger::traceLevelMessage(function, module.file, line, module.category, level, nullptr, 0, 0,
                                           message(text));
    }

    static std::string message(const std::string& text)
    {
        MVLog::MVMessageBuffer buffer;
        buffer << text.c_str();
        return buffer.str();
    }

    const Module& module;
    const char* function;
    std::string enteringText;
    std::string exitingText;
};

// Calls of the broker.

const CMPIValue* chars(const char* text)
{
    return reinterpret_cast<const CMPIValue*>(text);
}

const char* nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* rc)
{
    const CMPIString* const nameSpace = path->ft->getNameSpace(path, rc);
    return nameSpace->ft->getCharPtr(nameSpace, rc);
}

void readClassName(const CMPIObjectPath* path, CMPIStatus* rc)
{
    const CMPIString* const name = path->ft->getClassName(path, rc);
    name->ft->getCharPtr(name, rc);
}

void setNameSpaceOf(const CMPIObjectPath* path, const FloorRequest& request, CMPIStatus* rc)
{
    path->ft->setNameSpace(path, nameSpaceOf(request.ref, rc));
}

void setOrigin(const CMPIObjectPath* path, const FloorRequest& request, CMPIStatus* rc)
{
    setNameSpaceOf(path, request, rc);
    path->ft->setHostname(path, Tavro::getSystemName().c_str());
}

/// \param newPathRc  the status pointer of the call that makes the path
CMPIObjectPath* newPath(const char* className, const FloorRequest& request, CMPIStatus* rc,
                        CMPIStatus* newPathRc)
{
    return request.broker->eft->newObjectPath(request.broker, nameSpaceOf(request.ref, rc), className,
                                              newPathRc);
}

CMPIObjectPath* newPathWithOrigin(const char* className, const FloorRequest& request, CMPIStatus* rc)
{
    CMPIObjectPath* const path = newPath(className, request, rc, rc);
    setOrigin(path, request, rc);
    return path;
}

CMPIInstance* newInstance(const CMPIObjectPath* path, const FloorRequest& request, CMPIStatus* rc)
{
    return request.broker->eft->newInstance(request.broker, path, rc);
}

void addReferenceKey(const CMPIObjectPath* path, const char* name, const CMPIObjectPath* target)
{
    CMPIValue value{};
    value.ref = const_cast<CMPIObjectPath*>(target);
    path->ft->addKey(path, name, &value, CMPI_ref);
}

void setReference(const CMPIInstance* instance, const char* name, const CMPIObjectPath* target)
{
    CMPIValue value{};
    value.ref = const_cast<CMPIObjectPath*>(target);
    instance->ft->setProperty(instance, name, &value, CMPI_ref);
}

void setText(const CMPIInstance* instance, const char* name, const char* text)
{
    instance->ft->setProperty(instance, name, chars(text), CMPI_chars);
}

void setNumber(const CMPIInstance* instance, const char* name, CMPIUint16 number)
{
    CMPIValue value{};
    value.uint16 = number;
    instance->ft->setProperty(instance, name, &value, CMPI_uint16);
}

void setFlag(const CMPIInstance* instance, const char* name, bool flag)
{
    CMPIValue value{};
    value.boolean = flag ? 1 : 0;
    instance->ft->setProperty(instance, name, &value, CMPI_boolean);
}

void setNumbers(const CMPIInstance* instance, const char* name, const std::vector<CMPIUint16>& numbers,
                const FloorRequest& request, CMPIStatus* rc)
{
    const auto count = static_cast<CMPICount>(numbers.size());
    CMPIValue value{};
    value.array = request.broker->eft->newArray(request.broker, count, CMPI_uint16, rc);
    for (CMPICount i = 0; i < count; ++i) {
        CMPIValue number{};
        number.uint16 = numbers[i];
        value.array->ft->setElementAt(value.array, i, &number, CMPI_uint16);
    }
    instance->ft->setProperty(instance, name, &value, CMPI_uint16A);
}

CMPIObjectPath* objectPathOf(const CMPIInstance* instance, CMPIStatus* rc)
{
    return instance->ft->getObjectPath(instance, rc);
}

void returnPath(const CMPIObjectPath* path, const FloorRequest& request)
{
    request.rslt->ft->returnObjectPath(request.rslt, path);
}

void returnPathOf(const CMPIObjectPath* path, const FloorRequest& request, CMPIStatus* rc)
{
    setNameSpaceOf(path, request, rc);
    returnPath(path, request);
}

void returnInstance(const CMPIInstance* instance, const FloorRequest& request)
{
    request.rslt->ft->returnInstance(request.rslt, instance);
}

void returnInstances(const Instances& instances, const FloorRequest& request)
{
    for (const CMPIInstance* instance : instances)
        returnInstance(instance, request);
}

void returnDone(const FloorRequest& request)
{
    request.rslt->ft->returnDone(request.rslt);
}

/// Compares the path of each instance with the request's, which is that of none but the last of them.
void compareAll(const Instances& instances, bool deep, const FloorRequest& request, CMPIStatus* rc)
{
    for (const CMPIInstance* instance : instances)
        Tavro::isObjPathsEqual(request.ref, objectPathOf(instance, rc), deep);
}

/// Compares deep, and returns the last instance if it is the one asked for.
void compareAndReturn(const Instances& instances, bool lastIsAsked, const FloorRequest& request,
                      CMPIStatus* rc)
{
    compareAll(instances, true, request, rc);
    if (lastIsAsked)
        returnInstance(instances.back(), request);
}

// Collections.

void collectDevices(const FloorRequest& request)
{
    static Flow flow(records, "setVector");
    {
        Tavro::Instrumentation cursor;
        cursor.selectNode(Tavro::NodeLexicon::DiagnosticIndicator);
        if (!cursor)
            return;
        flow.entering(" vectGlimmark=", address, " instrumentation=", address);
        for (; cursor; ++cursor) {
            const std::string path = cursor.convertPathToString(cursor.getPathToNode());
            const std::string description = cursor.getNodeDescription();
            [[maybe_unused]] const unsigned int status = cursor.getNodeStatus();
            unsigned int alarmState = 1;
            cursor.getProperty(Tavro::NodeLexicon::AlarmState, alarmState);
        }
        flow.exiting(" vectGlimmark=", address, " instrumentation=", address);
    }
    for (const std::string& deviceID : request.indicators.deviceIDs)
        Tavro::stripSpaces(deviceID);
}

void collectCapabilities()
{
    static Flow flow(records, "getGlimmarkCapabilitiesInstances");
    flow.entering(" vectGlimmarkCapabilities=", address);
    flow.exiting(" vectGlimmarkCapabilities=", address);
}

// Alarm devices.

void setCaption(const CMPIInstance* instance)
{
    static const std::wstring messageId = L"MSGID_ALARMDEVICE_CAPTION";
    constexpr int providerTexts = 2;
    const std::string caption = [] {
        const std::string language = Tavro::Locale::getLanguageId();
        const std::wstring library = Tavro::Locale::getResourceLibrary(providerTexts, language);
        const Tavro::ResourceString text(library, messageId);
        return Tavro::make_string(text);
    }();
    setText(instance, "Caption", caption.c_str());
}

CMPIInstance* makeDevice(const Indicator& indicator, const FloorRequest& request, CMPIStatus* rc)
{
    static Flow flow(factory, "makeGlimmarkInstance");
    static const char* keys[] = {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName",
                                 nullptr};
    flow.entering(" broker=", address, " ref=", address, " glimmark=", address, " properties=", noList,
                  " isObjPath=", false, " rc=", address);
    const CMPIObjectPath* const path = newPath(GlimmarkClass, request, rc, nullptr);
    setOrigin(path, request, rc);
    CMPIInstance* const instance = newInstance(path, request, nullptr);
    instance->ft->setPropertyFilter(instance, nullptr, keys);
    setText(instance, "CreationClassName", GlimmarkClass);
    setText(instance, "DeviceID", Tavro::stripSpaces(indicator.deviceID).c_str());
    setText(instance, "SystemCreationClassName", ComputerSystemClass);
    setText(instance, "SystemName", Tavro::getSystemName().c_str());
    setCaption(instance);
    setText(instance, "Description", Tavro::stripSpaces(indicator.elementName).c_str());
    setText(instance, "Name", Tavro::stripSpaces(indicator.elementName).c_str());
    setText(instance, "ElementName", Tavro::stripSpaces(indicator.elementName).c_str());
    setNumber(instance, "RequestedState", 2);
    setNumber(instance, "HealthState", indicator.healthState);
    setNumbers(instance, "OperationalStatus", indicator.operationalStatus, request, rc);
    setFlag(instance, "AudibleAlarm", false);
    setFlag(instance, "VisibleAlarm", true);
    setFlag(instance, "MotionAlarm", false);
    setNumber(instance, "AlarmState", indicator.alarmState);
    flow.exiting(" broker=", address, " ref=", address, " glimmark=", address, " properties=", noList,
                 " isObjPath=", false, " rc=", address);
    return instance;
}

Instances makeDevices(const FloorRequest& request, CMPIStatus* rc)
{
    static Flow flow(factory, "getAllGlimmarkCMPIInstances");
    Instances instances;
    instances.reserve(request.indicators.sorted.size());
    flow.entering(" broker=", address, " ref=", address, " properties=", noList, " isObjPath=", false,
                  " instances=", address, " rc=", address);
    for (const Indicator& indicator : request.indicators.sorted)
        instances.push_back(makeDevice(indicator, request, rc));
    flow.exiting(" broker=", address, " ref=", address, " properties=", noList, " isObjPath=", false,
                 " instances=", address, " rc=", address);
    return instances;
}

CMPIObjectPath* makeDevicePath(const Indicator& indicator, const FloorRequest& request, CMPIStatus* rc)
{
    CMPIObjectPath* const path = newPathWithOrigin(GlimmarkClass, request, rc);
    path->ft->addKey(path, "CreationClassName", chars(GlimmarkClass), CMPI_chars);
    path->ft->addKey(path, "DeviceID", chars(Tavro::stripSpaces(indicator.deviceID).c_str()), CMPI_chars);
    path->ft->addKey(path, "SystemCreationClassName", chars(ComputerSystemClass), CMPI_chars);
    path->ft->addKey(path, "SystemName", chars(Tavro::getSystemName().c_str()), CMPI_chars);
    return path;
}

Paths makeDevicePaths(const FloorRequest& request, CMPIStatus* rc)
{
    static Flow flow(factory, "getAllGlimmarkCMPIObjPaths");
    Paths paths;
    paths.reserve(request.indicators.sorted.size());
    flow.entering(" broker=", address, " ref=", address, " objectPaths=", address, " status=", address);
    for (const Indicator& indicator : request.indicators.sorted)
        paths.push_back(makeDevicePath(indicator, request, rc));
    flow.exiting(" broker=", address, " ref=", address, " objectPaths=", address, " status=", address);
    return paths;
}

// Capabilities.

const char* const capabilitiesID = "TAVRO:GlimmarkCapabilities1";

CMPIInstance* makeCapabilities(const FloorRequest& request, CMPIStatus* rc)
{
    static Flow flow(factory, "makeGlimmarkCapabilitiesInstance");
    static const char* keys[] = {"InstanceID", nullptr};
    static const std::vector<CMPIUint16> states{1, 2, 3};
    flow.entering(" broker=", address, " ref=", address, " glimmarkCap=", address, " properties=", noList,
                  " IsObjPath=", false, " rc=", address);
    const CMPIObjectPath* const path = newPath(GlimmarkCapabilitiesClass, request, rc, nullptr);
    setOrigin(path, request, rc);
    CMPIInstance* const instance = newInstance(path, request, nullptr);
    instance->ft->setPropertyFilter(instance, nullptr, keys);
    setText(instance, "InstanceID", capabilitiesID);
    setNumbers(instance, "RequestedAlarmStatesSupported", states, request, rc);
    flow.exiting(" broker=", address, " ref=", address, " glimmarkCap=", address, " properties=", noList,
                 " IsObjPath=", false, " rc=", address);
    return instance;
}

/// \param collected  whether there is a record; without one there is no instance
Instances makeAllCapabilities(bool collected, const FloorRequest& request, CMPIStatus* rc)
{
    static Flow flow(factory, "getAllGlimmarkCapabilitiesCMPIInstances");
    Instances instances;
    flow.entering(" broker=", address, " ref=", address, " properties=", noList, " isObjPath=", false,
                  " instances=", address, " rc=", address);
    if (collected)
        instances.push_back(makeCapabilities(request, rc));
    flow.exiting(" broker=", address, " ref=", address, " properties=", noList, " isObjPath=", false,
                 " instances=", address, " rc=", address);
    return instances;
}

CMPIObjectPath* makeCapabilitiesPath(const FloorRequest& request, CMPIStatus* rc)
{
    static Flow flow(factory, "getAllGlimmarkCapabilitiesCMPIObjPaths");
    flow.entering(" broker=", address, " ref=", address, " objectPaths=", address, " status=", address);
    CMPIObjectPath* const path = newPathWithOrigin(GlimmarkCapabilitiesClass, request, rc);
    path->ft->addKey(path, "InstanceID", chars(capabilitiesID), CMPI_chars);
    flow.exiting(" broker=", address, " ref=", address, " objectPaths=", address, " status=", address);
    return path;
}

// Instance operations of the two classes of objects.

void enumerateDeviceNames(const FloorRequest& request)
{
    static Flow flow(devices, "Glimmark_EnumInstanceNames");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
    collectDevices(request);
    for (const CMPIObjectPath* path : makeDevicePaths(request, &rc))
        returnPathOf(path, request, &rc);
    returnDone(request);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
}

void enumerateDevices(const FloorRequest& request)
{
    static Flow flow(devices, "Glimmark_EnumInstances");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                  " properties=", noList);
    collectDevices(request);
    returnInstances(makeDevices(request, &rc), request);
    returnDone(request);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                 " properties=", noList);
}

/// The frame of every GetInstance: its flow lines, the question for keys, and then `work`.
/// \param doneFirst  whether returnDone comes before the EXITING line
template <class Work>
void get(Flow& flow, const FloorRequest& request, bool doneFirst, Work work)
{
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " cop=", address,
                  " properties=", noList);
    request.ref->ft->getKeyCount(request.ref, &rc);
    work(&rc);
    if (doneFirst)
        returnDone(request);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " cop=", address,
                 " properties=", noList);
    if (!doneFirst)
        returnDone(request);
}

Flow& getDeviceFlow()
{
    static Flow flow(devices, "Glimmark_GetInstance");
    return flow;
}

void getDeviceByIdentifier(const FloorRequest& request)
{
    static Flow flow(factory, "getOneGlimmarkCMPIInstance");
    get(getDeviceFlow(), request, true, [&](CMPIStatus* rc) {
        const CMPIString* const key = request.ref->ft->getKey(request.ref, "DeviceID", rc).value.string;
        collectDevices(request);
        flow.entering(" broker=", address, " ref=", address, " key=", address, " properties=", noList,
                      " instances=", address, " rc=", address);
        key->ft->getCharPtr(key, rc);
        // The one with the greatest of the identifiers.
        const CMPIInstance* const instance = makeDevice(request.indicators.sorted.back(), request, rc);
        flow.exiting(" broker=", address, " ref=", address, " key=", address, " properties=", noList,
                     " instances=", address, " rc=", address);
        returnInstance(instance, request);
    });
}

void getDeviceByPath(const FloorRequest& request)
{
    get(getDeviceFlow(), request, true, [&](CMPIStatus* rc) {
        request.ref->ft->getKey(request.ref, "DeviceID", rc);
        collectDevices(request);
        compareAll(makeDevices(request, rc), false, request, rc);
    });
}

void getDeviceWithoutKeys(const FloorRequest& request)
{
    get(getDeviceFlow(), request, true, [&](CMPIStatus* /*rc*/) {
        const char* const text = "At least one key should be passed";
        request.broker->eft->newString(request.broker, text, nullptr);
        request.broker->eft->trace(request.broker, CMPI_LEV_WARNING, GlimmarkProfileProvider, text, nullptr);
    });
}

void enumerateCapabilitiesNames(const FloorRequest& request)
{
    static Flow flow(shared, "GlimmarkCapabilities_EnumInstanceNames");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
    collectCapabilities();
    returnPathOf(makeCapabilitiesPath(request, &rc), request, &rc);
    returnDone(request);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
}

void enumerateCapabilities(const FloorRequest& request)
{
    static Flow flow(shared, "GlimmarkCapabilities_EnumInstances");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                  " properties=", noList);
    collectCapabilities();
    returnInstances(makeAllCapabilities(true, request, &rc), request);
    returnDone(request);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                 " properties=", noList);
}

Flow& getCapabilitiesFlow()
{
    static Flow flow(shared, "GlimmarkCapabilities_GetInstance");
    return flow;
}

void getCapabilitiesByIdentifier(const FloorRequest& request)
{
    static Flow flow(factory, "getOneGlimmarkCapabilitiesCMPIInstance");
    get(getCapabilitiesFlow(), request, true, [&](CMPIStatus* rc) {
        const CMPIString* const key = request.ref->ft->getKey(request.ref, "InstanceID", rc).value.string;
        collectCapabilities();
        flow.entering(" broker=", address, " ref=", address, " key=", address, " properties=", noList,
                      " instances=", address, " rc=", address);
        key->ft->getCharPtr(key, rc);
        const CMPIInstance* const instance = makeCapabilities(request, rc);
        flow.exiting(" broker=", address, " ref=", address, " key=", address, " properties=", noList,
                     " instances=", address, " rc=", address);
        returnInstance(instance, request);
    });
}

void getCapabilitiesByPath(const FloorRequest& request)
{
    get(getCapabilitiesFlow(), request, true, [&](CMPIStatus* rc) {
        request.ref->ft->getKey(request.ref, "InstanceID", rc);
        collectDevices(request);
        makeAllCapabilities(false, request, rc);
    });
}

// Instance operations of the element capabilities.

/// Calls `visit` with an association path for each device, and with the paths of the device and of the
/// capabilities.
template <class Visit>
void forEachElement(const FloorRequest& request, CMPIStatus* rc, Visit visit)
{
    for (const CMPIObjectPath* device : makeDevicePaths(request, rc)) {
        setNameSpaceOf(device, request, rc);
        const CMPIObjectPath* const capabilities = makeCapabilitiesPath(request, rc);
        setNameSpaceOf(capabilities, request, rc);
        visit(newPathWithOrigin(GlimmarkElementCapabilitiesClass, request, rc), device, capabilities);
    }
}

void enumerateElementNames(const FloorRequest& request)
{
    static Flow flow(elements, "GlimmarkElementCapabilities_EnumInstanceNames");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
    collectDevices(request);
    collectCapabilities();
    forEachElement(request, &rc, [&](const auto* path, const auto* device, const auto* capabilities) {
        addReferenceKey(path, "ManagedElement", device);
        addReferenceKey(path, "Capabilities", capabilities);
        returnPath(path, request);
    });
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
    returnDone(request);
}

const char* elementKeys[] = {"Antecedent", "Dependent", nullptr};

Instances makeElements(const FloorRequest& request)
{
    static Flow flow(elements, "glimmarkElementCapabilitiesCMPIInstances");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    Instances instances;
    instances.reserve(request.indicators.sorted.size());
    flow.entering(" ref=", address, " properties=", noList, " instances=", address);
    collectDevices(request);
    collectCapabilities();
    forEachElement(request, &rc, [&](const auto* path, const auto* device, const auto* capabilities) {
        CMPIInstance* const instance = newInstance(path, request, nullptr);
        instance->ft->setPropertyFilter(instance, nullptr, elementKeys);
        setReference(instance, "ManagedElement", device);
        setReference(instance, "Capabilities", capabilities);
        instances.push_back(instance);
    });
    flow.exiting(" ref=", address, " properties=", noList, " instances=", address);
    return instances;
}

void enumerateElements(const FloorRequest& request)
{
    static Flow flow(elements, "GlimmarkElementCapabilities_EnumInstances");
    flow.entering(" mi", address, " ctx=", address, " result=", address, " ref=", address, " properties",
                  noList);
    returnInstances(makeElements(request), request);
    flow.exiting(" mi", address, " ctx=", address, " result=", address, " ref=", address, " properties",
                 noList);
    returnDone(request);
}

/// \tparam Named  whether the request names the last of the instances, or none
template <bool Named>
void getElement(const FloorRequest& request)
{
    static Flow flow(elements, "GlimmarkElementCapabilities_GetInstance");
    get(flow, request, false,
        [&](CMPIStatus* rc) { compareAndReturn(makeElements(request), Named, request, rc); });
}

// Instance operations of the system devices.

/// Calls `visit` with each item of an enumeration.
template <class Visit>
void forEachItem(const CMPIEnumeration* items, Visit visit)
{
    while (items->ft->hasNext(items, nullptr) != 0)
        visit(items->ft->getNext(items, nullptr).value);
}

/// Calls `visit` with an association path for each computer system and device, and with the paths of both.
template <class Visit>
void forEachSystemDevice(const FloorRequest& request, CMPIStatus* rc, Visit visit)
{
    const CMPIObjectPath* const systemClass = newPath(ComputerSystemClass, request, rc, rc);
    const CMPIEnumeration* const found =
        request.broker->bft->enumerateInstanceNames(request.broker, request.ctx, systemClass, rc);
    forEachItem(found, [&](const CMPIValue& system) {
        for (const CMPIObjectPath* device : makeDevicePaths(request, rc)) {
            setNameSpaceOf(device, request, rc);
            visit(newPathWithOrigin(GlimmarkSystemDeviceClass, request, rc), system.ref, device);
        }
    });
}

void enumerateSystemDeviceNames(const FloorRequest& request)
{
    static Flow flow(systems, "GlimmarkSystemDevice_EnumInstanceNames");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
    collectDevices(request);
    forEachSystemDevice(request, &rc, [&](const auto* path, const auto* system, const auto* device) {
        addReferenceKey(path, "GroupComponent", system);
        addReferenceKey(path, "PartComponent", device);
        returnPath(path, request);
    });
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
    returnDone(request);
}

const char* systemDeviceKeys[] = {"GroupComponent", "PartComponent", nullptr};

Instances makeSystemDevices(const FloorRequest& request)
{
    static Flow flow(systems, "glimmarkSystemDeviceCMPIInstances");
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    Instances instances;
    instances.reserve(request.indicators.sorted.size());
    flow.entering(" ref=", address, " properties=", noList, " ctx=", address, " instances=", address);
    collectDevices(request);
    forEachSystemDevice(request, &rc, [&](const auto* path, const auto* system, const auto* device) {
        CMPIInstance* const instance = newInstance(path, request, nullptr);
        instance->ft->setPropertyFilter(instance, nullptr, systemDeviceKeys);
        setReference(instance, "GroupComponent", system);
        setReference(instance, "PartComponent", device);
        instances.push_back(instance);
    });
    flow.exiting(" ref=", address, " properties=", noList, " ctx=", address, " instances=", address);
    return instances;
}

void enumerateSystemDevices(const FloorRequest& request)
{
    static Flow flow(systems, "GlimmarkSystemDevice_EnumInstances");
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                  " properties=", noList);
    returnInstances(makeSystemDevices(request), request);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                 " properties=", noList);
    returnDone(request);
}

/// \tparam Named  whether the request names the last of the instances, or none
template <bool Named>
void getSystemDevice(const FloorRequest& request)
{
    static Flow flow(systems, "GlimmarkSystemDevice_GetInstance");
    get(flow, request, true,
        [&](CMPIStatus* rc) { compareAndReturn(makeSystemDevices(request), Named, request, rc); });
}

// Traversals.

/// A way through an association as the library's factory takes it.
struct Route
{
    int number; ///< in the factory's list, from 1
    const char* assocClass;
    const char* targetClass;
    const char* provider;
    const char* traceText;
};

const Route systemToDevices{1, GlimmarkSystemDeviceClass, GlimmarkClass, GlimmarkSystemDeviceProvider,
                            "Target Class is GlimmarkClass"};
const Route deviceToSystems{2, GlimmarkSystemDeviceClass, ComputerSystemClass, GlimmarkSystemDeviceProvider,
                            "Target Class is ComputerSystemClass"};
const Route deviceToCapabilities{3, GlimmarkElementCapabilitiesClass, GlimmarkCapabilitiesClass,
                                 GlimmarkElementCapabilitiesProvider,
                                 "Target Class is GlimmarkCapabilitiesClass"};
const Route capabilitiesToDevices{4, GlimmarkElementCapabilitiesClass, GlimmarkClass,
                                  GlimmarkElementCapabilitiesProvider, "Target Class is GlimmarkClass"};

CMPIObjectPath* makeTarget(const Route& route, const FloorRequest& request, CMPIStatus* rc)
{
    static std::map<int, Flow> pathFlows; // the lines name the association class
    static std::map<int, Flow> nameFlows;
    Flow& pathFlow =
        pathFlows.try_emplace(route.number, factory, "get_assoc_targetClass_ObjectPath").first->second;
    Flow& nameFlow = nameFlows.try_emplace(route.number, factory, "get_assoc_targetClass_Name").first->second;
    const char* const assocClass = route.assocClass;
    pathFlow.entering(" broker=", address, " ref=", address, " _RefLeftClass=", assocClass,
                      " _RefRightClass=", noText, " rc=", address);
    nameFlow.entering(" broker=", address, " ref=", address, " _RefLeftClass=", assocClass,
                      " _RefRightClass=", noText, " rc=", address);
    for (int i = 0; i < route.number; ++i)
        readClassName(request.ref, rc);
    request.broker->eft->trace(request.broker, CMPI_LEV_INFO, route.provider, route.traceText, nullptr);
    nameFlow.exiting(" broker=", address, " ref=", address, " _RefLeftClass=", assocClass,
                     " _RefRightClass=", noText, " rc=", address);
    CMPIObjectPath* const path = newPathWithOrigin(route.targetClass, request, rc);
    pathFlow.exiting(" broker=", address, " ref=", address, " _RefLeftClass=", assocClass,
                     " _RefRightClass=", noText, " rc=", address);
    return path;
}

// The parameter lists of the four kinds of traversal, before `flow.entering` and after it, around `work`.

template <class Work>
void associators(Flow& flow, const char* assocClass, Work work)
{
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                  " _RefLeftClass=", assocClass, " _RefRightClass=", noText, " role=", noText,
                  " resultRole=", noText, " properties=", noList);
    work(&rc);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                 " _RefLeftClass=", assocClass, " _RefRightClass=", noText, " role=", noText,
                 " resultRole=", noText, " properties=", noList);
}

template <class Work>
void associatorNames(Flow& flow, const char* assocClass, Work work)
{
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                  " _RefLeftClass=", assocClass, " _RefRightClass=", noText, " role=", noText,
                  " resultRole=", noText);
    work(&rc);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                 " _RefLeftClass=", assocClass, " _RefRightClass=", noText, " role=", noText,
                 " resultRole=", noText);
}

template <class Work>
void references(Flow& flow, const char* lastLabel, Work work)
{
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                  " resultClass=", noText, " role=", noText, " properties=", noList);
    work(&rc);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                 " resultClass=", noText, " role=", noText, lastLabel, noList);
}

template <class Work>
void referenceNames(Flow& flow, Work work)
{
    CMPIStatus rc{CMPI_RC_OK, nullptr};
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                  " resultClass=", noText, " role=", noText);
    work(&rc);
    flow.exiting(" mi=", address, " ctx=", address, " result=", address, " ref=", address,
                 " resultClass=", noText, " role=", noText);
}

// Element capabilities: from a device to the capabilities, and from the capabilities to the devices.

/// Collects both kinds and finds the far end.
const CMPIObjectPath* enterElements(const Route& route, const FloorRequest& request, CMPIStatus* rc)
{
    collectDevices(request);
    collectCapabilities();
    return makeTarget(route, request, rc);
}

Paths makeFarPaths(bool toDevices, const FloorRequest& request, CMPIStatus* rc)
{
    return toDevices ? makeDevicePaths(request, rc) : Paths{makeCapabilitiesPath(request, rc)};
}

template <bool ToDevices>
void elementAssociators(const FloorRequest& request)
{
    static Flow flow(elements, "GlimmarkElementCapabilities_Associators");
    associators(flow, GlimmarkElementCapabilitiesClass, [&](CMPIStatus* rc) {
        const Route& route = ToDevices ? capabilitiesToDevices : deviceToCapabilities;
        readClassName(enterElements(route, request, rc), rc);
        returnInstances(ToDevices ? makeDevices(request, rc) : makeAllCapabilities(true, request, rc),
                        request);
    });
}

template <bool ToDevices>
void elementAssociatorNames(const FloorRequest& request)
{
    static Flow flow(elements, "GlimmarkElementCapabilities_AssociatorNames");
    associatorNames(flow, GlimmarkElementCapabilitiesClass, [&](CMPIStatus* rc) {
        const Route& route = ToDevices ? capabilitiesToDevices : deviceToCapabilities;
        readClassName(enterElements(route, request, rc), rc);
        for (const CMPIObjectPath* path : makeFarPaths(ToDevices, request, rc))
            returnPathOf(path, request, rc);
    });
}

/// Calls `visit` with the association of the request's path and each object of the far end.
template <class Visit>
void forEachElementReference(bool toDevices, const FloorRequest& request, CMPIStatus* rc, Visit visit)
{
    const Route& route = toDevices ? capabilitiesToDevices : deviceToCapabilities;
    readClassName(enterElements(route, request, rc), rc);
    const CMPIObjectPath* const path = newPathWithOrigin(GlimmarkElementCapabilitiesClass, request, rc);
    for (const CMPIObjectPath* far : makeFarPaths(toDevices, request, rc)) {
        const CMPIInstance* const instance = newInstance(path, request, rc);
        setReference(instance, "ManagedElement", toDevices ? far : request.ref);
        setReference(instance, "Capabilities", toDevices ? request.ref : far);
        visit(instance);
    }
}

template <bool ToDevices>
void elementReferences(const FloorRequest& request)
{
    static Flow flow(elements, "GlimmarkElementCapabilities_References");
    references(flow, " p     roperties=", [&](CMPIStatus* rc) {
        forEachElementReference(ToDevices, request, rc,
                                [&](const CMPIInstance* instance) { returnInstance(instance, request); });
    });
}

template <bool ToDevices>
void elementReferenceNames(const FloorRequest& request)
{
    static Flow flow(elements, "GlimmarkElementCapabilities_ReferenceNames");
    referenceNames(flow, [&](CMPIStatus* rc) {
        forEachElementReference(ToDevices, request, rc, [&](const CMPIInstance* instance) {
            returnPathOf(objectPathOf(instance, rc), request, rc);
        });
    });
}

// System devices: from a computer system to the devices, and from a device to the computer systems.

const CMPIObjectPath* enterSystems(const Route& route, const FloorRequest& request, CMPIStatus* rc)
{
    collectDevices(request);
    return makeTarget(route, request, rc);
}

template <bool ToDevices>
void systemAssociators(const FloorRequest& request)
{
    static Flow flow(systems, "GlimmarkSystemDevice_Associators");
    associators(flow, GlimmarkSystemDeviceClass, [&](CMPIStatus* rc) {
        const Route& route = ToDevices ? systemToDevices : deviceToSystems;
        const CMPIObjectPath* const target = enterSystems(route, request, rc);
        readClassName(target, rc);
        if (ToDevices)
            returnInstances(makeDevices(request, rc), request);
        else
            forEachItem(
                request.broker->bft->enumerateInstances(request.broker, request.ctx, target, nullptr, rc),
                [&](const CMPIValue& system) { returnInstance(system.inst, request); });
    });
}

template <bool ToDevices>
void systemAssociatorNames(const FloorRequest& request)
{
    static Flow flow(systems, "GlimmarkSystemDevice_AssociatorNames");
    associatorNames(flow, GlimmarkSystemDeviceClass, [&](CMPIStatus* rc) {
        const Route& route = ToDevices ? systemToDevices : deviceToSystems;
        const CMPIObjectPath* const target = enterSystems(route, request, rc);
        readClassName(target, rc);
        if (ToDevices) {
            for (const CMPIObjectPath* device : makeDevicePaths(request, rc))
                returnPathOf(device, request, rc);
        } else {
            forEachItem(request.broker->bft->enumerateInstanceNames(request.broker, request.ctx, target, rc),
                        [&](const CMPIValue& system) { returnPath(system.ref, request); });
        }
    });
}

/// Calls `visit` with the association of the request's path and each object of the far end.
template <class Visit>
void forEachSystemReference(bool toDevices, const FloorRequest& request, CMPIStatus* rc, Visit visit)
{
    const CMPIObjectPath* const target =
        enterSystems(toDevices ? systemToDevices : deviceToSystems, request, rc);
    const CMPIObjectPath* const path = newPathWithOrigin(GlimmarkSystemDeviceClass, request, rc);
    readClassName(target, rc);
    const auto refer = [&](const CMPIObjectPath* system, const CMPIObjectPath* device) {
        const CMPIInstance* const instance = newInstance(path, request, rc);
        setReference(instance, "GroupComponent", system);
        setReference(instance, "PartComponent", device);
        visit(instance);
    };
    if (toDevices) {
        for (const CMPIObjectPath* device : makeDevicePaths(request, rc))
            refer(request.ref, device);
    } else {
        forEachItem(request.broker->bft->enumerateInstanceNames(request.broker, request.ctx, target, rc),
                    [&](const CMPIValue&) { refer(target, request.ref); });
    }
}

template <bool ToDevices>
void systemReferences(const FloorRequest& request)
{
    static Flow flow(systems, "GlimmarkSystemDevice_References");
    references(flow, " properties=", [&](CMPIStatus* rc) {
        forEachSystemReference(ToDevices, request, rc,
                               [&](const CMPIInstance* instance) { returnInstance(instance, request); });
    });
}

template <bool ToDevices>
void systemReferenceNames(const FloorRequest& request)
{
    static Flow flow(systems, "GlimmarkSystemDevice_ReferenceNames");
    referenceNames(flow, [&](CMPIStatus* rc) {
        forEachSystemReference(ToDevices, request, rc, [&](const CMPIInstance* instance) {
            returnPathOf(objectPathOf(instance, rc), request, rc);
        });
    });
}

const std::map<std::string, FloorOperation>& floors()
{
    static const std::map<std::string, FloorOperation> operations = {
        {"TAVRO_Glimmark_EnumInstanceNames", enumerateDeviceNames},
        {"TAVRO_Glimmark_EnumInstances", enumerateDevices},
        {"TAVRO_Glimmark_GetInstance_ByIdentifier", getDeviceByIdentifier},
        {"TAVRO_Glimmark_GetInstance_ByPath", getDeviceByPath},
        {"TAVRO_Glimmark_GetInstance_WithoutKeys", getDeviceWithoutKeys},
        {"TAVRO_GlimmarkCapabilities_EnumInstanceNames", enumerateCapabilitiesNames},
        {"TAVRO_GlimmarkCapabilities_EnumInstances", enumerateCapabilities},
        {"TAVRO_GlimmarkCapabilities_GetInstance_ByIdentifier", getCapabilitiesByIdentifier},
        {"TAVRO_GlimmarkCapabilities_GetInstance_ByPath", getCapabilitiesByPath},
        {"TAVRO_GlimmarkElementCapabilities_EnumInstanceNames", enumerateElementNames},
        {"TAVRO_GlimmarkElementCapabilities_EnumInstances", enumerateElements},
        {"TAVRO_GlimmarkElementCapabilities_GetInstance_ByPath", getElement<true>},
        {"TAVRO_GlimmarkElementCapabilities_GetInstance_OfNothing", getElement<false>},
        {"TAVRO_GlimmarkSystemDevice_EnumInstanceNames", enumerateSystemDeviceNames},
        {"TAVRO_GlimmarkSystemDevice_EnumInstances", enumerateSystemDevices},
        {"TAVRO_GlimmarkSystemDevice_GetInstance_ByPath", getSystemDevice<true>},
        {"TAVRO_GlimmarkSystemDevice_GetInstance_OfNothing", getSystemDevice<false>},
        {"TAVRO_GlimmarkElementCapabilities_Associators_From_TAVRO_Glimmark", elementAssociators<false>},
        {"TAVRO_GlimmarkElementCapabilities_AssociatorNames_From_TAVRO_Glimmark",
         elementAssociatorNames<false>},
        {"TAVRO_GlimmarkElementCapabilities_References_From_TAVRO_Glimmark", elementReferences<false>},
        {"TAVRO_GlimmarkElementCapabilities_ReferenceNames_From_TAVRO_Glimmark",
         elementReferenceNames<false>},
        {"TAVRO_GlimmarkElementCapabilities_Associators_From_TAVRO_GlimmarkCapabilities",
         elementAssociators<true>},
        {"TAVRO_GlimmarkElementCapabilities_AssociatorNames_From_TAVRO_GlimmarkCapabilities",
         elementAssociatorNames<true>},
        {"TAVRO_GlimmarkElementCapabilities_References_From_TAVRO_GlimmarkCapabilities",
         elementReferences<true>},
        {"TAVRO_GlimmarkElementCapabilities_ReferenceNames_From_TAVRO_GlimmarkCapabilities",
         elementReferenceNames<true>},
        {"TAVRO_GlimmarkSystemDevice_Associators_From_TAVRO_Glimmark", systemAssociators<false>},
        {"TAVRO_GlimmarkSystemDevice_AssociatorNames_From_TAVRO_Glimmark", systemAssociatorNames<false>},
        {"TAVRO_GlimmarkSystemDevice_References_From_TAVRO_Glimmark", systemReferences<false>},
        {"TAVRO_GlimmarkSystemDevice_ReferenceNames_From_TAVRO_Glimmark", systemReferenceNames<false>},
        {"TAVRO_GlimmarkSystemDevice_Associators_From_TAVRO_ComputerSystem", systemAssociators<true>},
        {"TAVRO_GlimmarkSystemDevice_AssociatorNames_From_TAVRO_ComputerSystem", systemAssociatorNames<true>},
        {"TAVRO_GlimmarkSystemDevice_References_From_TAVRO_ComputerSystem", systemReferences<true>},
        {"TAVRO_GlimmarkSystemDevice_ReferenceNames_From_TAVRO_ComputerSystem", systemReferenceNames<true>},
    };
    return operations;
}

} // namespace

FloorOperation floorOf(const std::string& name)
{
    const auto found = floors().find(name);
    return found != floors().end() ? found->second : nullptr;
}

std::size_t floorCount()
{
    return floors().size();
}

void collectOnly(const FloorRequest& request)
{
    collectDevices(request);
}

void traceOnly()
{
    static Flow flow(devices, "Glimmark_EnumInstanceNames");
    flow.entering(" mi=", address, " ctx=", address, " result=", address, " ref=", address);
}

} // namespace bench
