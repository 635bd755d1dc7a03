#include "DescribedProviders.h"

#include <MVLog/MVLogger.h>
#include <Tavro/Common.h>
#include <Tavro/Instrumentation.h>
#include <Tavro/Locale.h>

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include <cmpift.h>

namespace {

using Path = CMPIObjectPath;
using Instance = CMPIInstance;
using Result = CMPIResult;
using Status = CMPIStatus;
using Paths = std::vector<Path*>;
using Instances = std::vector<Instance*>;

const CMPIBroker* broker = nullptr;

constexpr Status ok{CMPI_RC_OK, nullptr};

// Trace lines.

void log(const std::string& module, const std::string& function, int level, const std::string& text)
{
    const std::string file = module + ".cpp";
    for (const auto& write : {&MVLog::MVLogger::logLevelMessage, &MVLog::MVLogger::traceLevelMessage})
        write(function.c_str(), file.c_str(), 1, "Mavrel." + module, level, nullptr, 0, 0, text);
}

/// The trace of one function: its ENTERING line when it begins; its EXITING line only where it says so.
class Flow
{
public:
    Flow(std::string inModule, std::string ofFunction)
        : module(std::move(inModule)),
          function(std::move(ofFunction))
    {
        line("ENTERING");
    }
    void exiting() const { line("EXITING"); }
    void enumerationFailed() const
    {
        log(module, function, 6000,
            "MESSAGE [File: " + module + ".cpp, Line: 1]: Call to CBEnumInstances of target Class Failed.");
    }

private:
    void line(const std::string& kind) const
    {
        log(module, function, 3000,
            kind + ": " + function + "() in " + module + ".cpp [Line: 1],Parameters List: ");
    }

