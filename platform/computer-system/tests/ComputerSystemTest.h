/// \file
/// The stand-in provider in a broker, with systems of the test's choice.
#ifndef COMPUTERSYSTEMTEST_H
#define COMPUTERSYSTEMTEST_H

#include "broker/Broker.h"
#include "broker/Registration.h"
#include "cim/Values.h"
#include "testing/Environment.h"

#include <optional>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

class ComputerSystemTest : public testing::Test
{
protected:
    ComputerSystemTest()
        : broker(cimhost::readRegistrationFile(REGISTRATION_FILE), {PROVIDER_DIRECTORY}, listeners())
    {}
    ~ComputerSystemTest() override { EXPECT_THAT(misuses, testing::IsEmpty()); }

    static cimhost::cim::ObjectPath classPath() { return {"", "root/cimv2", "TAVRO_ComputerSystem", {}}; }

    static cimhost::cim::ObjectPath systemPath(const std::string& name)
    {
        cimhost::cim::ObjectPath path = classPath();
        path.keys = {{"CreationClassName", cimhost::cim::textValue("TAVRO_ComputerSystem")},
                     {"Name", cimhost::cim::textValue(name)}};
        return path;
    }

    Testing::Environment systems{"TAVRO_COMPUTER_SYSTEMS", "alpha"};
    std::vector<std::string> misuses;
    cimhost::Broker broker;

private:
    cimhost::Listeners listeners()
    {
        cimhost::Listeners result;
        result.misuse = [this](const std::string& line) { misuses.push_back(line); };
        return result;
    }
};

#endif
