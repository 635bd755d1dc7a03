/// \file
/// What a request knows: it collects the indicators, or the capabilities, or both, before it answers.
#ifndef TESTS_FAILURES_DESCRIBED_INDICATORS_H
#define TESTS_FAILURES_DESCRIBED_INDICATORS_H

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace described {

struct Indicator
{
    std::string name;
    std::vector<std::uint16_t> operationalStatus;
    unsigned int healthState = 0;
    unsigned int alarmState = 0;
};

using Indicators = std::map<std::string, Indicator>; ///< by DeviceID

/// Empty when one of them has no description.
Indicators collectIndicators();

/// There is one object of them, always the same.
void collectCapabilities();

Indicators collectIndicatorsAndCapabilities();

} // namespace described

#endif