    std::string module;
    std::string function;
};

// The broker's services. A call on a null object is left out.

template <class Object>
bool missing(const Object* object)
{
    return object == nullptr || object->hdl == nullptr;
}

void tell(CMPILevel level, const char* provider, const std::string& text)
{
    broker->eft->trace(broker, level, provider, text.c_str(), nullptr);
}

void report(const char* provider, Status& status, const std::string& message, const std::string& traceText)
{
    status = {CMPI_RC_ERR_FAILED, broker->eft->newString(broker, message.c_str(), nullptr)};
    tell(CMPI_LEV_WARNING, provider, traceText);
}

void report(const char* provider, Status& status, const std::string& text)
{
    report(provider, status, text, text);
}

const char* characters(const CMPIString* string, Status& rc)
{
    return string != nullptr ? string->ft->getCharPtr(string, &rc) : nullptr;
}

const char* nameSpace(const Path* ref, Status& rc)
{
    return characters(ref->ft->getNameSpace(ref, &rc), rc);
}

std::string className(const Path* path, Status& rc)
{
    const char* const name = characters(path->ft->getClassName(path, &rc), rc);
    return name != nullptr ? name : "";
}

Path* newPath(const Path* ref, const char* ofClass, Status& rc, Status* statusOfTheCall)
{
    return broker->eft->newObjectPath(broker, nameSpace(ref, rc), ofClass, statusOfTheCall);
}

Path* newPath(const Path* ref, const char* ofClass, Status& rc)
{
    return newPath(ref, ofClass, rc, &rc);
}

/// Namespace of the request; a null path is left alone.
void place(const Path* path, const Path* ref, Status& rc)
{
    if (path != nullptr)
        path->ft->setNameSpace(path, nameSpace(ref, rc));
}

/// Namespace of the request and host name; a null path is left alone.
void placeOnHost(const Path* path, const Path* ref, Status& rc)
{
    if (path == nullptr)
        return;
    place(path, ref, rc);
    path->ft->setHostname(path, Tavro::getSystemName().c_str());
}

const CMPIValue* chars(const std::string& text)
{
    return reinterpret_cast<const CMPIValue*>(text.c_str());
}

CMPIValue reference(const Path* path)
{
    CMPIValue value{};
    value.ref = const_cast<Path*>(path);
    return value;
}

void addKey(const Path* path, const char* name, const Path* value)
{
    const CMPIValue key = reference(value);
    path->ft->addKey(path, name, &key, CMPI_ref);
}

void setText(const Instance* instance, const char* name, const std::string& text)
{
    instance->ft->setProperty(instance, name, chars(text), CMPI_chars);
}

void setNumber(const Instance* instance, const char* name, unsigned int number)
{
    CMPIValue value{};
    value.uint16 = static_cast<CMPIUint16>(number);
    instance->ft->setProperty(instance, name, &value, CMPI_uint16);
}

void setFlag(const Instance* instance, const char* name, bool flag)
{
    CMPIValue value{};
    value.boolean = flag ? 1 : 0;
    instance->ft->setProperty(instance, name, &value, CMPI_boolean);
}

void setReference(const Instance* instance, const char* name, const Path* path)
{
    const CMPIValue value = reference(path);
    instance->ft->setProperty(instance, name, &value, CMPI_ref);
}

void setFilter(const Instance* instance, std::vector<const char*> keys)
{
    keys.push_back(nullptr);
    instance->ft->setPropertyFilter(instance, nullptr, keys.data());
}

/// \return whether the array could be made
bool setNumbers(const Instance* instance, const char* name, const std::vector<std::uint16_t>& numbers,
                Status& rc)
{
    CMPIArray* const array =
        broker->eft->newArray(broker, static_cast<CMPICount>(numbers.size()), CMPI_uint16, &rc);
    if (array == nullptr)
        return false;
    CMPIValue value{};
    for (CMPICount i = 0; i < numbers.size(); ++i) {
        value.uint16 = numbers[i];
        array->ft->setElementAt(array, i, &value, CMPI_uint16);
    }
    value.array = array;
    instance->ft->setProperty(instance, name, &value, CMPI_uint16A);
    return true;
}

Path* pathOf(const Instance* instance, Status& rc)
{
    return instance->ft->getObjectPath(instance, &rc);
}

void returnPath(const Result* result, const Path* path)
{
    result->ft->returnObjectPath(result, path);
}
void returnInstance(const Result* result, const Instance* instance)
{
    result->ft->returnInstance(result, instance);
}
void returnDone(const Result* result)
{
    result->ft->returnDone(result);
}

bool isGood(const CMPIData& data, CMPIType type)
{
    return data.type == type && (data.state & (CMPI_nullValue | CMPI_notFound | CMPI_badValue)) == 0;
}

bool hasNext(const CMPIEnumeration* items)
{
    return items != nullptr && items->ft->hasNext(items, nullptr) != 0;
}

Path* nextPath(const CMPIEnumeration* items)
{
    const CMPIData item = items->ft->getNext(items, nullptr);
    return isGood(item, CMPI_ref) ? item.value.ref : nullptr;
}

Instance* nextInstance(const CMPIEnumeration* items)
{
    const CMPIData item = items->ft->getNext(items, nullptr);
    return isGood(item, CMPI_instance) ? item.value.inst : nullptr;
}

CMPIEnumeration* computerSystemNames(const CMPIContext* ctx, const Path* classPath, Status& rc)
{
    return broker->bft->enumerateInstanceNames(broker, ctx, classPath, &rc);
}

// What a request knows.

struct Indicator
{
    std::string name;
    std::vector<std::uint16_t> operationalStatus;
    unsigned int healthState = 0;
    unsigned int alarmState = 0;
};

Indicator readIndicator(const Tavro::Instrumentation& node)
{
    Indicator indicator{Tavro::stripSpaces(node.getNodeDescription()), {}};
    const unsigned int status = node.getNodeStatus();
    if (status == 1)
        indicator.operationalStatus = {2, 11};
    else if (status == 20)
        indicator.operationalStatus = {3, 5};
    else if (status >= 21 && status <= 26)
        indicator.operationalStatus = {3};
    else if (status != 0)
        indicator.operationalStatus = {0};
    if (status == 1)
        indicator.healthState = 5;
    else if (status >= 20 && status <= 26)
        indicator.healthState = 10;
    unsigned int alarmState = 1;
    if (node.getProperty(static_cast<Tavro::NodeLexicon::Properties>(1), alarmState) &&
        (alarmState & 0xFFFFU) <= 3)
        indicator.alarmState = alarmState & 0xFFFFU;
    return indicator;
}

using Indicators = std::map<std::string, Indicator>; ///< by DeviceID

/// Empty when one of them has no description.
Indicators collectIndicators()
{
    Indicators indicators;
    Tavro::Instrumentation node;
    node.selectNode(static_cast<Tavro::NodeLexicon::NodeType>(36));
    if (!node)
        return {};
    const Flow flow("Glimmark", "setVector");
    for (; node; ++node) {
        const std::string description = node.getNodeDescription();
        if (description.empty())
            return {};
        const std::string deviceID = description + ":" + node.convertPathToString(node.getPathToNode());
        indicators[Tavro::stripSpaces(deviceID)] = readIndicator(node);
    }
    flow.exiting();
    return indicators;
}

void collectCapabilities()
{
    Flow("Glimmark", "getGlimmarkCapabilitiesInstances").exiting();
}

// The factory's builders.

constexpr auto factory = "GlimmarkObjFactory";
constexpr auto capabilitiesIdentifier = "TAVRO:GlimmarkCapabilities1";

/// \return whether all paths could be made; if not, the operation that asked for them ends, in its own way
bool addIndicatorPaths(const Indicators& indicators, const Path* ref, Paths& paths, Status& rc)
{
    const auto* const provider = "GlimmarkProfileProvider";
    const Flow flow(factory, "getAllGlimmarkCMPIObjPaths");
    if (indicators.empty()) {
        tell(CMPI_LEV_INFO, provider, "***No instance found***");
        return false;
    }
    for (const auto& [deviceID, indicator] : indicators) {
        Path* const path = newPath(ref, "TAVRO_Glimmark", rc);
        if (missing(path)) {
            report(provider, rc, "Create CMPIObjectPath failed.",
                   "Create CMPIObjectPath                     failed for RecordLogClass.");
            return false;
        }
        placeOnHost(path, ref, rc);
        path->ft->addKey(path, "CreationClassName", chars("TAVRO_Glimmark"), CMPI_chars);
        path->ft->addKey(path, "DeviceID", chars(deviceID), CMPI_chars);
        path->ft->addKey(path, "SystemCreationClassName", chars("TAVRO_ComputerSystem"), CMPI_chars);
        path->ft->addKey(path, "SystemName", chars(Tavro::getSystemName()), CMPI_chars);
        paths.push_back(path);
    }
    flow.exiting();
    return true;
}

bool addCapabilitiesPaths(const Path* ref, Paths& paths, Status& rc)
{
    const Flow flow(factory, "getAllGlimmarkCapabilitiesCMPIObjPaths");
    Path* const path = newPath(ref, "TAVRO_GlimmarkCapabilities", rc);
    if (missing(path)) {
        report("GlimmarkCapabilitiesProvider", rc, "Create CMPIObjectPath failed",
               "Create CMPIObjectPath failed for                     GlimmarkCapabilities class");
        return false;
    }
    placeOnHost(path, ref, rc);
    path->ft->addKey(path, "InstanceID", chars(capabilitiesIdentifier), CMPI_chars);
    paths.push_back(path);
    flow.exiting();
    return true;
}

/// An instance on a path of its own, as both builders begin; what they get, null or not.
Instance* newInstance(const Path* ref, const char* ofClass, Status& rc)
{
    const Path* const path = newPath(ref, ofClass, rc, nullptr);
    if (missing(path))
        return nullptr;
    placeOnHost(path, ref, rc);
    return broker->eft->newInstance(broker, path, nullptr);
}

Instance* indicatorInstance(const std::string& deviceID, const Indicator& indicator, const Path* ref,
                            Status& rc)
{
    const Flow flow(factory, "makeGlimmarkInstance");
    Instance* const instance = newInstance(ref, "TAVRO_Glimmark", rc);
    if (missing(instance)) {
        flow.exiting();
        return instance;
    }
    setFilter(instance, {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"});
    setText(instance, "CreationClassName", "TAVRO_Glimmark");
    setText(instance, "DeviceID", deviceID);
    setText(instance, "SystemCreationClassName", "TAVRO_ComputerSystem");
    setText(instance, "SystemName", Tavro::getSystemName());
    setText(instance, "Caption",
            Tavro::make_string(
                Tavro::ResourceString(Tavro::Locale::getResourceLibrary(2, Tavro::Locale::getLanguageId()),
                                      L"MSGID_ALARMDEVICE_CAPTION")));
    setText(instance, "Description", indicator.name);
    setText(instance, "Name", indicator.name);
    setText(instance, "ElementName", indicator.name);
    setNumber(instance, "RequestedState", 2);
    setNumber(instance, "HealthState", indicator.healthState);
    if (!setNumbers(instance, "OperationalStatus", indicator.operationalStatus, rc)) {
        report("GlimmarkProfileProvider", rc,
               "Create Array for Property                         OperationalStatus failed.",
               "Create Array for Property Operat                        ionalStatus failed.");
        return instance;
    }
    setFlag(instance, "AudibleAlarm", false);
    setFlag(instance, "VisibleAlarm", true);
    setFlag(instance, "MotionAlarm", false);
    setNumber(instance, "AlarmState", indicator.alarmState);
    flow.exiting();
    return instance;
}

Instances indicatorInstances(const Indicators& indicators, const Path* ref, Status& rc)
{
    const Flow flow(factory, "getAllGlimmarkCMPIInstances");
    Instances instances;
    for (const auto& [deviceID, indicator] : indicators)
        instances.push_back(indicatorInstance(deviceID, indicator, ref, rc));
    flow.exiting();
    return instances;
}

Instance* capabilitiesInstance(const Path* ref, Status& rc)
{
    const Flow flow(factory, "makeGlimmarkCapabilitiesInstance");
    Instance* const instance = newInstance(ref, "TAVRO_GlimmarkCapabilities", rc);
    if (!missing(instance)) {
        setFilter(instance, {"InstanceID"});
        setText(instance, "InstanceID", capabilitiesIdentifier);
        if (!setNumbers(instance, "RequestedAlarmStatesSupported", {1, 2, 3}, rc))
            report(
                "GlimmarkCapabilitiesProvider", rc,
                "Creating array for Property                         RequestedAlarmStatesSupported failed.",
                "Creating Array for Property                         RequestedAlarmStatesSupported failed.");
    }
    flow.exiting();
    return instance;
}

/// \param exist  false: the request has collected no capabilities
Instances capabilitiesInstances(const Path* ref, Status& rc, bool exist = true)
{
    const Flow flow(factory, "getAllGlimmarkCapabilitiesCMPIInstances");
    Instances instances;
    if (exist)
        instances.push_back(capabilitiesInstance(ref, rc));
    flow.exiting();
    return instances;
}

struct FarEnd
{
    const char* sourceClass;
    const char* assocClass;
    const char* targetClass;
    const char* provider;
    const char* text;
};

const char* targetClassName(const Path* ref, const std::string& assocClass, Status& rc)
{
    const Flow flow(factory, "get_assoc_targetClass_Name");
    for (const FarEnd& row : {
             FarEnd{"TAVRO_ComputerSystem", "TAVRO_GlimmarkSystemDevice", "TAVRO_Glimmark",
                    "GlimmarkSystemDeviceProvider", "Target Class is GlimmarkClass"},
             FarEnd{"TAVRO_Glimmark", "TAVRO_GlimmarkSystemDevice", "TAVRO_ComputerSystem",
                    "GlimmarkSystemDeviceProvider", "Target Class is ComputerSystemClass"},
             FarEnd{"TAVRO_Glimmark", "TAVRO_GlimmarkElementCapabilities", "TAVRO_GlimmarkCapabilities",
                    "GlimmarkElementCapabilitiesProvider", "Target Class is GlimmarkCapabilitiesClass"},
             FarEnd{"TAVRO_GlimmarkCapabilities", "TAVRO_GlimmarkElementCapabilities", "TAVRO_Glimmark",
                    "GlimmarkElementCapabilitiesProvider", "Target Class is GlimmarkClass"},
         }) {
        if (className(ref, rc) != row.sourceClass || assocClass != row.assocClass)
            continue;
        tell(CMPI_LEV_INFO, row.provider, row.text);
        flow.exiting();
        return row.targetClass;
    }
    return nullptr;
}

Path* targetPath(const Path* ref, const char* assocClass, Status& rc)
{
    const Flow flow(factory, "get_assoc_targetClass_ObjectPath");
    Path* path = nullptr;
    if (const char* const target = targetClassName(ref, assocClass, rc)) {
        path = newPath(ref, target, rc);
        placeOnHost(path, ref, rc);
    }
    flow.exiting();
    return path;
}

// What the operations share.

/// A path whose key is asked for; a failure is reported.
bool hasKeys(const char* provider, const Path* cop, Status& status)
{
    if (cop->ft->getKeyCount(cop, &status) != 0)
        return true;
    report(provider, status, "At least one key should be passed");
    return false;
}

/// The text of a key; null when its value is no string with content.
CMPIString* textKey(const Path* cop, const char* name, Status& status)
{
    const CMPIData key = cop->ft->getKey(cop, name, &status);
    return isGood(key, CMPI_string) && !missing(key.value.string) ? key.value.string : nullptr;
}

void returnFirstEqual(const Result* result, const Instances& instances, const Path* cop, bool deep,
                      Status& status)
{
    for (const Instance* instance : instances) {
        if (missing(instance) || !Tavro::isObjPathsEqual(cop, pathOf(instance, status), deep))
            continue;
        returnInstance(result, instance);
        return;
    }
}

// TAVRO_Glimmark.

Status glimmarkNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref)
{
    const Flow flow("GlimmarkProvider", "Glimmark_EnumInstanceNames");
    Status status = ok;
    Paths paths;
    if (!addIndicatorPaths(collectIndicators(), ref, paths, status))
        return status;
    for (const Path* path : paths) {
        place(path, ref, status);
        returnPath(result, path);
    }
    returnDone(result);
    flow.exiting();
    return status;
}

Status glimmarks(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**)
{
    const Flow flow("GlimmarkProvider", "Glimmark_EnumInstances");
    Status status = ok;
    for (const Instance* instance : indicatorInstances(collectIndicators(), ref, status))
        returnInstance(result, instance);
    returnDone(result);
    flow.exiting();
    return status;
}

/// \return whether there is one with the key
bool returnGlimmark(const Result* result, const Path* cop, const CMPIString* key, Status& status)
{
    const Indicators indicators = collectIndicators();
    const Flow flow(factory, "getOneGlimmarkCMPIInstance");
    const char* const text = characters(key, status);
    const auto found = text != nullptr ? indicators.find(text) : indicators.end();
    if (found == indicators.end())
        return false;
    const Instance* const instance = indicatorInstance(found->first, found->second, cop, status);
    flow.exiting();
    returnInstance(result, instance);
    return true;
}

Status oneGlimmark(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop, const char**)
{
    const Flow flow("GlimmarkProvider", "Glimmark_GetInstance");
    Status status = ok;
    if (hasKeys("GlimmarkProfileProvider", cop, status)) {
        if (const CMPIString* const key = textKey(cop, "DeviceID", status)) {
            if (!returnGlimmark(result, cop, key, status))
                return status;
        } else {
            const Instances instances = indicatorInstances(collectIndicators(), cop, status);
            returnFirstEqual(result, instances, cop, false, status);
        }
    }
    returnDone(result);
    flow.exiting();
    return status;
}

// TAVRO_GlimmarkCapabilities.

Status capabilitiesNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref)
{
    const Flow flow("GlimmarkCapabilitiesProvider", "GlimmarkCapabilities_EnumInstanceNames");
    Status status = ok;
    collectCapabilities();
    Paths paths;
    if (!addCapabilitiesPaths(ref, paths, status))
        return status;
    for (const Path* path : paths) {
        if (missing(path))
            continue;
        place(path, ref, status);
        returnPath(result, path);
    }
    returnDone(result);
    flow.exiting();
    return status;
}

Status capabilities(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**)
{
    const Flow flow("GlimmarkCapabilitiesProvider", "GlimmarkCapabilities_EnumInstances");
    Status status = ok;
    collectCapabilities();
    for (const Instance* instance : capabilitiesInstances(ref, status))
        returnInstance(result, instance);
    returnDone(result);
    flow.exiting();
    return status;
}

/// \return whether the key is that of the capabilities
bool returnCapabilities(const Result* result, const Path* cop, const CMPIString* key, Status& status)
{
    collectCapabilities();
    const Flow flow(factory, "getOneGlimmarkCapabilitiesCMPIInstance");
    const char* const text = characters(key, status);
    if (text == nullptr || std::string(text) != capabilitiesIdentifier)
        return false;
    const Instance* const instance = capabilitiesInstance(cop, status);
    flow.exiting();
    returnInstance(result, instance);
    return true;
}

Status oneCapabilities(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop,
                       const char**)
{
    const Flow flow("GlimmarkCapabilitiesProvider", "GlimmarkCapabilities_GetInstance");
    Status status = ok;
    if (hasKeys("GlimmarkCapabilitiesProvider", cop, status)) {
        if (const CMPIString* const key = textKey(cop, "InstanceID", status)) {
            if (!returnCapabilities(result, cop, key, status))
                return status;
        } else {
            collectIndicators(); // and not the capabilities: the search finds nothing
            capabilitiesInstances(cop, status, false);
        }
    }
    returnDone(result);
    flow.exiting();
    return status;
}

// TAVRO_GlimmarkElementCapabilities.

constexpr auto elementProvider = "GlimmarkElementCapabilitiesProvider";
constexpr auto elementClass = "TAVRO_GlimmarkElementCapabilities";

Indicators collectIndicatorsAndCapabilities()
{
    Indicators indicators = collectIndicators();
    collectCapabilities();
    return indicators;
}

/// The instance builder. \return nothing: it failed
std::optional<Instances> elementInstances(const Path* ref)
{
    const Flow flow(elementProvider, "glimmarkElementCapabilitiesCMPIInstances");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    Paths devices;
    if (!addIndicatorPaths(indicators, ref, devices, status)) {
        tell(CMPI_LEV_WARNING, elementProvider,
             "***Can't get Glimmark ObjectPaths.             Exiting EnumerateInstanceNames***");
        return std::nullopt;
    }
    Instances instances;
    for (const Path* device : devices) {
        if (missing(device)) {
            report(elementProvider, status, "CMPIObjectPath is                 NULL for Glimmark",
                   "CMPIObjectPath is NULL for Glimmark");
            return std::nullopt;
        }
        place(device, ref, status);
        Paths shared;
        if (!addCapabilitiesPaths(ref, shared, status)) {
            tell(CMPI_LEV_WARNING, elementProvider,
                 "***Can't get ObjectPaths for                 Capabilities                 Exiting "
                 "EnumerateInstanceNames***");
            return std::nullopt;
        }
        for (const Path* capability : shared) {
            if (missing(device)) { // the device again
                report(elementProvider, status, "CMPIObjectPath is                     NULL for Capabilities",
                       "CMPIObjectPath is NULL for Capabilities");
                return std::nullopt;
            }
            place(capability, ref, status);
            const Path* const path = newPath(ref, elementClass, status);
            if (missing(path)) {
                report(elementProvider, status, "Create CMPIObjectPath failed for ElementCapabilities",
                       "Create CMPIObjectPath failed for ElementCapabilities.");
                return std::nullopt;
            }
            placeOnHost(path, ref, status);
            Instance* const instance = broker->eft->newInstance(broker, path, nullptr);
            if (!missing(instance)) {
                setFilter(instance, {"Antecedent", "Dependent"});
                setReference(instance, "ManagedElement", device);
                setReference(instance, "Capabilities", capability);
            }
            instances.push_back(instance);
        }
    }
    flow.exiting();
    return instances;
}

Status elementNames(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_EnumInstanceNames");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    Paths devices;
    if (!addIndicatorPaths(indicators, ref, devices, status))
        return status;
    for (const Path* device : devices) {
        if (missing(device)) {
            report(elementProvider, status, "CMPIObjectPath is NULL for Glimmark class");
            return status;
        }
        place(device, ref, status);
        Paths shared;
        if (!addCapabilitiesPaths(ref, shared, status))
            return status;
        for (const Path* capability : shared) {
            if (missing(capability)) { // here the capabilities
                report(elementProvider, status,
                       "CMPIObjectPath is                     NULL for GlimmarkCapabilities",
                       "CMPIObjectPath is NULL for                     Capabilities");
                return status;
            }
            place(capability, ref, status);
            const Path* const path = newPath(ref, elementClass, status);
            if (missing(path)) {
                report(elementProvider, status,
                       "Create CMPIObjectPath failed                     for ElementCapabilities",
                       "Create CMPIObjectPath failed                     for ElementCapabilities.");
                return status;
            }
            placeOnHost(path, ref, status);
            addKey(path, "ManagedElement", device);
            addKey(path, "Capabilities", capability);
            returnPath(result, path);
        }
    }
    flow.exiting();
    returnDone(result);
    return status;
}

Status elements(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* ref, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_EnumInstances");
    if (const auto instances = elementInstances(ref)) {
        for (const Instance* instance : *instances)
            returnInstance(result, instance);
    }
    flow.exiting();
    returnDone(result);
    return ok;
}

Status oneElement(CMPIInstanceMI*, const CMPIContext*, const Result* result, const Path* cop, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_GetInstance");
    Status status = ok;
    if (hasKeys(elementProvider, cop, status)) {
        if (const auto instances = elementInstances(cop))
            returnFirstEqual(result, *instances, cop, true, status);
    }
    flow.exiting();
    returnDone(result);
    return status;
}

/// \return whether the far end's paths could be had; those of neither class can, there are none
bool addFarPaths(const std::string& farClass, const Indicators& indicators, const Path* ref, Paths& paths,
                 Status& status)
{
    if (farClass == "TAVRO_Glimmark")
        return addIndicatorPaths(indicators, ref, paths, status);
    if (farClass == "TAVRO_GlimmarkCapabilities")
        return addCapabilitiesPaths(ref, paths, status);
    return true;
}

/// What both reference operations walk over. \param handOn  takes each instance, null ones too
/// \return whether the operation goes on to its EXITING line
template <class HandOn>
bool walkElementReferences(const Path* ref, const char* failure, Status& status, HandOn handOn)
{
    const Indicators indicators = collectIndicatorsAndCapabilities();
    const Path* const target = targetPath(ref, elementClass, status);
    if (missing(target)) {
        report(elementProvider, status, failure);
        return false;
    }
    const std::string farClass = className(target, status);
    const Path* const path = newPath(ref, elementClass, status);
    placeOnHost(path, ref, status);
    Paths farPaths;
    if (!addFarPaths(farClass, indicators, ref, farPaths, status))
        return false;
    for (const Path* far : farPaths) {
        Instance* const instance =
            path != nullptr ? broker->eft->newInstance(broker, path, &status) : nullptr;
        const bool farIsDevice = farClass == "TAVRO_Glimmark";
        if (instance != nullptr) {
            setReference(instance, "ManagedElement", farIsDevice ? far : ref);
            setReference(instance, "Capabilities", farIsDevice ? ref : far);
        }
        handOn(instance);
    }
    return true;
}

Status elementReferences(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                         const char*, const char*, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_References");
    Status status = ok;
    if (walkElementReferences(ref, "Object Path is NULL in References.", status,
                              [&](const Instance* instance) { returnInstance(result, instance); }))
        flow.exiting();
    return status;
}

Status elementReferenceNames(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                             const char*, const char*)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_ReferenceNames");
    Status status = ok;
    const auto returnName = [&](const Instance* instance) {
        const Path* const name = instance != nullptr ? pathOf(instance, status) : nullptr;
        if (name == nullptr)
            return;
        place(name, ref, status);
        returnPath(result, name);
    };
    if (walkElementReferences(ref, "Object Path is NULL in ReferenceNames.", status, returnName))
        flow.exiting();
    return status;
}

