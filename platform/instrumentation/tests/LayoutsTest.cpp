// What is made of sysfs, on trees laid out like those of several servers.

#include <Tavro/Instrumentation.h>

#include "testing/Environment.h"
#include "testing/RecordedLog.h"
#include "testing/TemporaryDirectory.h"

#include <cstdlib>
#include <map>
#include <ostream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using Tavro::Instrumentation;
using testing::ElementsAre;
using Testing::Environment;
using testing::IsEmpty;
using Testing::TemporaryDirectory;
using testing::UnorderedElementsAre;
namespace NodeLexicon = Tavro::NodeLexicon;

enum State : unsigned int
{
    Unknown,
    Off,
    Steady,
    Alternating
};

struct Indicator
{
    std::string description;
    std::string displayText; ///< without "/sys/class/"
    unsigned int status;
    State state;

    bool operator==(const Indicator& other) const
    {
        return description == other.description && displayText == other.displayText &&
               status == other.status && state == other.state;
    }
};

std::ostream& operator<<(std::ostream& stream, const Indicator& indicator)
{
    return stream << '{' << indicator.description << ", " << indicator.displayText << ", " << indicator.status
                  << ", " << indicator.state << '}';
}

std::string withoutFolder(const std::string& path)
{
    const std::string folder = "/sys/class/";
    EXPECT_EQ(path.rfind(folder, 0), 0U) << path;
    return path.substr(folder.size());
}

Indicator indicatorUnder(const Instrumentation& cursor)
{
    unsigned int state = 17;
    EXPECT_TRUE(cursor.getProperty(NodeLexicon::AlarmState, state));
    return {cursor.getNodeDescription(), withoutFolder(cursor.convertPathToString(cursor.getPathToNode())),
            cursor.getNodeStatus(), static_cast<State>(state)};
}

std::vector<Indicator> indicators()
{
    std::vector<Indicator> found;
    Instrumentation cursor;
    for (cursor.selectNode(NodeLexicon::DiagnosticIndicator); cursor; ++cursor)
        found.push_back(indicatorUnder(cursor));
    return found;
}

class Layouts : public testing::Test
{
protected:
    ~Layouts() override { EXPECT_THAT(RecordedLog::take(), IsEmpty()); }

    void make(const std::string& layout)
    {
        const std::string tree = directory.path(layout);
        ASSERT_EQ(std::system((MAKE_TREE " " + layout + " " + tree).c_str()), 0); // NOLINT(cert-env33-c)
        root.set(tree);
    }

    /// The devices' paths by what is shown for them.
    static std::map<std::string, std::string> paths()
    {
        std::map<std::string, std::string> found;
        Instrumentation cursor;
        for (cursor.selectNode(NodeLexicon::DiagnosticIndicator); cursor; ++cursor)
            found[withoutFolder(cursor.convertPathToString(cursor.getPathToNode()))] = cursor.getPathToNode();
        return found;
    }

    TemporaryDirectory directory;
    Environment inventory{"TAVRO_INVENTORY", std::nullopt};
    Environment root{"TAVRO_SYSFS_ROOT", std::nullopt};
};

