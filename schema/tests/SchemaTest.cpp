// The project's MOF against the rules, and against what the providers answer.

#include "Answers.h"
#include "ProjectClasses.h"
#include "Rules.h"

#include "broker/Broker.h"
#include "testing/Environment.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using cimhost::cim::Answer;
using cimhost::cim::Instance;
using cimhost::cim::ObjectPath;
using cimhost::schema::Class;
using cimhost::schema::Classes;
using Testing::Environment;
using testing::IsEmpty;
using testing::Not;
using testing::UnorderedElementsAre;

std::vector<std::string> classNames()
{
    std::vector<std::string> names;
    for (const Class& declaration : cimhost::schema::projectClasses())
        names.push_back(declaration.name);
    return names;
}

TEST(Schema, HasTheClassesServed)
{
    EXPECT_THAT(classNames(), UnorderedElementsAre("TAVRO_Glimmark", "TAVRO_GlimmarkCapabilities",
                                                   "TAVRO_GlimmarkElementCapabilities",
                                                   "TAVRO_GlimmarkSystemDevice", "TAVRO_ComputerSystem"));
}

TEST(Schema, BuildsOnTheRightSuperclasses)
{
    const Classes classes = cimhost::schema::allClasses();
    EXPECT_EQ(classes.find("TAVRO_Glimmark")->superclass, "CIM_AlarmDevice");
    EXPECT_EQ(classes.find("TAVRO_GlimmarkCapabilities")->superclass, "CIM_AlarmDeviceCapabilities");
    EXPECT_EQ(classes.find("TAVRO_GlimmarkElementCapabilities")->superclass, "CIM_ElementCapabilities");
    EXPECT_EQ(classes.find("TAVRO_GlimmarkSystemDevice")->superclass, "CIM_SystemDevice");
    EXPECT_EQ(classes.find("TAVRO_ComputerSystem")->superclass, "CIM_ComputerSystem");
}

TEST(Schema, AssociatesTheRightClasses)
{
    const Classes classes = cimhost::schema::allClasses();
    const auto typeOf = [&](const char* association, const char* end) {
        return typeText(*findProperty(*classes.find(association), end));
    };
    EXPECT_EQ(typeOf("TAVRO_GlimmarkElementCapabilities", "ManagedElement"), "TAVRO_Glimmark REF");
    EXPECT_EQ(typeOf("TAVRO_GlimmarkElementCapabilities", "Capabilities"), "TAVRO_GlimmarkCapabilities REF");
    EXPECT_EQ(typeOf("TAVRO_GlimmarkSystemDevice", "GroupComponent"), "CIM_ComputerSystem REF");
    EXPECT_EQ(typeOf("TAVRO_GlimmarkSystemDevice", "PartComponent"), "TAVRO_Glimmark REF");
}

/// Each file is compiled with the DMTF schema loaded and nothing else, the stand-in's perhaps never.
TEST(Schema, RefersOnlyToClassesOfItsFileAndOfDmtf)
{
    std::vector<Class> known = cimhost::schema::readMofFile(SUPERCLASSES).classes;
    const std::vector<Class> own =
        cimhost::schema::readMofFile(SCHEMA_DIRECTORY "/TAVRO_Glimmark.mof").classes;
    known.insert(known.end(), own.begin(), own.end());
    const Classes classes(known);
    for (const Class& declaration : own) {
        for (const cimhost::schema::Property& property : declaration.properties) {
            const bool isKnown = !property.isReference || classes.find(property.type) != nullptr;
            EXPECT_TRUE(isKnown) << declaration.name << '.' << property.name;
        }
    }
}