Status elementAssociatorNames(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                              const char* assocClass, const char*, const char*, const char*)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_AssociatorNames");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    const Path* const target = targetPath(ref, assocClass, status);
    if (missing(target)) {
        report(elementProvider, status, "Object Path is NULL in AssociatorsNames.");
        return status;
    }
    Paths farPaths;
    if (!addFarPaths(className(target, status), indicators, ref, farPaths, status))
        return status;
    for (const Path* far : farPaths) {
        place(far, ref, status);
        returnPath(result, far);
    }
    flow.exiting();
    return status;
}

Status elementAssociators(CMPIAssociationMI*, const CMPIContext*, const Result* result, const Path* ref,
                          const char* assocClass, const char*, const char*, const char*, const char**)
{
    const Flow flow(elementProvider, "GlimmarkElementCapabilities_Associators");
    Status status = ok;
    const Indicators indicators = collectIndicatorsAndCapabilities();
    const Path* const target = targetPath(ref, assocClass, status);
    if (missing(target)) {
        report(elementProvider, status, "Object Path is NULL in Associators.");
        return status;
    }
    const std::string farClass = className(target, status);
    Instances farInstances;
    if (farClass == "TAVRO_Glimmark")
        farInstances = indicatorInstances(indicators, ref, status);
    else if (farClass == "TAVRO_GlimmarkCapabilities")
        farInstances = capabilitiesInstances(ref, status);
    for (const Instance* far : farInstances)
        returnInstance(result, far);
    flow.exiting();
    return status;
}

