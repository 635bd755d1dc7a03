#include "cli/Installation.h"

#include "cli/Arguments.h"
#include "schema/MofReader.h"
#include "testing/TemporaryDirectory.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::cli;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using Testing::TemporaryDirectory;

namespace {

std::string normal(const std::string& file)
{
    return std::filesystem::path(file).lexically_normal().string();
}

/// A tree with a program in its folder bin.
class Installation : public testing::Test
{
protected:
    [[nodiscard]] Surroundings surroundings() const
    {
        return {tree.folder("bin"), std::nullopt, std::nullopt};
    }

    TemporaryDirectory tree;
    Settings settings;
};

TEST_F(Installation, theCommandLinesDirectoriesComeFirst)
{
    settings.providerDirectories = {"/a", "/b"};
    Surroundings around = surroundings();
    around.providerDirs = "/c";
    EXPECT_THAT(findProviderDirectories(settings, around), ElementsAre("/a", "/b"));
}

TEST_F(Installation, theEnvironmentListsDirectories)
{
    Surroundings around = surroundings();
    around.providerDirs = "/c::/d:";
    EXPECT_THAT(findProviderDirectories(settings, around), ElementsAre("/c", "/d"));
}

TEST_F(Installation, providersAreInTheInstalledTree)
{
    const std::string directory = tree.folder("x/" CIMHOST_PROVIDERDIR_FROM_BIN);
    const std::string built = tree.folder("x/../lib");
    Surroundings around = surroundings();
    around.programDirectory = tree.folder("x");
    EXPECT_THAT(findProviderDirectories(settings, around), ElementsAre(normal(directory)));
}

TEST_F(Installation, providersAreInTheBuildTree)
{
    const std::string directory = tree.folder("lib");
    EXPECT_THAT(findProviderDirectories(settings, surroundings()), ElementsAre(directory));
}

TEST_F(Installation, thereMayBeNoProviderDirectory)
{
    EXPECT_THAT(findProviderDirectories(settings, surroundings()), IsEmpty());
}

TEST_F(Installation, theCommandLinesRegistrationsComeFirst)
{
    settings.registrationFiles = {"a.reg"};
    Surroundings around = surroundings();
    around.registrationFiles = "b.reg";
    EXPECT_THAT(findRegistrationFiles(settings, around), ElementsAre("a.reg"));
}

TEST_F(Installation, theEnvironmentListsRegistrations)
{
    Surroundings around = surroundings();
    around.registrationFiles = "b.reg:c.reg";
    EXPECT_THAT(findRegistrationFiles(settings, around), ElementsAre("b.reg", "c.reg"));
}

TEST_F(Installation, registrationsAreInTheInstalledTree)
{
    const Surroundings around = surroundings();
    const std::string second = tree.file("bin/" CIMHOST_SCHEMADIR_FROM_BIN "/b.reg", "");
    const std::string first = tree.file("bin/" CIMHOST_SCHEMADIR_FROM_BIN "/a.reg", "");
    const std::string other = tree.file("bin/" CIMHOST_SCHEMADIR_FROM_BIN "/a.mof", "");
    const std::string built = tree.file("schema/c.reg", "");
    EXPECT_THAT(findRegistrationFiles(settings, around), ElementsAre(normal(first), normal(second)));
}

TEST_F(Installation, registrationsAreInTheBuildTree)
{
    const std::string file = tree.file("schema/c.reg", "");
    EXPECT_THAT(findRegistrationFiles(settings, surroundings()), ElementsAre(normal(file)));
}

TEST_F(Installation, withoutRegistrationsNothingCanBeDone)
{
    EXPECT_THROW(findRegistrationFiles(settings, surroundings()), UsageError);
    const std::string empty = tree.folder("schema");
    try {
        findRegistrationFiles(settings, surroundings());
        FAIL() << empty;
    } catch (const UsageError& error) {
        EXPECT_THAT(error.what(), HasSubstr("--registration or CIMHOST_REGISTRATION"));
    }
}

TEST_F(Installation, theCommandLinesSchemaComesFirstThenThatOfTheEnvironment)
{
    Surroundings around = surroundings();
    around.schemaFiles = "b.mof:c.mof";
    EXPECT_THAT(findSchemaFiles(settings, around), ElementsAre("b.mof", "c.mof"));
    settings.schemaFiles = {"a.mof"};
    EXPECT_THAT(findSchemaFiles(settings, around), ElementsAre("a.mof"));
}

TEST_F(Installation, theSchemaIsInTheInstalledTree)
{
    EXPECT_THAT(findSchemaFiles(settings, surroundings()), IsEmpty());
    const std::string folder = "bin/" CIMHOST_SCHEMADIR_FROM_BIN;
    const std::string second = tree.file(folder + "/b.mof", "");
    const std::string first = tree.file(folder + "/a.mof", "");
    const std::string other = tree.file(folder + "/a.reg", "");
    const std::string brokers = tree.file(folder + "/cimhost/a.mof", "");
    EXPECT_THAT(findSchemaFiles(settings, surroundings()),
                ElementsAre(normal(first), normal(second), normal(brokers)));
}

TEST_F(Installation, classesOfSeveralFilesAddUp)
{
    const std::string first = tree.file("a.mof", "class A : B {}; instance of A {};");
    const std::string second = tree.file("b.mof", "class B {};");
    EXPECT_TRUE(readClasses({first, second}).isA("A", "B"));
    EXPECT_THROW(readClasses({first, second, tree.file("c.mof", "class a {};")}), schema::MofError);
}

std::string section(const std::string& className, const std::string& provider)
{
    return "[" + className + "]\n provider: " + provider +
           "\n location: L\n type: instance\n namespace: root/cimv2\n#\n";
}

std::string errorOfRegistrations(const std::vector<std::string>& files)
{
    try {
        readRegistrations(files);
        return "no error";
    } catch (const RegistrationError& error) {
        return error.what();
    }
}

TEST_F(Installation, registrationsOfSeveralFilesAddUp)
{
    const Registration all =
        readRegistrations({tree.file("a.reg", section("CIM_A", "P")),
                           tree.file("b.reg", section("CIM_B", "P") + section("CIM_A", "Q"))});
    ASSERT_EQ(all.classes.size(), 3U);
    EXPECT_EQ(all.classes[0].className, "CIM_A");
    EXPECT_EQ(all.classes[1].className, "CIM_B");
    EXPECT_EQ(all.classes[2].provider, "Q");
}

TEST_F(Installation, aClassAndProviderMayNotBeInTwoFiles)
{
    const std::string first = tree.file("a.reg", section("CIM_A", "P"));
    const std::string second = tree.file("b.reg", section("cim_a", "P"));
    EXPECT_EQ(errorOfRegistrations({first, second}),
              second + ": [cim_a] is registered with the provider P in another file already");
}

TEST_F(Installation, aRegistrationHasAClass)
{
    const std::string full = tree.file("a.reg", section("CIM_A", "P"));
    const std::string empty = tree.file("b\x1b.reg", "# nothing\n");
    EXPECT_EQ(errorOfRegistrations({full, empty}),
              "no class is registered in " + tree.path().string() + "/b\\x001B.reg");
}

TEST_F(Installation, namesOfFilesAreShownPrintably)
{
    const std::string first = tree.file("a.reg", section("CIM_A", "P"));
    const std::string second = tree.file("\x1b.reg", section("CIM_A", "P"));
    EXPECT_THAT(errorOfRegistrations({first, second}), HasSubstr("/\\x001B.reg: [CIM_A]"));
}

} // namespace