/// The brokers' compilers disagree on the encoding of a file, and on which pragmas there are.
TEST(Schema, IsPlainAsciiWithoutPragmas)
{
    std::vector<std::string> files;
    for (const auto& entry : std::filesystem::directory_iterator(SCHEMA_DIRECTORY)) {
        const std::string extension = entry.path().extension();
        if (extension != ".mof" && extension != ".reg")
            continue;
        files.push_back(entry.path().filename());
        std::ifstream file(entry.path(), std::ios::binary);
        const std::string text{std::istreambuf_iterator<char>(file), {}};
        const bool plain =
            std::all_of(text.begin(), text.end(), [](char c) { return c == '\n' || (c >= ' ' && c <= '~'); });
        EXPECT_TRUE(plain) << entry.path();
        EXPECT_EQ(text.find("#pragma"), std::string::npos) << entry.path();
        EXPECT_THAT(text, testing::EndsWith("\n")) << entry.path();
    }
    EXPECT_THAT(files, UnorderedElementsAre("TAVRO_Glimmark.mof", "TAVRO_ComputerSystem.mof", "glimmark.reg",
                                            "computer-system.reg", "glimmark-pegasus.mof",
                                            "computer-system-pegasus.mof"));
}

class SchemaClass : public testing::TestWithParam<std::string>
{
protected:
    const Classes classes = cimhost::schema::allClasses();
    const Class& declaration = *classes.find(GetParam());
};

TEST_P(SchemaClass, KeepsTheRules)
{
    EXPECT_THAT(breaches(declaration, classes), IsEmpty());
}

/// The real providers and support libraries, on a sample inventory.
class SchemaAnswers : public SchemaClass
{
protected:
    SchemaAnswers() : broker(registration(), {PROVIDER_DIRECTORY}) {}

    void useInventory(const std::string& fileName) const
    {
        inventory.set(INVENTORY_DIRECTORY "/" + fileName);
    }

    cimhost::cim::ObjectPaths paths()
    {
        Answer answer = broker.enumerateInstanceNames(classPath());
        EXPECT_EQ(answer.status.code, CMPI_RC_OK) << answer.status.message.value_or("");
        EXPECT_THAT(answer.paths, Not(IsEmpty()));
        return answer.paths;
    }

    cimhost::cim::Instances instances()
    {
        Answer answer = broker.enumerateInstances(classPath());
        EXPECT_EQ(answer.status.code, CMPI_RC_OK) << answer.status.message.value_or("");
        EXPECT_THAT(answer.instances, Not(IsEmpty()));
        return answer.instances;
    }

    void expectAnswersAsDeclared()
    {
        for (const ObjectPath& path : paths()) {
            EXPECT_THAT(departures(path, declaration, classes), IsEmpty());
            const Answer answer = broker.getInstance(path);
            ASSERT_EQ(answer.instances.size(), 1U);
            EXPECT_THAT(departures(answer.instances.front(), declaration, classes), IsEmpty());
        }
        for (const Instance& instance : instances())
            EXPECT_THAT(departures(instance, declaration, classes), IsEmpty());
    }

private:
    static cimhost::Registration registration()
    {
        cimhost::Registration all = cimhost::readRegistrationFile(SCHEMA_DIRECTORY "/glimmark.reg");
        for (auto& entry : cimhost::readRegistrationFile(SCHEMA_DIRECTORY "/computer-system.reg").classes)
            all.classes.push_back(std::move(entry));
        return all;
    }

    static ObjectPath classPath() { return {"", "root/cimv2", GetParam(), {}}; }

    Environment inventory{"TAVRO_INVENTORY", std::nullopt};
    Environment systems{"TAVRO_COMPUTER_SYSTEMS", std::nullopt};
    cimhost::Broker broker;
};

TEST_P(SchemaAnswers, AreAsDeclaredOnASmallServer)
{
    useInventory("small-server.json");
    expectAnswersAsDeclared();
}

TEST_P(SchemaAnswers, AreAsDeclaredInEdgeCases)
{
    useInventory("edge-cases-readable.json");
    expectAnswersAsDeclared();
}

TEST_P(SchemaAnswers, HaveEveryValueOfTheValueMaps)
{
    // Has indicators of every status and alarm state.
    useInventory("small-server.json");
    EXPECT_THAT(unusedValues(instances(), declaration), IsEmpty());
}

std::string nameOf(const testing::TestParamInfo<std::string>& info)
{
    return info.param;
}

INSTANTIATE_TEST_SUITE_P(Mof, SchemaClass, testing::ValuesIn(classNames()), nameOf);
INSTANTIATE_TEST_SUITE_P(Mof, SchemaAnswers, testing::ValuesIn(classNames()), nameOf);

} // namespace