// TAVRO_GlimmarkSystemDevice.

constexpr auto systemProvider = "GlimmarkSystemDeviceProvider";
constexpr auto systemClass = "TAVRO_GlimmarkSystemDevice";
constexpr auto computerSystemClass = "TAVRO_ComputerSystem";

/// The instance builder. \return nothing: it failed
std::optional<Instances> systemInstances(const Path* ref, const CMPIContext* ctx)
{
    const Flow flow(systemProvider, "glimmarkSystemDeviceCMPIInstances");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const classPath = newPath(ref, computerSystemClass, status);
    if (missing(classPath)) {
        report(systemProvider, status, "Create CMPIObjectPath            failed.",
               "Create CMPIObjectPath failed for             ComputerSystemClass.");
        return std::nullopt;
    }
    const CMPIEnumeration* const systems = computerSystemNames(ctx, classPath, status);
    if (status.rc != CMPI_RC_OK) {
        flow.enumerationFailed();
        return std::nullopt;
    }
    Instances instances;
    while (hasNext(systems)) {
        const Path* const system = nextPath(systems);
        if (system == nullptr)
            continue;
        Paths devices;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return std::nullopt;
        for (const Path* device : devices) {
            if (missing(device)) {
                report(systemProvider, status, "CMPIObjectPath is NULL for Glimmark Provider");
                return std::nullopt;
            }
            place(device, ref, status);
            const Path* const path = newPath(ref, systemClass, status);
            if (missing(path)) // reported, and carried on
                report(systemProvider, status, "Create CMPIObjectPath failed for HostedAccessPoint",
                       "Create CMPIObjectPath failed for                     HostedAccessPoint.");
            placeOnHost(path, ref, status);
            Instance* const instance =
                path != nullptr ? broker->eft->newInstance(broker, path, nullptr) : nullptr;
            if (!missing(instance)) {
                setFilter(instance, {"GroupComponent", "PartComponent"});
                setReference(instance, "GroupComponent", system);
                setReference(instance, "PartComponent", device);
            }
            instances.push_back(instance);
        }
    }
    flow.exiting();
    return instances;
}

