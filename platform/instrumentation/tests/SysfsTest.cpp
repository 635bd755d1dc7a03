// Reading sysfs: what is chosen when, names and attributes one by one, and what goes wrong.

#include <Tavro/Instrumentation.h>

#include "testing/Environment.h"
#include "testing/RecordedLog.h"
#include "testing/TemporaryDirectory.h"
#include "testing/WithoutPrivileges.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <filesystem>
#include <iterator>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;
using Tavro::Instrumentation;
using testing::ElementsAre;
using Testing::Environment;
using testing::IsEmpty;
using testing::StartsWith;
using Testing::TemporaryDirectory;
namespace NodeLexicon = Tavro::NodeLexicon;

constexpr unsigned int unknown = 0;
constexpr unsigned int off = 1;
constexpr unsigned int steady = 2;
constexpr unsigned int alternating = 3;

std::vector<std::string> descriptions()
{
    std::vector<std::string> found;
    Instrumentation cursor;
    for (cursor.selectNode(NodeLexicon::DiagnosticIndicator); cursor; ++cursor)
        found.push_back(cursor.getNodeDescription());
    return found;
}

/// Status and alarm state of the only indicator.
std::pair<unsigned int, unsigned int> states()
{
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    EXPECT_TRUE(cursor);
    unsigned int state = 17;
    EXPECT_TRUE(cursor.getProperty(NodeLexicon::AlarmState, state));
    return {cursor.getNodeStatus(), state};
}

class Sysfs : public testing::Test
{
protected:
    Sysfs()
    {
        fs::create_directories(tree.path("class/leds"));
        fs::create_directories(tree.path("class/enclosure"));
        fs::create_directories(tree.path("devices"));
    }
    ~Sysfs() override { EXPECT_THAT(RecordedLog::take(), IsEmpty()); }

    /// As the kernel does it: the link comes last.
    void addLed(const std::string& name, const std::string& brightness = "1\n",
                const std::optional<std::string>& trigger = "[none] timer\n") const
    {
        const std::string device = "devices/" + name + '/';
        fs::create_directory(tree.path("devices/" + name));
        (void)tree.file(device + "brightness", brightness);
        if (trigger)
            (void)tree.file(device + "trigger", *trigger);
        fs::create_directory_symlink("../../devices/" + name, tree.path("class/leds/" + name));
    }

    /// As the kernel does it: the link goes first.
    void removeLed(const std::string& name) const
    {
        fs::remove(tree.path("class/leds/" + name));
        fs::remove(tree.path("devices/" + name + "/trigger"));
        fs::remove(tree.path("devices/" + name + "/brightness"));
        fs::remove(tree.path("devices/" + name));
    }

    /// An enclosure "bay" with a slot "1" that has one light.
    void useSlot(const std::string& status, const std::string& fault) const
    {
        fs::create_directories(tree.path("devices/bay/1"));
        if (!fs::is_symlink(tree.path("class/enclosure/bay")))
            fs::create_directory_symlink("../../devices/bay", tree.path("class/enclosure/bay"));
        (void)tree.file("devices/bay/1/status", status);
        (void)tree.file("devices/bay/1/fault", fault);
    }

    TemporaryDirectory tree;
    TemporaryDirectory elsewhere;
    Environment inventory{"TAVRO_INVENTORY", std::nullopt};
    Environment root{"TAVRO_SYSFS_ROOT", tree.path("")};
};

// Which source.

TEST_F(Sysfs, isReadWhereNothingElseIsNamed)
{
    addLed("power");
    for (const std::optional<std::string>& value : {std::optional<std::string>(), {""}, {"sysfs"}}) {
        inventory.set(value);
        EXPECT_THAT(descriptions(), ElementsAre("Power LED"));
    }
}

TEST_F(Sysfs, isNotReadWhereAFileIsNamed)
{
    addLed("power");
    inventory.set(elsewhere.file("sysfs", R"({"nodes":[]})"));
    EXPECT_THAT(descriptions(), IsEmpty());
}