TEST_F(Layouts, aRackServer)
{
    make("rack");
    const std::string bay = "Enclosure 0:0:24:0 ";
    const std::string path = "enclosure/0:0:24:0/";
    EXPECT_THAT(
        indicators(),
        ElementsAre(Indicator{"BMC Green Heartbeat LED", "leds/bmc:green:heartbeat", 1, Alternating},
                    Indicator{"Chassis Amber Fault LED", "leds/chassis:amber:fault", 1, Alternating},
                    Indicator{"Chassis Blue Identify LED", "leds/chassis:blue:identify", 1, Steady},
                    Indicator{"Chassis Green Power LED", "leds/chassis:green:power", 1, Steady},
                    Indicator{"Chassis Red Temperature LED", "leds/chassis:red:temperature", 1, Off},
                    Indicator{"Green Disk LED", "leds/green:disk", 1, Off},
                    Indicator{"Green LAN 1 LED", "leds/green:lan-1", 1, Steady},
                    Indicator{"Green LAN 2 LED", "leds/green:lan-2", 1, Off},
                    Indicator{bay + "Drive Slot #09 Fault LED", path + "Drive Slot #09 /fault", 1, Off},
                    Indicator{bay + "Drive Slot #09 Locate LED", path + "Drive Slot #09 /locate", 1, Off},
                    Indicator{bay + "Slot 01 Fault LED", path + "Slot 01/fault", 1, Off},
                    Indicator{bay + "Slot 01 Locate LED", path + "Slot 01/locate", 1, Off},
                    Indicator{bay + "Slot 02 Fault LED", path + "Slot 02/fault", 20, Off},
                    Indicator{bay + "Slot 02 Locate LED", path + "Slot 02/locate", 20, Steady},
                    Indicator{bay + "Slot 03 Fault LED", path + "Slot 03/fault", 21, Steady},
                    Indicator{bay + "Slot 03 Locate LED", path + "Slot 03/locate", 21, Off},
                    Indicator{bay + "Slot 04 Fault LED", path + "Slot 04/fault", 22, Steady},
                    Indicator{bay + "Slot 04 Locate LED", path + "Slot 04/locate", 22, Steady},
                    Indicator{bay + "Slot 05 Fault LED", path + "Slot 05/fault", 0, Off},
                    Indicator{bay + "Slot 05 Locate LED", path + "Slot 05/locate", 0, Off},
                    Indicator{bay + "Slot 06 Fault LED", path + "Slot 06/fault", 0, Off},
                    Indicator{bay + "Slot 06 Locate LED", path + "Slot 06/locate", 0, Off},
                    Indicator{bay + "Slot 07 Fault LED", path + "Slot 07/fault", 0, Off},
                    Indicator{bay + "Slot 07 Locate LED", path + "Slot 07/locate", 0, Off},
                    Indicator{bay + "Slot 08 Fault LED", path + "Slot 08/fault", 0, Off},
                    Indicator{bay + "Slot 08 Locate LED", path + "Slot 08/locate", 0, Off}));
}

TEST_F(Layouts, aBladeWithPlainNames)
{
    make("blade");
    EXPECT_THAT(indicators(), ElementsAre(Indicator{"Fan 1 Fault LED", "leds/fan1_fault", 1, Off},
                                          Indicator{"Fan 2 Fault LED", "leds/fan2_fault", 1, Steady},
                                          Indicator{"Front LED", "leds/front-led", 1, Alternating},
                                          Indicator{"Front ID LED", "leds/front_id", 1, Off},
                                          Indicator{"LED 0", "leds/led0", 1, Alternating},
                                          Indicator{"Power LED", "leds/power", 1, Steady},
                                          Indicator{"PSU 1 Fault LED", "leds/psu1_fault", 1, Alternating},
                                          Indicator{"Rear ID LED", "leds/rear-id", 1, Off},
                                          Indicator{"UID LED", "leds/uid", 1, Steady}));
}

TEST_F(Layouts, aServerWithDrivesInPciExpressSlots)
{
    make("nvme");
    const std::vector<Indicator> found = indicators();
    EXPECT_EQ(found.size(), 24U);
    const std::string slot = "leds/0000:40:02.0:enclosure:";
    EXPECT_THAT(found, testing::IsSupersetOf(
                           {Indicator{"0000:40:02.0 Enclosure OK LED", slot + "ok", 1, Off},
                            Indicator{"0000:40:02.0 Enclosure Locate LED", slot + "locate", 1, Steady},
                            Indicator{"0000:40:02.0 Enclosure Predicted Failure LED", slot + "pfa", 1, Off},
                            Indicator{"0000:40:02.0 Enclosure Hot Spare LED", slot + "hotspare", 1, Off}}));
    const std::string bay = "Enclosure 8:0:0:0 ";
    const std::string path = "enclosure/8:0:0:0/";
    EXPECT_THAT(
        std::vector<Indicator>(found.end() - 6, found.end()),
        ElementsAre(Indicator{bay + "Slot 0 Fault LED", path + "0/fault", 1, Off},
                    Indicator{bay + "Slot 0 Locate LED", path + "0/locate", 1, Off},
                    Indicator{bay + "Slot 1 Fault LED", path + "1/fault", 21, Steady},
                    Indicator{bay + "Slot 1 Locate LED", path + "1/locate", 21, Steady},
                    Indicator{bay + "Array Device 02 Fault LED", path + "ArrayDevice02/fault", 1, Off},
                    Indicator{bay + "Array Device 02 Locate LED", path + "ArrayDevice02/locate", 1, Steady}));
}