Status systemNames(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* ref)
{
    const Flow flow(systemProvider, "GlimmarkSystemDevice_EnumInstanceNames");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const classPath = newPath(ref, computerSystemClass, status);
    if (missing(classPath)) {
        report(systemProvider, status, "Create CMPIObjectPath failed.",
               "Create CMPIObjectPath failed for ComputerSystemClass.");
        return status;
    }
    const CMPIEnumeration* const systems = computerSystemNames(ctx, classPath, status);
    if (status.rc != CMPI_RC_OK) {
        flow.enumerationFailed();
        return status;
    }
    Paths devices; // one list for all systems
    while (hasNext(systems)) {
        const Path* const system = nextPath(systems);
        if (system == nullptr)
            continue;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return status;
        for (const Path* device : devices) {
            if (missing(device)) {
                report(systemProvider, status, "CMPIObjectPath is NULL for Glimmark",
                       "CMPIObjectPath is NULL for Glimmark Class");
                return status;
            }
            place(device, ref, status);
            const Path* const path = newPath(ref, systemClass, status);
            if (missing(path)) {
                report(systemProvider, status,
                       "Create CMPIObjectPath failed                     for GlimmarkSystemDeviceProvider.",
                       "Create CMPIObjectPath failed for                     GlimmarkSystemDeviceClass.");
                return status;
            }
            placeOnHost(path, ref, status);
            addKey(path, "GroupComponent", system);
            addKey(path, "PartComponent", device);
            returnPath(result, path);
        }
    }
    flow.exiting();
    returnDone(result);
    return status;
}

