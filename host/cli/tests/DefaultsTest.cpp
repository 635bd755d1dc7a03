#include "cli/Defaults.h"

#include "cli/Arguments.h"
#include "testing/TemporaryDirectory.h"

#include <cstdlib>
#include <filesystem>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

using namespace cimhost;
using namespace cimhost::cli;
using testing::HasSubstr;
using testing::StartsWith;
using Testing::TemporaryDirectory;

namespace {

const Defaults inventoryDefaults{"", "CIMT_INVENTORY", ""};

class DefaultsFile : public testing::Test
{
protected:
    /// Those of a registration in the folder `own` of a tree.
    [[nodiscard]] Defaults read() const
    {
        return readDefaults({tree.path("own/a.reg")}, {tree.folder("bin"), std::nullopt, std::nullopt});
    }

    /// The error of a file with that text, without the file's name.
    [[nodiscard]] std::string errorOf(const std::string& text) const
    {
        const std::string file = tree.file("own/cimhost.conf", text);
        try {
            static_cast<void>(read());
            return "no error";
        } catch (const UsageError& error) {
            EXPECT_THAT(error.what(), StartsWith(file));
            return std::string(error.what()).substr(file.size());
        }
    }

    TemporaryDirectory tree;
};

TEST_F(DefaultsFile, mayBeMissingAndSoMayItsEntries)
{
    EXPECT_EQ(read().watchedClass, "");
    EXPECT_EQ(read().inventoryVariable, "");
    EXPECT_EQ(errorOf("\n # nothing\n"), "no error");
    EXPECT_EQ(read().watchedClass, "");
}

TEST_F(DefaultsFile, namesTheWatchedClassAndTheVariable)
{
    EXPECT_EQ(errorOf("watch:CIM_A\r\n  inventory-variable : B_C \n"), "no error");
    EXPECT_EQ(read().watchedClass, "CIM_A");
    EXPECT_EQ(read().inventoryVariable, "B_C");
}

TEST_F(DefaultsFile, liesBesideTheRegistrationOrInTheTree)
{
    const std::string inTree = tree.file("schema/cimhost.conf", "watch: CIM_Tree");
    EXPECT_EQ(read().watchedClass, "CIM_Tree") << inTree;
    const std::string own = tree.file("own/cimhost.conf", "watch: CIM_Own");
    EXPECT_EQ(read().watchedClass, "CIM_Own") << own;
}

TEST_F(DefaultsFile, hasNoOtherLines)
{
    const std::string expected =
        ": expected watch, inventory-variable or inventory-check, a colon and a value, found ";
    EXPECT_EQ(errorOf("watch: A\nlook: A\n"), ":2" + expected + "\"look: A\"");
    EXPECT_EQ(errorOf("watch:\n"), ":1" + expected + "\"watch:\"");
    EXPECT_EQ(errorOf("watch\x1b"), ":1" + expected + "\"watch\\x001B\"");
}

TEST_F(DefaultsFile, mustBeAFile)
{
    const std::string folder = tree.folder("own/cimhost.conf");
    EXPECT_THROW(static_cast<void>(read()), UsageError) << folder;
}

TEST(Defaults, completeACommandThatLeavesItsClassToThem)
{
    const Watch watch{{"", "root/x", "", {}}, {}};
    EXPECT_EQ(std::get<Watch>(complete(watch, {"CIM_A", "", ""})).target.className, "CIM_A");
    EXPECT_EQ(std::get<Watch>(complete(watch, {"CIM_A", "", ""})).target.nameSpace, "root/x");
    const Watch own{{"", "root/x", "CIM_Own", {}}, {}};
    EXPECT_EQ(std::get<Watch>(complete(own, {"CIM_A", "", ""})).target.className, "CIM_Own");
    EXPECT_THROW(complete(watch, {}), UsageError);
    EXPECT_EQ(std::get<Watch>(complete(own, {})).target.className, "CIM_Own");
}

TEST(Defaults, withoutAVariableThereIsNoInventory)
{
    EXPECT_THROW(useInventory("/dev/null", {}), UsageError);
}

TEST_F(DefaultsFile, anInventoryIsHandedOnInTheEnvironment)
{
    const std::string file = tree.file("inventory.json", "{}");
    useInventory(file, inventoryDefaults);
    EXPECT_EQ(std::getenv("CIMT_INVENTORY"), file);
    useInventory(tree.file("empty.json", ""), inventoryDefaults); // whose content is the providers' concern
    unsetenv("CIMT_INVENTORY");
}

TEST_F(DefaultsFile, anInventoryMustBeReadable)
{
    for (const std::string& file : {tree.path().string() + "/missing.json", tree.folder("directory")}) {
        try {
            useInventory(file, inventoryDefaults);
            FAIL() << file;
        } catch (const UsageError& error) {
            EXPECT_THAT(error.what(), HasSubstr("cannot read the inventory " + file + ": ")) << file;
        }
        EXPECT_EQ(std::getenv("CIMT_INVENTORY"), nullptr);
    }
}

std::string errorOfInventory(const std::string& file)
{
    try {
        useInventory(file, inventoryDefaults);
        unsetenv("CIMT_INVENTORY");
        return "no error";
    } catch (const UsageError& error) {
        return error.what();
    }
}

TEST_F(DefaultsFile, anInventoryIsARegularFile)
{
    const std::string pipe = tree.path() / "pipe";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_EQ(errorOfInventory(pipe),
              "cannot read the inventory " + pipe + ": expected a regular file, found a pipe");
    for (const std::string device : {"/dev/null", "/dev/zero"})
        EXPECT_EQ(errorOfInventory(device),
                  "cannot read the inventory " + device + ": expected a regular file, found a device");
}

TEST_F(DefaultsFile, aProgramMayJudgeTheInventory)
{
    const std::string program =
        tree.file("libexec/check", "#!/bin/sh\n"
                                   "grep -q good \"$1\" && exit 0\n"
                                   "grep -q unclear \"$1\" && echo unclear && exit 3\n"
                                   "printf 'line 1:\\033 bad\\nmore\\n'\n"
                                   "exit 1\n");
    std::filesystem::permissions(program, std::filesystem::perms::owner_all);
    EXPECT_EQ(errorOf("inventory-variable: CIMT_INVENTORY\ninventory-check: ../libexec/check\n"), "no error");
    const std::string file = tree.path("inventory");
    const auto errorWith = [&](const std::string& content) {
        const std::string written = tree.file("inventory", content);
        try {
            useInventory(written, read());
            unsetenv("CIMT_INVENTORY");
            return std::string("no error");
        } catch (const UsageError& error) {
            return std::string(error.what());
        }
    };
    EXPECT_EQ(errorWith("bad"), "no inventory: " + file + ": line 1:\\x001B bad");
    EXPECT_EQ(errorWith("good"), "no error");
    EXPECT_EQ(errorWith("unclear"), "no error") << "it said nothing of the file";
    std::filesystem::remove(program);
    EXPECT_EQ(errorWith("bad"), "no error") << "there is nobody who could judge";
}

TEST_F(DefaultsFile, namesOfInventoriesAreShownPrintably)
{
    EXPECT_THAT(errorOfInventory("/nowhere/\x1b[2J"),
                HasSubstr("the inventory /nowhere/\\x001B[2J: No such file"));
}

} // namespace