TEST_F(Sysfs, isReadAfterTheNodesOfAFileThatNamesItsClasses)
{
    addLed("power");
    useSlot("OK\n", "0\n");
    const std::string node = R"("nodes":[{"kind":36,"description":"D","path":"P","status":1}])";
    const std::string slot = "Enclosure bay Slot 1 Fault LED";
    const std::vector<std::pair<std::string, std::vector<std::string>>> cases = {
        {R"("sources":["leds"])", {"Power LED"}},
        {R"("sources":["enclosures"])", {slot}},
        {R"("sources":["leds","enclosures"])", {"Power LED", slot}},
        {R"("sources":["enclosures","leds"])", {slot, "Power LED"}},
        {R"("sources":[])", {}},
        {R"("sources":["leds"],)" + node, {"D", "Power LED"}},
        {node + R"(,"sources":["enclosures"])", {"D", slot}},
    };
    for (const auto& [fields, expected] : cases) {
        inventory.set(elsewhere.file("inventory.json", '{' + fields + '}'));
        EXPECT_EQ(descriptions(), expected) << fields;
    }
}

TEST_F(Sysfs, pathsOfAFileBesideItAreShownAsTheyStand)
{
    addLed("power");
    inventory.set(elsewhere.file(
        "inventory.json",
        R"({"sources":["leds"],"nodes":[{"kind":36,"description":"D","path":"P","status":1}]})"));
    Instrumentation cursor;
    cursor.selectNode(NodeLexicon::DiagnosticIndicator);
    EXPECT_EQ(cursor.convertPathToString(cursor.getPathToNode()), "P");
    ++cursor;
    EXPECT_EQ(cursor.convertPathToString(cursor.getPathToNode()), "/sys/class/leds/power");
}

TEST_F(Sysfs, isThisMachinesOwnUnlessARootIsNamed)
{
    // Whatever this machine has: it is read without a complaint.
    for (const std::optional<std::string>& value : {std::optional<std::string>(), {""}}) {
        root.set(value);
        const Instrumentation cursor;
        for (const RecordedLog::Line& line : RecordedLog::take())
            EXPECT_THAT(line.text, StartsWith("/sys")) << "a machine without sysfs";
    }
}

// Attributes.

TEST_F(Sysfs, theAlarmStateOfALedIsThatOfBrightnessAndTrigger)
{
    struct Case
    {
        std::string brightness;
        std::optional<std::string> trigger;
        unsigned int state;
    };
    const std::vector<Case> cases = {
        {"0\n", std::nullopt, off},
        {"1\n", std::nullopt, steady},
        {"255\n", std::nullopt, steady},
        {"0\n", "[none] timer\n", off},
        {"7\n", "[none] timer\n", steady},
        {"0\n", "none [timer] heartbeat\n", alternating},
        {"1\n", "none [timer] heartbeat\n", alternating},
        {"0\n", "none timer [heartbeat]\n", alternating},
        {"0\n", "none [pattern]\n", alternating},
        {"0\n", "none [activity]\n", alternating},
        {"0\n", "none [disk-activity]\n", off},
        {"1\n", "none [disk-activity]\n", steady},
        {"0\n", "none timer [oneshot]\n", off},
        {"0\n", "none timer [my-timer]\n", off},
        {"0\n", "none timer [Timer]\n", off},
        {"0\n", "none timer []\n", off},
        {"0\n", "none timer heartbeat\n", unknown},
        {"0\n", "\n", unknown},
    };
    for (const Case& each : cases) {
        addLed("led", each.brightness, each.trigger);
        EXPECT_EQ(states(), std::make_pair(1U, each.state)) << each.brightness << each.trigger.value_or("-");
        removeLed("led");
    }
}

TEST_F(Sysfs, theStatusOfALightIsThatOfItsSlot)
{
    const std::vector<std::pair<std::string, unsigned int>> cases = {
        {"OK\n", 1},
        {"OK", 1},
        {"non-critical\n", 20},
        {"critical\n", 21},
        {"unrecoverable\n", 22},
        {"not installed\n", 0},
        {"unsupported\n", 0},
        {"unknown\n", 0},
        {"unavailable\n", 0},
        {"ok\n", 0},
        {"OK OK\n", 0},
        {"OK\n\n", 0},
        {std::string("OK\0", 3), 0},
        {"", 0},
        {"\n", 0},
        {std::string(100000, 'O'), 0},
    };
    for (const auto& [status, code] : cases) {
        useSlot(status, "0\n");
        EXPECT_EQ(states(), std::make_pair(code, off)) << status.substr(0, 20);
    }
}