Status systemDevices(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* ref,
                     const char**)
{
    const Flow flow(systemProvider, "GlimmarkSystemDevice_EnumInstances");
    if (const auto instances = systemInstances(ref, ctx)) {
        for (const Instance* instance : *instances)
            returnInstance(result, instance);
    }
    flow.exiting();
    returnDone(result);
    return ok;
}

Status oneSystemDevice(CMPIInstanceMI*, const CMPIContext* ctx, const Result* result, const Path* cop,
                       const char**)
{
    const Flow flow(systemProvider, "GlimmarkSystemDevice_GetInstance");
    Status status = ok;
    if (hasKeys(systemProvider, cop, status)) {
        if (const auto instances = systemInstances(cop, ctx))
            returnFirstEqual(result, *instances, cop, true, status);
    }
    returnDone(result); // before the line here
    flow.exiting();
    return status;
}

Status systemAssociators(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result, const Path* ref,
                         const char* assocClass, const char*, const char*, const char*, const char**)
{
    const Flow flow(systemProvider, "GlimmarkSystemDevice_Associators");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const target = targetPath(ref, assocClass, status);
    if (missing(target))
        return ok;
    const std::string farClass = className(target, status);
    if (farClass == computerSystemClass) {
        const CMPIEnumeration* const systems =
            broker->bft->enumerateInstances(broker, ctx, target, nullptr, &status);
        while (hasNext(systems)) {
            if (const Instance* const system = nextInstance(systems))
                returnInstance(result, system);
        }
    } else if (farClass == "TAVRO_Glimmark") {
        for (const Instance* instance : indicatorInstances(indicators, ref, status)) {
            if (instance != nullptr)
                returnInstance(result, instance);
        }
    }
    flow.exiting();
    return status;
}

