#include "cli/InstanceTable.h"

#include "cim/Utf8.h"
#include "cim/Values.h"

#include <sstream>

#include <gmock/gmock.h>
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

const cim::Instances& devices()
{
    static const cim::Instances list{device("a", 5, {std::uint64_t{2}, std::uint64_t{11}}),
                                     device("b", 99, {std::uint64_t{3}})};
    return list;
}

TEST(InstanceTable, showsAlarmDevicesInWords)
{
    EXPECT_EQ(instanceTable(devices(), std::nullopt),
              "Name   HealthState  OperationalStatus  AlarmState  DeviceID\n"
              "-----  -----------  -----------------  ----------  --------\n"
              "Led a  OK           OK, In Service     Off         a\n"
              "Led b  99           Degraded           Off         b\n");
}

TEST(InstanceTable, showsTheKeysFirstWhereNoNameTellsTheInstancesApart)
{
    cim::Instances instances = devices();
    instances.editBack().properties[1].value = instances[0].properties[1].value;
    EXPECT_EQ(instanceTable(instances, std::nullopt),
              "DeviceID  HealthState  OperationalStatus  AlarmState  Name\n"
              "--------  -----------  -----------------  ----------  -----\n"
              "a         OK           OK, In Service     Off         Led a\n"
              "b         99           Degraded           Off         Led a\n");
}

TEST(InstanceTable, fitsTheTerminal)
{
    const cim::Instances instances{device("chassis-1/system-board-1/a", 5, {std::uint64_t{2}}),
                                   device("chassis-1/system-board-1/b", 10, {std::uint64_t{3}})};
    const auto heading = [&](std::size_t width) {
        const std::string table = instanceTable(instances, std::nullopt, width);
        return table.substr(0, table.find('\n'));
    };
    EXPECT_EQ(heading(200),
              "Name                            HealthState       OperationalStatus  AlarmState  DeviceID");
    EXPECT_THAT(instanceTable(instances, std::nullopt, 105),
                testing::HasSubstr("  chassis-1/s…em-board-1/b\n"));
    EXPECT_EQ(heading(90), "Name                            HealthState       OperationalStatus  AlarmState");
    EXPECT_THAT(instanceTable(instances, std::nullopt, 70),
                testing::HasSubstr("\nLed chassis-1/system-boar…  Degraded/Warning"));
    EXPECT_THAT(instanceTable(instances, {{"HealthState"}}, 40),
                testing::HasSubstr("\nchassis-1/…m-board-1/b  Degraded/Warning\n"));
}

TEST(InstanceTable, neverWraps)
{
    for (std::size_t width = 0; width < 120; ++width)
        for (const cim::PropertyList& properties :
             {cim::PropertyList(), cim::PropertyList({"Name", "OperationalStatus"})}) {
            std::istringstream lines(instanceTable(devices(), properties, width));
            for (std::string line; std::getline(lines, line);)
                EXPECT_LE(cim::displayWidth(line), width) << line;
        }
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
    const cim::Instances instances{
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
    cim::Instances instances = devices();
    std::vector<cim::Property>& properties = instances.editBack().properties;
    properties.erase(properties.begin() + 2); // HealthState
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
    const cim::ObjectPaths paths{
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