TEST_F(Layouts, aLaptop)
{
    make("laptop");
    EXPECT_THAT(
        indicators(),
        ElementsAre(Indicator{"Input 3 Caps Lock LED", "leds/input3::capslock", 1, Steady},
                    Indicator{"Input 3 Num Lock LED", "leds/input3::numlock", 1, Off},
                    Indicator{"Input 3 Scroll Lock LED", "leds/input3::scrolllock", 1, Off},
                    Indicator{"Laptop Keyboard Backlight LED", "leds/laptop::kbd_backlight", 1, Steady},
                    Indicator{"MMC 0 LED", "leds/mmc0::", 1, Off},
                    Indicator{"Phy 0 LED", "leds/phy0-led", 1, Off},
                    Indicator{"Platform Microphone Mute LED", "leds/platform::micmute", 1, Steady}));
}

TEST_F(Layouts, aMachineWithoutLights)
{
    make("none");
    EXPECT_THAT(indicators(), IsEmpty());
}

TEST_F(Layouts, pathsLeadToTheDevices)
{
    make("laptop");
    const auto laptop = paths();
    EXPECT_EQ(laptop.at("leds/input3::capslock"),
              "/sys/devices/platform/i8042/serio0/input/input3/input3::capslock");
    EXPECT_EQ(laptop.at("leds/phy0-led"), "/sys/devices/pci0000:00/0000:00:14.3/leds/phy0-led");
    make("nvme");
    EXPECT_EQ(
        paths().at("enclosure/8:0:0:0/1/fault"),
        "/sys/devices/pci0000:00/0000:00:17.0/ata9/host8/target8:0:0/8:0:0:0/enclosure/8:0:0:0/1/fault");
}

TEST_F(Layouts, anyPathOfTheInventoryHasItsDisplayText)
{
    make("blade");
    Instrumentation cursor;
    const std::string power = "/sys/devices/virtual/leds/power";
    EXPECT_EQ(cursor.convertPathToString(power), "/sys/class/leds/power");
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    EXPECT_EQ(cursor.convertPathToString(power), "/sys/class/leds/power");
    EXPECT_EQ(cursor.convertPathToString("/sys/devices"), "/sys/devices");
}

// The layout "odd".

class OddTree : public Layouts
{
protected:
    OddTree() { make("odd"); }

    /// Those of which the path begins so.
    static std::vector<Indicator> below(const std::string& beginning)
    {
        std::vector<Indicator> found;
        for (const Indicator& indicator : indicators())
            if (indicator.displayText.rfind(beginning, 0) == 0)
                found.push_back(indicator);
        return found;
    }

    /// The description of the one of which that is the path.
    static std::string description(const std::string& displayText)
    {
        for (const Indicator& indicator : indicators())
            if (indicator.displayText == displayText)
                return indicator.description;
        return "(none)";
    }
};

TEST_F(OddTree, namesAreShownPrintablyAndApart)
{
    EXPECT_EQ(description("leds/:::"), ": LED");
    EXPECT_EQ(description("leds/-_ -"), "LED");
    EXPECT_EQ(description("leds/\\x20"), "LED");
    EXPECT_EQ(description("leds/line\\x0Abreak"), "Line\\x0Abreak LED");
    EXPECT_EQ(description("leds/not\\xFF\\xC3utf8"), "Not\\xFF\\xC3utf8 LED");
    EXPECT_EQ(description("leds/back\\x5Cx0Aslash"), "Back\\x5Cx0Aslash LED");
    EXPECT_EQ(description("leds/gr\xC3\xBCn"), "Gr\xC3\xBCn LED");
    EXPECT_EQ(description("leds/" + std::string(249, '0') + "7"), std::string(249, '0') + "7 LED");
}

