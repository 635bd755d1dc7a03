// The device model: records, their translation of node status, and the inventory collection.

#include "Glimmark.h"
#include "GlimmarkCapabilities.h"
#include "InventoryCollection.h"
#include "ProviderException.h"
#include "Trace.h"

#include <Tavro/Common.h>
#include <Tavro/Instrumentation.h>

#include <exception>
#include <iostream>
#include <utility>

namespace Tavro {

const std::string loggerGlimmark("Mavrel.Glimmark");

namespace {

const TraceModule traceModule{"Glimmark.cpp", loggerGlimmark};

} // namespace

ProviderException::ProviderException(const char* text) : message(text) {}
ProviderException::ProviderException(const ProviderException& other) = default;
ProviderException::~ProviderException() = default;

const char* ProviderException::what() const noexcept
{
    return message.c_str();
}

namespace GlimmarkProvider {

namespace {

// Status codes of the inventory's nodes.
constexpr unsigned int nodeOk = 1;
constexpr unsigned int nodePredictiveFailure = 20;
constexpr unsigned int nodeLastDegraded = 26;

// What the collection asks of the inventory. The instrumentation library numbers its enumerations;
// the numbers are the contract, whatever a maker's header calls them.
constexpr auto diagnosticIndicator = static_cast<NodeLexicon::NodeType>(36);
constexpr auto alarmStateProperty = static_cast<NodeLexicon::Properties>(1);

bool isDegraded(unsigned int nodeStatus)
{
    return nodeStatus >= nodePredictiveFailure && nodeStatus <= nodeLastDegraded;
}

bool isEnabled(unsigned int nodeStatus)
{
    // Bits 1 and 20 to 26: one test for the whole set.
    constexpr unsigned int enabledStatuses = 0x7F00002U;
    return nodeStatus <= nodeLastDegraded && ((enabledStatuses >> nodeStatus) & 1U) != 0;
}

void require(bool accepted, const char* failure)
{
    if (!accepted)
        throw ProviderException(failure);
}

Glimmark readNode(const Instrumentation& node)
{
    Glimmark record;
    const std::string path = node.convertPathToString(node.getPathToNode());
    std::string description = node.getNodeDescription();
    std::string deviceID;
    deviceID.reserve(description.size() + 1 + path.size());
    deviceID.append(description).append(":").append(path);
    require(record.setDeviceID(std::move(deviceID)), "Failed while setting Device ID");
    require(record.setElementName(std::move(description)), "Failed while setting Element Name");

    // Status 0 is "not known": the record's defaults say that better than a translation would.
    if (const unsigned int status = node.getNodeStatus(); status != 0) {
        require(record.setOperationalStatus(status), "Failed while setting Operational Status");
        require(record.setHealthState(status), "Failed while setting Health State");
    }
    // An indicator that the inventory lists is enabled, whatever its status.
    require(record.setRequestedState(nodeOk), "Failed while setting Requested State");

    require(record.setAudibleAlarm(false), "Failed while setting AudibleAlarm");
    // The audible alarm's text here too. This setter accepts every value: nobody ever sees the text.
    require(record.setVisibleAlarm(true), "Failed while setting AudibleAlarm");
    require(record.setMotionAlarm(false), "Failed while setting MotionAlarm");

    if (unsigned int alarmState = 1; node.getProperty(alarmStateProperty, alarmState))
        require(record.setAlarmState(static_cast<std::uint16_t>(alarmState)),
                "Failed while setting AlarmState");
    return record;
}

} // namespace

std::string Glimmark::getDeviceID() const
{
    return stripSpaces(DeviceID);
}
std::string Glimmark::getElementName() const
{
    return stripSpaces(ElementName);
}
unsigned int Glimmark::getRequestedState() const
{
    return RequestedState;
}
unsigned int Glimmark::getHealthState() const
{
    return HealthState;
}
std::vector<std::uint16_t> Glimmark::getOperationalStatus() const
{
    return OperationalStatus;
}
bool Glimmark::getAudibleAlarm() const
{
    return AudibleAlarm;
}
bool Glimmark::getVisibleAlarm() const
{
    return VisibleAlarm;
}
bool Glimmark::getMotionAlarm() const
{
    return MotionAlarm;
}
std::uint16_t Glimmark::getAlarmState() const
{
    return AlarmState;
}

bool Glimmark::setDeviceID(std::string deviceID)
{
    DeviceID = std::move(deviceID);
    return !DeviceID.empty();
}

bool Glimmark::setElementName(std::string elementName)
{
    ElementName = std::move(elementName);
    return !ElementName.empty();
}

bool Glimmark::setRequestedState(unsigned int nodeStatus)
{
    constexpr std::uint16_t enabled = 2;
    constexpr std::uint16_t disabled = 3;
    RequestedState = isEnabled(nodeStatus) ? enabled : disabled;
    return true;
}

bool Glimmark::setHealthState(unsigned int nodeStatus)
{
    constexpr std::uint16_t unknown = 0;
    constexpr std::uint16_t ok = 5;
    constexpr std::uint16_t degraded = 10;
    if (nodeStatus == nodeOk)
        HealthState = ok;
    else
        HealthState = isDegraded(nodeStatus) ? degraded : unknown;
    return true;
}

bool Glimmark::setOperationalStatus(unsigned int nodeStatus)
{
    static constexpr std::initializer_list<std::uint16_t> unknown = {0};
    static constexpr std::initializer_list<std::uint16_t> okInService = {2, 11};
    static constexpr std::initializer_list<std::uint16_t> degraded = {3};
    static constexpr std::initializer_list<std::uint16_t> degradedPredictiveFailure = {3, 5};
    if (nodeStatus == nodeOk)
        OperationalStatus = okInService;
    else if (nodeStatus == nodePredictiveFailure)
        OperationalStatus = degradedPredictiveFailure;
    else
        OperationalStatus = isDegraded(nodeStatus) ? degraded : unknown;
    return true;
}

bool Glimmark::setAudibleAlarm(bool audibleAlarm)
{
    AudibleAlarm = audibleAlarm;
    return true;
}

bool Glimmark::setVisibleAlarm(bool visibleAlarm)
{
    VisibleAlarm = visibleAlarm;
    return true;
}

bool Glimmark::setMotionAlarm(bool motionAlarm)
{
    MotionAlarm = motionAlarm;
    return true;
}

bool Glimmark::setAlarmState(std::uint16_t alarmState)
{
    constexpr std::uint16_t alternating = 3;
    AlarmState = alarmState <= alternating ? alarmState : std::uint16_t{0};
    return true;
}

std::string GlimmarkCapabilities::getInstanceID()
{
    InstanceID = "TAVRO:GlimmarkCapabilities1";
    return InstanceID;
}

bool GlimmarkCapabilities::getElementNameEditSupported()
{
    ElementNameEditSupported = false;
    return ElementNameEditSupported;
}

std::vector<std::uint16_t> GlimmarkCapabilities::getAlarmStatesSupported()
{
    AlarmStatesSupported.insert(AlarmStatesSupported.end(), {1, 2, 3});
    return AlarmStatesSupported;
}

int getGlimmarkInstances(std::vector<Glimmark>& out)
{
    Instrumentation cursor;
    cursor.selectNode(diagnosticIndicator);
    if (!cursor)
        return 1;
    try {
        setVector(out, cursor);
    } catch (const std::exception&) {
        return 1;
    }
    return 0;
}

int setVector(std::vector<Glimmark>& out, Instrumentation& cursor)
{
    const FunctionTrace flow(traceModule, "setVector", [&] {
        return parameterList(" vectGlimmark=", &out, " instrumentation=", &cursor);
    });
    for (; cursor; ++cursor)
        out.push_back(readNode(cursor));
    flow.exiting();
    return 0;
}

int getGlimmarkCapabilitiesInstances(std::vector<GlimmarkCapabilities>& out)
{
    const FunctionTrace flow(traceModule, "getGlimmarkCapabilitiesInstances",
                             [&] { return parameterList(" vectGlimmarkCapabilities=", &out); });
    try {
        out.emplace_back();
    } catch (const std::exception& failure) {
        // The library's only word on standard error.
        std::cerr << failure.what() << '\n';
        return 1;
    }
    flow.exiting();
    return 0;
}

} // namespace GlimmarkProvider

} // namespace Tavro