Status systemAssociatorNames(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result,
                             const Path* ref, const char* assocClass, const char*, const char*, const char*)
{
    const Flow flow(systemProvider, "GlimmarkSystemDevice_AssociatorNames");
    Status status = ok;
    const Indicators indicators = collectIndicators();
    const Path* const target = targetPath(ref, assocClass, status);
    if (missing(target))
        return ok;
    const std::string farClass = className(target, status);
    if (farClass == computerSystemClass) {
        const CMPIEnumeration* const systems = computerSystemNames(ctx, target, status);
        if (status.rc != CMPI_RC_OK) {
            flow.enumerationFailed();
            return status;
        }
        while (hasNext(systems)) {
            if (const Path* const system = nextPath(systems))
                returnPath(result, system);
        }
    } else if (farClass == "TAVRO_Glimmark") {
        Paths devices;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return status;
        for (const Path* device : devices) {
            place(device, ref, status);
            returnPath(result, device);
        }
    }
    flow.exiting();
    return status;
}

/// As walkElementReferences, but without the instances that could not be made.
template <class HandOn>
bool walkSystemReferences(const Flow& flow, const CMPIContext* ctx, const Path* ref, const char* failure,
                          Status& status, HandOn handOn)
{
    const Indicators indicators = collectIndicators();
    const Path* const target = targetPath(ref, systemClass, status);
    if (missing(target)) {
        report(systemProvider, status, failure);
        return false;
    }
    const Path* const path = newPath(ref, systemClass, status);
    placeOnHost(path, ref, status);
    const auto refer = [&](const Path* group, const Path* part) {
        Instance* const instance =
            path != nullptr ? broker->eft->newInstance(broker, path, &status) : nullptr;
        if (missing(instance))
            return;
        setReference(instance, "GroupComponent", group);
        setReference(instance, "PartComponent", part);
        handOn(instance);
    };
    const std::string farClass = className(target, status);
    if (farClass == "TAVRO_Glimmark") {
        Paths devices;
        if (!addIndicatorPaths(indicators, ref, devices, status))
            return false;
        for (const Path* device : devices)
            refer(ref, device);
    } else if (farClass == computerSystemClass) {
        const CMPIEnumeration* const systems = computerSystemNames(ctx, target, status);
        if (status.rc != CMPI_RC_OK) {
            flow.enumerationFailed();
            return false;
        }
        while (hasNext(systems)) {
            nextPath(systems); // and not used: the group is the class
            refer(target, ref);
        }
    }
    return true;
}

