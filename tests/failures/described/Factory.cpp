#include "Factory.h"

#include "Names.h"
#include "Trace.h"

#include <Tavro/Common.h>
#include <Tavro/Locale.h>

namespace described {

namespace {

/// An instance on a path of its own, as both builders begin; what they get, null or not.
Instance* newInstanceOf(const char* ofClass, const Path* ref, Status& rc)
{
    const Path* const path = newPathUnchecked(ref, ofClass, rc);
    if (missing(path))
        return nullptr;
    placeOnHost(path, ref, rc);
    return newInstance(path, nullptr);
}

std::string caption()
{
    const auto library = Tavro::Locale::getResourceLibrary(2, Tavro::Locale::getLanguageId());
    return Tavro::make_string(Tavro::ResourceString(library, L"MSGID_ALARMDEVICE_CAPTION"));
}

struct FarEnd
{
    const char* sourceClass;
    const char* assocClass;
    const char* targetClass;
    const char* provider;
    const char* text;
};

constexpr FarEnd farEnds[] = {
    {computerSystemClass, systemDeviceClass, glimmarkClass, systemDeviceProvider,
     "Target Class is GlimmarkClass"},
    {glimmarkClass, systemDeviceClass, computerSystemClass, systemDeviceProvider,
     "Target Class is ComputerSystemClass"},
    {glimmarkClass, elementClass, capabilitiesClass, elementProvider,
     "Target Class is GlimmarkCapabilitiesClass"},
    {capabilitiesClass, elementClass, glimmarkClass, elementProvider, "Target Class is GlimmarkClass"},
};

const char* targetClassName(const Path* ref, const std::string& assocClass, Status& rc)
{
    const Flow flow(factory, "get_assoc_targetClass_Name");
    for (const FarEnd& row : farEnds) {
        if (className(ref, rc) != row.sourceClass || assocClass != row.assocClass)
            continue;
        tell(CMPI_LEV_INFO, row.provider, row.text);
        flow.exiting();
        return row.targetClass;
    }
    return nullptr;
}

} // namespace

bool addIndicatorPaths(const Indicators& indicators, const Path* ref, Paths& paths, Status& rc)
{
    const Flow flow(factory, "getAllGlimmarkCMPIObjPaths");
    if (indicators.empty()) {
        tell(CMPI_LEV_INFO, glimmarkProvider, "***No instance found***");
        return false;
    }
    for (const auto& [deviceID, indicator] : indicators) {
        Path* const path = newPath(ref, glimmarkClass, rc);
        if (missing(path)) {
            report(glimmarkProvider, rc, "Create CMPIObjectPath failed.",
                   "Create CMPIObjectPath                     failed for RecordLogClass.");
            return false;
        }
        placeOnHost(path, ref, rc);
        addKey(path, "CreationClassName", glimmarkClass);
        addKey(path, "DeviceID", deviceID);
        addKey(path, "SystemCreationClassName", computerSystemClass);
        addKey(path, "SystemName", Tavro::getSystemName());
        paths.push_back(path);
    }
    flow.exiting();
    return true;
}

bool addCapabilitiesPaths(const Path* ref, Paths& paths, Status& rc)
{
    const Flow flow(factory, "getAllGlimmarkCapabilitiesCMPIObjPaths");
    Path* const path = newPath(ref, capabilitiesClass, rc);
    if (missing(path)) {
        report(capabilitiesProvider, rc, "Create CMPIObjectPath failed",
               "Create CMPIObjectPath failed for                     GlimmarkCapabilities class");
        return false;
    }
    placeOnHost(path, ref, rc);
    addKey(path, "InstanceID", capabilitiesIdentifier);
    paths.push_back(path);
    flow.exiting();
    return true;
}

Instance* indicatorInstance(const std::string& deviceID, const Indicator& indicator, const Path* ref,
                            Status& rc)
{
    const Flow flow(factory, "makeGlimmarkInstance");
    Instance* const instance = newInstanceOf(glimmarkClass, ref, rc);
    if (missing(instance)) {
        flow.exiting();
        return instance;
    }
    setFilter(instance, {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"});
    setText(instance, "CreationClassName", glimmarkClass);
    setText(instance, "DeviceID", deviceID);
    setText(instance, "SystemCreationClassName", computerSystemClass);
    setText(instance, "SystemName", Tavro::getSystemName());
    setText(instance, "Caption", caption());
    setText(instance, "Description", indicator.name);
    setText(instance, "Name", indicator.name);
    setText(instance, "ElementName", indicator.name);
    setNumber(instance, "RequestedState", 2);
    setNumber(instance, "HealthState", indicator.healthState);
    if (!setNumbers(instance, "OperationalStatus", indicator.operationalStatus, rc)) {
        report(glimmarkProvider, rc,
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
    Instance* const instance = newInstanceOf(capabilitiesClass, ref, rc);
    if (!missing(instance)) {
        setFilter(instance, {"InstanceID"});
        setText(instance, "InstanceID", capabilitiesIdentifier);
        if (!setNumbers(instance, "RequestedAlarmStatesSupported", {1, 2, 3}, rc))
            report(
                capabilitiesProvider, rc,
                "Creating array for Property                         RequestedAlarmStatesSupported failed.",
                "Creating Array for Property                         RequestedAlarmStatesSupported failed.");
    }
    flow.exiting();
    return instance;
}

Instances capabilitiesInstances(const Path* ref, Status& rc, bool exist)
{
    const Flow flow(factory, "getAllGlimmarkCapabilitiesCMPIInstances");
    Instances instances;
    if (exist)
        instances.push_back(capabilitiesInstance(ref, rc));
    flow.exiting();
    return instances;
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

} // namespace described
