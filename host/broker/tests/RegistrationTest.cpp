// Registration files: what is read, and the message for everything that cannot be.

#include "broker/Registration.h"

#include <filesystem>
#include <fstream>
#include <random>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

namespace cimhost {

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

constexpr const char* thing = "[TEST_Thing]\n"
                              "   provider: Thing\n"
                              "   location: CimhostSample\n"
                              "   type: instance\n"
                              "   namespace: root/test\n";

TEST(RegistrationTest, ReadsSectionsInTheirOrder)
{
    const Registration registration = parseRegistration("# the things\n"
                                                        "\n" +
                                                            std::string(thing) +
                                                            "#\n"
                                                            "  [ TEST_Link ] \r\n"
                                                            "namespace:root/test\troot/a-b.c\r\n"
                                                            "type: association instance\n"
                                                            "location: lib-Other_1.2+x\n"
                                                            "provider : _Link2\n",
                                                        "test.reg");
    ASSERT_EQ(registration.classes.size(), 2U);
    const RegisteredClass& first = registration.classes[0];
    EXPECT_EQ(first.className, "TEST_Thing");
    EXPECT_EQ(first.provider, "Thing");
    EXPECT_EQ(first.location, "CimhostSample");
    EXPECT_TRUE(first.instance);
    EXPECT_FALSE(first.association);
    EXPECT_THAT(first.nameSpaces, ElementsAre("root/test"));
    const RegisteredClass& second = registration.classes[1];
    EXPECT_EQ(second.className, "TEST_Link");
    EXPECT_EQ(second.provider, "_Link2");
    EXPECT_EQ(second.location, "lib-Other_1.2+x");
    EXPECT_TRUE(second.instance);
    EXPECT_TRUE(second.association);
    EXPECT_THAT(second.nameSpaces, ElementsAre("root/test", "root/a-b.c"));
}

TEST(RegistrationTest, TakesAnEmptyText)
{
    EXPECT_TRUE(parseRegistration("", "test.reg").classes.empty());
    EXPECT_TRUE(parseRegistration("# nothing\n\n", "test.reg").classes.empty());
}

TEST(RegistrationTest, TakesAClassOfTwoProviders)
{
    std::string text = thing;
    text += "[TEST_Thing]\nprovider: Other\nlocation: X\ntype: association\nnamespace: root/test";
    EXPECT_EQ(parseRegistration(text, "test.reg").classes.size(), 2U);
}

struct BadText
{
    const char* name;
    std::string text;
    std::string message;
};

class BadRegistrationTest : public testing::TestWithParam<BadText>
{};

TEST_P(BadRegistrationTest, NamesFileAndLineAndWhatWasExpected)
{
    try {
        parseRegistration(GetParam().text, "test.reg");
        FAIL() << "no error";
    } catch (const RegistrationError& error) {
        EXPECT_EQ(error.what(), GetParam().message);
    }
}

std::string section(const std::string& lines)
{
    return "[TEST_Thing]\n" + lines;
}

INSTANTIATE_TEST_SUITE_P(
    All, BadRegistrationTest,
    testing::Values(
        BadText{"EntryOutsideASection", "\nprovider: Thing\n",
                R"(test.reg:2: expected a section [CLASS] first, found "provider: Thing")"},
        BadText{"SectionNotClosed", "[TEST_Thing\n",
                R"(test.reg:1: expected a section [CLASS], found "[TEST_Thing")"},
        BadText{"LoneBracket", "[", R"(test.reg:1: expected a section [CLASS], found "[")"},
        BadText{"NoClassName", "[ ]", R"(test.reg:1: expected a section [CLASS], found "[ ]")"},
        BadText{"BadClassName", "[1A]", R"(test.reg:1: expected a section [CLASS], found "[1A]")"},
        BadText{"NoColon", section("provider Thing"),
                R"(test.reg:2: expected an entry NAME: VALUE, found "provider Thing")"},
        BadText{"UnknownEntry", section("unload: never"),
                R"(test.reg:2: expected provider:, location:, type: or namespace:, found "unload: never")"},
        BadText{"RepeatedEntry", section("provider: A\nprovider: B"),
                "test.reg:3: the entry provider: stands twice in the section [TEST_Thing]"},
        BadText{"NoProviderName", section("provider:"),
                R"(test.reg:2: expected the name of a provider, found "")"},
        BadText{"BadProviderName", section("provider: A B"),
                R"(test.reg:2: expected the name of a provider, found "A B")"},
        BadText{"LocationWithFolder", section("location: ../evil"),
                R"(test.reg:2: expected the name of a library without "lib" and ".so", found "../evil")"},
        BadText{"NoLocation", section("location:"),
                R"(test.reg:2: expected the name of a library without "lib" and ".so", found "")"},
        BadText{"UnknownType", section("type: instance method"),
                R"(test.reg:2: expected the type instance or association, found "method")"},
        BadText{"NoType", section("type:"),
                R"(test.reg:2: expected the type instance or association, found "")"},
        BadText{"NoNamespace", section("namespace: "),
                R"(test.reg:2: expected a namespace such as root/cimv2, found "")"},
        BadText{"BadNamespace", section("namespace: root/test /x"),
                R"(test.reg:2: expected a namespace such as root/cimv2, found "/x")"},
        BadText{"NamespaceEndsWithSlash", section("namespace: root/"),
                R"(test.reg:2: expected a namespace such as root/cimv2, found "root/")"},
        BadText{"MissingEntry", "#\n[TEST_Thing]\nprovider: A\nlocation: B\ntype: instance\n",
                "test.reg:2: the section [TEST_Thing] has no entry namespace:"},
        BadText{"MissingEntryBeforeNextSection", "[TEST_Thing]\n[TEST_Other]\n",
                "test.reg:1: the section [TEST_Thing] has no entry provider:"},
        BadText{"SameClassAndProviderTwice",
                std::string(thing) +
                    "[test_thing]\nprovider: Thing\nlocation: B\ntype: association\nnamespace: root/x\n",
                "test.reg:6: the class test_thing and the provider Thing are registered in line 1 already"},
        BadText{"ControlCharacters", std::string("a\0b\x1b[2J", 7),
                R"(test.reg:1: expected a section [CLASS] first, found "a\x0000b\x001B[2J")"},
        BadText{"NotUtf8", "\xff\xc3",
                "test.reg:1: expected a section [CLASS] first, found \"\uFFFD\uFFFD\""},
        BadText{"LongLine", std::string(100, 'x'),
                "test.reg:1: expected a section [CLASS] first, found \"" + std::string(60, 'x') + "...\""}),
    [](const auto& instance) { return instance.param.name; });

TEST(RegistrationTest, SurvivesAnyBytes)
{
    std::mt19937 random(1);
    const std::string valid = thing;
    for (int i = 0; i < 5000; ++i) {
        std::string text = valid;
        for (unsigned changes = random() % 8; changes > 0; --changes)
            text[random() % text.size()] = static_cast<char>(random());
        try {
            parseRegistration(text, "test.reg");
        } catch (const RegistrationError& error) {
            EXPECT_THAT(error.what(), HasSubstr("test.reg:"));
        }
    }
}

TEST(RegistrationTest, ReadsAFile)
{
    const std::string name = testing::TempDir() + "cimhost-registration-test.reg";
    std::ofstream(name) << thing;
    EXPECT_EQ(readRegistrationFile(name).classes.size(), 1U);
}

TEST(RegistrationTest, SaysWhyAFileCannotBeRead)
{
    for (const std::string& name : {std::string("/nowhere/test.reg"), testing::TempDir()}) {
        try {
            readRegistrationFile(name);
            FAIL() << "no error";
        } catch (const RegistrationError& error) {
            EXPECT_THAT(error.what(), HasSubstr(name + ": cannot be read: "));
        }
    }
}

std::string errorOfFile(const std::string& name)
{
    try {
        readRegistrationFile(name);
        return "no error";
    } catch (const RegistrationError& error) {
        return error.what();
    }
}

TEST(RegistrationTest, ReadsNoDeviceAndNoPipe)
{
    EXPECT_EQ(errorOfFile("/dev/zero"), "/dev/zero: cannot be read: expected a regular file, found a device");
    const std::string pipe = testing::TempDir() + "cimhost-registration-test.pipe";
    unlink(pipe.c_str());
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_EQ(errorOfFile(pipe), pipe + ": cannot be read: expected a regular file, found a pipe");
    unlink(pipe.c_str());
}

TEST(RegistrationTest, ReadsFilesUpToALimit)
{
    const std::string name = testing::TempDir() + "cimhost-registration-limit.reg";
    const std::string start = thing + std::string("#");
    std::ofstream(name) << start << std::string(maxRegistrationLength - start.size(), 'x');
    EXPECT_EQ(readRegistrationFile(name).classes.size(), 1U);
    std::ofstream(name, std::ios::app) << 'x';
    EXPECT_EQ(errorOfFile(name), name + ": cannot be read: expected at most 1048576 bytes, found more");
    std::filesystem::remove(name);
}

TEST(RegistrationTest, ShowsFileNamesPrintably)
{
    EXPECT_THAT(errorOfFile("/nowhere/\x1b[2J"), HasSubstr("/nowhere/\\x001B[2J: "));
    try {
        parseRegistration("x", "\x1b");
        FAIL() << "no error";
    } catch (const RegistrationError& error) {
        EXPECT_THAT(error.what(), HasSubstr("\\x001B:1: "));
    }
}

} // namespace

} // namespace cimhost
