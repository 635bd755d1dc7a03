#include "Indicators.h"

#include "Trace.h"

#include <Tavro/Common.h>
#include <Tavro/Instrumentation.h>

namespace described {

namespace {

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

} // namespace

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

Indicators collectIndicatorsAndCapabilities()
{
    Indicators indicators = collectIndicators();
    collectCapabilities();
    return indicators;
}

} // namespace described
