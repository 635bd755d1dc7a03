// Every translation of a node's status and of an alarm state, all numbers beyond the known ones included.

#include "Generators.h"

#include "Glimmark.h"

#include <cstdint>
#include <vector>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

using Tavro::GlimmarkProvider::Glimmark;

namespace {

struct States
{
    unsigned int requested;
    unsigned int health;
    std::vector<std::uint16_t> operational;
};

/// Of the statuses from 0 on; what lies beyond is as the first.
const std::vector<States>& knownStates()
{
    static const std::vector<States> states = [] {
        const States unknown{3, 0, {0}};
        const States degraded{2, 10, {3}};
        std::vector<States> all(27, unknown);
        all[1] = {2, 5, {2, 11}};
        all[20] = {2, 10, {3, 5}};
        for (std::size_t status = 21; status <= 26; ++status)
            all[status] = degraded;
        return all;
    }();
    return states;
}

const States& statesOf(unsigned int status)
{
    return status < knownStates().size() ? knownStates()[status] : knownStates()[0];
}

bool isTranslated(unsigned int status)
{
    Glimmark record;
    const States& expected = statesOf(status);
    return record.setRequestedState(status) && record.setHealthState(status) &&
           record.setOperationalStatus(status) && record.getRequestedState() == expected.requested &&
           record.getHealthState() == expected.health &&
           record.getOperationalStatus() == expected.operational;
}

RC_GTEST_PROP(Translations, ofAStatusAreThoseOfTheTable, ())
{
    const unsigned int status = *Generators::statuses();
    RC_ASSERT(isTranslated(status));
}

RC_GTEST_PROP(Translations, forgetTheStatusBefore, ())
{
    Glimmark record;
    for (const unsigned int status : *rc::gen::container<std::vector<unsigned int>>(Generators::statuses())) {
        record.setOperationalStatus(status);
        RC_ASSERT(record.getOperationalStatus() == statesOf(status).operational);
    }
}

} // namespace

TEST(Translations, OfEveryStatusOf16BitsAreThoseOfTheTable)
{
    for (unsigned int status = 0; status <= 0xFFFF; ++status)
        ASSERT_TRUE(isTranslated(status)) << status;
}

TEST(Translations, OfEveryAlarmStateKeepTheKnownOnes)
{
    for (unsigned int state = 0; state <= 0xFFFF; ++state) {
        Glimmark record;
        ASSERT_TRUE(record.setAlarmState(static_cast<std::uint16_t>(state)));
        ASSERT_EQ(record.getAlarmState(), state <= 3 ? state : 0) << state;
    }
}
