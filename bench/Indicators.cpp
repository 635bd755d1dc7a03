#include "Indicators.h"

#include <algorithm>
#include <optional>

namespace bench {

namespace {

MadeInventory::Node makeNode(std::size_t number)
{
    constexpr unsigned int statuses[] = {1, 20, 21, 0, 2};
    constexpr unsigned int alarmStates = 4;
    const std::string text = std::to_string(number);
    MadeInventory::Node node{"Drive " + text + " Fault LED", "chassis-1/drive-bay-" + text + "/indicator-1"};
    node.status = statuses[number % std::size(statuses)];
    if (number % (alarmStates + 1) != 0)
        node.alarmState = static_cast<unsigned int>(number % (alarmStates + 1)) - 1;
    return node;
}

Indicator indicatorOf(const MadeInventory::Node& node)
{
    Indicator indicator{node.description + ":/" + node.path, node.description, 0, {}, 0};
    if (node.status == 1) {
        indicator.healthState = 5;
        indicator.operationalStatus = {2, 11};
    } else if (node.status == 20) {
        indicator.healthState = 10;
        indicator.operationalStatus = {3, 5};
    } else if (node.status == 21) {
        indicator.healthState = 10;
        indicator.operationalStatus = {3};
    } else if (node.status != 0) {
        indicator.operationalStatus = {0};
    }
    indicator.alarmState = static_cast<std::uint16_t>(node.alarmState.value_or(0));
    return indicator;
}

} // namespace

std::vector<MadeInventory::Node> makeNodes(std::size_t count)
{
    std::vector<MadeInventory::Node> nodes;
    nodes.reserve(count);
    for (std::size_t number = 1; number < count; ++number)
        nodes.push_back(makeNode(number));
    nodes.push_back({"b", "2"});
    return nodes;
}

Indicators::Indicators(const std::vector<MadeInventory::Node>& nodes)
{
    for (const MadeInventory::Node& node : nodes) {
        sorted.push_back(indicatorOf(node));
        deviceIDs.push_back(sorted.back().deviceID);
    }
    std::sort(sorted.begin(), sorted.end(),
              [](const Indicator& a, const Indicator& b) { return a.deviceID < b.deviceID; });
}

} // namespace bench