TEST_F(Sysfs, theAlarmStateOfASlotsLightIsItsOwn)
{
    const std::vector<std::pair<std::string, unsigned int>> cases = {
        {"0\n", off},  {"1\n", steady},  {"6\n", steady},   {"0", off},
        {"", unknown}, {"x\n", unknown}, {"-1\n", unknown},
    };
    for (const auto& [fault, state] : cases) {
        useSlot("OK\n", fault);
        EXPECT_EQ(states(), std::make_pair(1U, state)) << fault;
    }
}

TEST_F(Sysfs, aSlotWithoutAStatusHasAnUnknownOne)
{
    useSlot("OK\n", "1\n");
    fs::remove(tree.path("devices/bay/1/status"));
    EXPECT_EQ(states(), std::make_pair(0U, steady));
}

// Names.

TEST_F(Sysfs, theNameOfALedIsShownInWords)
{
    const std::vector<std::pair<std::string, std::string>> cases = {
        // device:colour:function
        {"front:blue:identify", "Front Blue Identify LED"},
        {"board-2:multicolor:status", "Board 2 Multicolor Status LED"},
        {"disk0:ir:activity", "Disk 0 Infrared Activity LED"},
        {"front:green:status-12", "Front Green Status 12 LED"},
        {"green:disk-err", "Green Disk Error LED"},
        {"red:fault_1", "Red Fault 1 LED"},
        {"input7::kbd_backlight", "Input 7 Keyboard Backlight LED"},
        {"mmc1::", "MMC 1 LED"},
        {":green:", "Green LED"},
        {"::power", "Power LED"},
        {":power", "Power LED"},
        {"power:", "Power LED"},
        {"a:b:c:d", "a:b C D LED"},
        {"r8169-0-300:00:green:lan", "r8169-0-300:00 Green LAN LED"},
        {"1-1.4:amber:link", "1-1.4 Amber Link LED"},
        {"rgb:player-1", "RGB Player 1 LED"},
        // Plain names.
        {"led", "LED"},
        {"Led3", "LED 3"},
        {"statusLight", "Status Light LED"},
        {"NVMe0", "NVMe 0 LED"},
        {"enp2s0", "Enp2s0 LED"},
        {"r8169", "R8169 LED"},
        {"wlan-5ghz", "WLAN 5ghz LED"},
        {"sled", "Sled LED"},
        {"Fault  Of--All__Things", "Fault Of All Things LED"},
        {"controller!c0d1", "Controller!c0d1 LED"},
    };
    for (const auto& [name, words] : cases) {
        addLed(name);
        EXPECT_THAT(descriptions(), ElementsAre(words)) << name;
        removeLed(name);
    }
}

// What goes wrong.

/// The only line logged while the inventory is read; expects no indicators.
std::string complaint()
{
    EXPECT_THAT(descriptions(), IsEmpty());
    const std::vector<RecordedLog::Line> lines = RecordedLog::take();
    EXPECT_EQ(lines.size(), 1U);
    if (lines.empty())
        return {};
    EXPECT_EQ(lines.front().channel, RecordedLog::Channel::log);
    EXPECT_EQ(lines.front().level, 6000);
    EXPECT_EQ(lines.front().category, "Mavrel.Instrumentation");
    EXPECT_EQ(lines.front().file, "SysfsNodeSource.cpp");
    return lines.front().text;
}

TEST_F(Sysfs, aRootThatIsNoneIsComplainedOf)
{
    root.set(tree.path("none"));
    EXPECT_EQ(complaint(), tree.path("none") + ": expected a directory of sysfs: No such file or directory");
    const std::string file = tree.file("file", "");
    root.set(file);
    EXPECT_EQ(complaint(), file + ": expected a directory of sysfs: Not a directory");
}

TEST_F(Sysfs, aClassThatIsNoDirectoryIsComplainedOf)
{
    useSlot("OK\n", "0\n");
    fs::remove(tree.path("class/leds"));
    root.set(tree.path("."));
    inventory.set(elsewhere.file("leds.json", R"({"sources":["leds"]})"));
    (void)tree.file("class/leds", "");
    EXPECT_EQ(complaint(), tree.path(".") + "/class/leds: expected a directory of sysfs: Not a directory");
}