TEST_F(OddTree, aBrightnessThatIsNoneMakesTheStatusUnknown)
{
    const std::vector<Indicator> found = below("leds/brightness-");
    EXPECT_EQ(found.size(), 12U);
    for (const Indicator& indicator : found) {
        EXPECT_EQ(indicator.status, 0U) << indicator;
        EXPECT_EQ(indicator.state, Unknown) << indicator;
    }
}

TEST_F(OddTree, aListOfTriggersThatIsNoneMakesTheStateUnknown)
{
    EXPECT_THAT(below("leds/trigger-"),
                ElementsAre(Indicator{"Trigger Binary LED", "leds/trigger-binary", 1, Unknown},
                            Indicator{"Trigger Directory LED", "leds/trigger-directory", 1, Unknown},
                            Indicator{"Trigger Empty LED", "leds/trigger-empty", 1, Unknown},
                            Indicator{"Trigger Endless LED", "leds/trigger-endless", 1, Unknown},
                            Indicator{"Trigger Long LED", "leds/trigger-long", 1, Alternating},
                            Indicator{"Trigger Pipe LED", "leds/trigger-pipe", 1, Unknown},
                            Indicator{"Trigger Unclosed LED", "leds/trigger-unclosed", 1, Unknown}));
}

TEST_F(OddTree, numbersHaveTheirWholeRange)
{
    EXPECT_THAT(below("leds/largest"), ElementsAre(Indicator{"Largest LED", "leds/largest", 1, Steady}));
    EXPECT_THAT(below("leds/no-line"), ElementsAre(Indicator{"No Line End LED", "leds/no-line-end", 1, Off}));
}

TEST_F(OddTree, onlyWhatLeadsToADeviceIsAnIndicator)
{
    for (const char* const gone : {"dangling", "outside", "file", "pipe"})
        EXPECT_THAT(below("leds/" + std::string(gone)), IsEmpty());
    EXPECT_THAT(below("leds/loop"), ElementsAre(Indicator{"Loop LED", "leds/loop", 0, Unknown}));
    EXPECT_THAT(below("leds/old"), ElementsAre(Indicator{"Old Kernel LED", "leds/old-kernel", 1, Steady}));
    EXPECT_EQ(paths().at("leds/old-kernel"), "/sys/class/leds/old-kernel");
    EXPECT_THAT(below("leds/well"), ElementsAre(Indicator{"Well LED", "leds/well", 1, Steady}));
}

TEST_F(OddTree, enclosuresHoldSlotsOnly)
{
    const std::string bay = "Enclosure bay ";
    const std::string path = "enclosure/bay/";
    EXPECT_THAT(
        below("enclosure/"),
        UnorderedElementsAre(
            Indicator{bay + "Fault Only Fault LED", path + "fault-only/fault", 1, Steady},
            Indicator{bay + "Odd\\x1B\\xFFname Fault LED", path + "odd\\x1B\\xFFname/fault", 21, Steady},
            Indicator{bay + "Odd\\x1B\\xFFname Locate LED", path + "odd\\x1B\\xFFname/locate", 21, Off},
            Indicator{bay + "Pipes Fault LED", path + "pipes/fault", 0, Unknown},
            Indicator{bay + "Pipes Locate LED", path + "pipes/locate", 0, Unknown},
            Indicator{bay + "Well Fault LED", path + "well/fault", 1, Off},
            Indicator{bay + "Well Locate LED", path + "well/locate", 1, Off},
            Indicator{bay + "Words Fault LED", path + "words/fault", 0, Unknown},
            Indicator{bay + "Words Locate LED", path + "words/locate", 0, Unknown}));
}

} // namespace
