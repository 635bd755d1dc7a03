#include "cli/InstanceTable.h"

#include "cim/Values.h"

#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::cli;

namespace {

using cim::Value;

cim::Instance device(const std::string& id, std::uint64_t health, std::vector<Value::Scalar> status)
{
    return {{"",
             "root/cimv2",
             "CIM_Led",
             {{"CreationClassName", cim::textValue("CIM_Led")}, {"DeviceID", cim::textValue(id)}}},
            {{"DeviceID", cim::textValue(id)},
             {"Name", cim::textValue("Led " + id)},
             {"HealthState", cim::unsignedValue(health, CMPI_uint16)},
             {"OperationalStatus", cim::arrayValue(CMPI_uint16, std::move(status))},
             {"AlarmState", cim::unsignedValue(1, CMPI_uint16)},
             {"Caption", cim::textValue("c")}}};
}

const std::vector<cim::Instance>& devices()
{
    static const std::vector<cim::Instance> list{device("a", 5, {std::uint64_t{2}, std::uint64_t{11}}),
                                                 device("b", 99, {std::uint64_t{3}})};
    return list;
}

TEST(InstanceTable, showsAlarmDevicesInWords)
{
    EXPECT_EQ(instanceTable(devices(), std::nullopt),
              "DeviceID  Name   HealthState  OperationalStatus  AlarmState\n"
              "--------  -----  -----------  -----------------  ----------\n"
              "a         Led a  OK           OK, In Service     Off\n"
              "b         Led b  99           Degraded           Off\n");
}

TEST(InstanceTable, showsTheTellingKeysAndThePropertiesNamed)
{
    EXPECT_EQ(instanceTable(devices(), {{"HealthState", "deviceid", "Nothing"}}),
              "DeviceID  HealthState  Nothing\n"
              "--------  -----------  -------\n"
              "a         OK\n"
              "b         99\n");
}

TEST(InstanceTable, showsRepeatingKeysWhereNoOtherTellsTheInstancesApart)
{
    cim::Instance instance = devices().front();
    instance.path.keys.pop_back();
    EXPECT_EQ(instanceTable({instance}, {{"Caption"}}), "CreationClassName  Caption\n"
                                                        "-----------------  -------\n"
                                                        "CIM_Led            c\n");
}

TEST(InstanceTable, showsOtherInstancesAsBlocks)
{
    const cim::ObjectPath end{"", "", "CIM_Led", {{"N", cim::unsignedValue(1)}}};
    const std::vector<cim::Instance> instances{
        {{"", "root/cimv2", "CIM_Link", {}},
         {{"Left", cim::referenceValue(end)},
          {"AlarmState", cim::unsignedValue(2, CMPI_uint16)},
          {"OperationalStatus", cim::arrayValue(CMPI_uint16, {std::uint64_t{2}, std::monostate()})},
          {"Flag", cim::booleanValue(true)},
          {"Letter", cim::unsignedValue('A', CMPI_char16)},
          {"None", cim::nullValue(CMPI_string)},
          {"Text\n", cim::textValue("a\x1b\"b\"")}}},
        {{"", "root/cimv2", "CIM_Empty", {}}, {}}};
    EXPECT_EQ(instanceTable(instances, std::nullopt), "root/cimv2:CIM_Link\n"
                                                      "  Left               CIM_Led.N=1\n"
                                                      "  AlarmState         2 (Steady)\n"
                                                      "  OperationalStatus  2 (OK), NULL\n"
                                                      "  Flag               TRUE\n"
                                                      "  Letter             'A'\n"
                                                      "  None\n"
                                                      "  Text\\n             a\\x001B\"b\"\n"
                                                      "\n"
                                                      "root/cimv2:CIM_Empty\n");
}

TEST(InstanceTable, isNotForDevicesIfOneInstanceIsNone)
{
    std::vector<cim::Instance> instances = devices();
    instances.back().properties.erase(instances.back().properties.begin() + 2); // HealthState
    EXPECT_EQ(instanceTable(instances, std::nullopt), instanceBlocks(instances));
}

TEST(InstanceTable, saysSoIfThereIsNothing)
{
    EXPECT_EQ(instanceTable({}, std::nullopt), "No instances.\n");
    EXPECT_EQ(instanceTable({}, {{"Name"}}), "No instances.\n");
    EXPECT_EQ(nameTable({}), "No names.\n");
}

TEST(NameTable, hasAColumnForEachKey)
{
    const std::vector<cim::ObjectPath> paths{
        {"srv", "root/cimv2", "CIM_A", {{"Name", cim::textValue("x")}, {"Number", cim::unsignedValue(1)}}},
        {"", "root/cimv2", "cim_a", {{"NUMBER", cim::unsignedValue(2)}}}};
    EXPECT_EQ(nameTable(paths), "Name  Number\n"
                                "----  ------\n"
                                "x     1\n"
                                "      2\n");
}

TEST(NameTable, tellsClassesApart)
{
    EXPECT_EQ(nameTable({{"", "", "CIM_A", {{"N", cim::unsignedValue(1)}}},
                         {"", "", "CIM_B", {{"N", cim::unsignedValue(2)}}}}),
              "Class  N\n"
              "-----  -\n"
              "CIM_A  1\n"
              "CIM_B  2\n");
    EXPECT_EQ(nameTable({{"", "", "CIM_A", {}}}), "Class\n-----\nCIM_A\n");
}

} // namespace