TEST_F(Sysfs, aClassThatTheKernelHasNotIsNoFault)
{
    fs::remove_all(tree.path("class"));
    EXPECT_THAT(descriptions(), IsEmpty());
}

TEST_F(Sysfs, whatMayNotBeReadIsUnknown)
{
    addLed("brightness");
    addLed("device");
    addLed("trigger");
    // Only its owner may use a temporary directory.
    ASSERT_EQ(chmod(tree.path("").c_str(), 0755), 0);
    ASSERT_EQ(chmod(tree.path("devices/brightness/brightness").c_str(), 0), 0);
    ASSERT_EQ(chmod(tree.path("devices/device").c_str(), 0), 0);
    ASSERT_EQ(chmod(tree.path("devices/trigger/trigger").c_str(), 0), 0);

    const Testing::WithoutPrivileges user;
    Instrumentation cursor;
    std::vector<std::pair<unsigned int, unsigned int>> found;
    for (cursor.selectNode(NodeLexicon::DiagnosticIndicator); cursor; ++cursor) {
        unsigned int state = 17;
        cursor.getProperty(NodeLexicon::AlarmState, state);
        found.emplace_back(cursor.getNodeStatus(), state);
    }
    EXPECT_THAT(found, ElementsAre(std::make_pair(0U, unknown), std::make_pair(0U, unknown),
                                   std::make_pair(1U, unknown)));
}

TEST_F(Sysfs, nothingIsTakenOutOfAPipe)
{
    addLed("led");
    const std::string pipe = tree.path("devices/led/brightness");
    fs::remove(pipe);
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    const int end = open(pipe.c_str(), O_RDWR | O_NONBLOCK | O_CLOEXEC);
    ASSERT_EQ(write(end, "1\n", 2), 2);
    EXPECT_EQ(states(), std::make_pair(0U, unknown));
    std::array<char, 3> left{};
    EXPECT_EQ(read(end, left.data(), left.size()), 2);
    close(end);
}

TEST_F(Sysfs, noDescriptorStaysOpen)
{
    addLed("well");
    addLed("broken");
    fs::remove(tree.path("devices/broken/brightness"));
    useSlot("OK\n", "0\n");
    const auto open = [] {
        return std::distance(fs::directory_iterator("/proc/self/fd"), fs::directory_iterator());
    };
    const auto before = open();
    const Instrumentation cursor;
    EXPECT_EQ(open(), before);
}

// LEDs come and go as the kernel lets them while others read: each one listed is whole.
TEST_F(Sysfs, aLedThatVanishesWhileItIsReadIsLeftOut)
{
    constexpr int atATime = 20;
    std::atomic<bool> isDone = false;
    std::atomic<int> removed = 0;
    std::thread kernel([&] {
        for (int added = 0; !isDone; ++added) {
            addLed("led-" + std::to_string(added));
            if (added >= atATime) {
                removeLed("led-" + std::to_string(added - atATime));
                ++removed;
            }
        }
    });
    std::size_t broken = 0;
    for (int round = 0; round < 100 || removed < 100; ++round) {
        Instrumentation cursor;
        for (cursor.selectNode(NodeLexicon::DiagnosticIndicator); cursor; ++cursor) {
            unsigned int state = 17;
            cursor.getProperty(NodeLexicon::AlarmState, state);
            broken += cursor.getNodeStatus() != 1 || state != steady;
        }
    }
    isDone = true;
    kernel.join();
    EXPECT_EQ(broken, 0U);
}

TEST_F(Sysfs, cursorsOfSeveralThreadsDoNotMeet)
{
    for (int number = 0; number < 10; ++number)
        addLed("led" + std::to_string(number));
    useSlot("OK\n", "0\n");
    std::vector<std::thread> threads;
    threads.reserve(4);
    for (int number = 0; number < 4; ++number)
        threads.emplace_back([] {
            for (int round = 0; round < 20; ++round)
                EXPECT_EQ(descriptions().size(), 11U);
        });
    for (std::thread& thread : threads)
        thread.join();
}

} // namespace