Status systemReferences(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result, const Path* ref,
                        const char*, const char*, const char**)
{
    const Flow flow(systemProvider, "GlimmarkSystemDevice_References");
    Status status = ok;
    if (walkSystemReferences(flow, ctx, ref, "Object Path is NULL in References.", status,
                             [&](const Instance* instance) { returnInstance(result, instance); }))
        flow.exiting();
    return status;
}

Status systemReferenceNames(CMPIAssociationMI*, const CMPIContext* ctx, const Result* result, const Path* ref,
                            const char*, const char*)
{
    const Flow flow(systemProvider, "GlimmarkSystemDevice_ReferenceNames");
    Status status = ok;
    const auto returnName = [&](const Instance* instance) {
        const Path* const name = pathOf(instance, status);
        if (name == nullptr)
            return;
        place(name, ref, status);
        returnPath(result, name);
    };
    if (walkSystemReferences(flow, ctx, ref, "Object Path is NULL in ReferenceNames.", status, returnName))
        flow.exiting();
    return status;
}

// The providers' records.

template <auto Names, auto All, auto One>
CMPIInstanceMI* instanceProvider(const CMPIBroker* of, const CMPIContext*, Status*)
{
    static CMPIInstanceMIFT table{200, 200,     "described", nullptr, Names,  All,
                                  One, nullptr, nullptr,     nullptr, nullptr};
    static CMPIInstanceMI mi{nullptr, &table};
    broker = of;
    return &mi;
}

template <auto Associators, auto AssociatorNames, auto References, auto ReferenceNames>
CMPIAssociationMI* associationProvider(const CMPIBroker* of, const CMPIContext*, Status*)
{
    static CMPIAssociationMIFT table{
        200, 200, "described", nullptr, Associators, AssociatorNames, References, ReferenceNames};
    static CMPIAssociationMI mi{nullptr, &table};
    broker = of;
    return &mi;
}

} // namespace

EntryPoints describedEntryPoints()
{
    return {&instanceProvider<&glimmarkNames, &glimmarks, &oneGlimmark>,
            &instanceProvider<&capabilitiesNames, &capabilities, &oneCapabilities>,
            &instanceProvider<&elementNames, &elements, &oneElement>,
            &associationProvider<&elementAssociators, &elementAssociatorNames, &elementReferences,
                                 &elementReferenceNames>,
            &instanceProvider<&systemNames, &systemDevices, &oneSystemDevice>,
            &associationProvider<&systemAssociators, &systemAssociatorNames, &systemReferences,
                                 &systemReferenceNames>};
}
