// The registration files against the MOF and against the libraries that they name.

#include "ProjectClasses.h"

#include "broker/Registration.h"

#include <set>

#include <dlfcn.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using cimhost::readRegistrationFile;
using cimhost::RegisteredClass;
using cimhost::schema::Class;
using cimhost::schema::Classes;
using testing::ElementsAre;

/// The MOF file of a registration, and the classes in both.
struct RegistrationOf
{
    const char* mof;
    const char* registration;
    const char* location;
};

void PrintTo(const RegistrationOf& pair, std::ostream* stream)
{
    *stream << pair.registration;
}

class Registration : public testing::TestWithParam<RegistrationOf>
{
protected:
    const std::string directory = SCHEMA_DIRECTORY "/";
    const std::vector<RegisteredClass> registered =
        readRegistrationFile(directory + GetParam().registration).classes;
    const std::vector<Class> declared = cimhost::schema::readMofFile(directory + GetParam().mof).classes;
};

TEST_P(Registration, HasEachDeclaredClassOnce)
{
    std::multiset<std::string> registeredNames;
    for (const RegisteredClass& entry : registered)
        registeredNames.insert(entry.className);
    std::multiset<std::string> declaredNames;
    for (const Class& declaration : declared)
        declaredNames.insert(declaration.name);
    EXPECT_EQ(registeredNames, declaredNames);
}

TEST_P(Registration, ServesInstancesAndTraversesAssociations)
{
    const Classes classes(declared);
    for (const RegisteredClass& entry : registered) {
        ASSERT_NE(classes.find(entry.className), nullptr) << entry.className;
        EXPECT_TRUE(entry.instance) << entry.className;
        EXPECT_EQ(entry.association, isAssociation(*classes.find(entry.className))) << entry.className;
    }
}

TEST_P(Registration, IsForTheNamespaceOfTheSchema)
{
    for (const RegisteredClass& entry : registered)
        EXPECT_THAT(entry.nameSpaces, ElementsAre("root/cimv2")) << entry.className;
}

TEST_P(Registration, GivesEachClassAProviderOfItsOwn)
{
    std::set<std::string> providers;
    for (const RegisteredClass& entry : registered) {
        EXPECT_EQ(entry.location, GetParam().location) << entry.className;
        EXPECT_TRUE(providers.insert(entry.provider).second) << entry.provider;
    }
}

TEST_P(Registration, NamesTheEntryPointsThatTheLibraryHas)
{
    const std::string file = std::string(PROVIDER_DIRECTORY "/lib") + GetParam().location + ".so";
    void* const library = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL);
    ASSERT_NE(library, nullptr) << dlerror();
    for (const RegisteredClass& entry : registered) {
        const auto has = [&](const char* suffix) {
            return dlsym(library, (entry.provider + suffix).c_str()) != nullptr;
        };
        EXPECT_EQ(has("_Create_InstanceMI"), entry.instance) << entry.provider;
        EXPECT_EQ(has("_Create_AssociationMI"), entry.association) << entry.provider;
    }
    dlclose(library);
}

INSTANTIATE_TEST_SUITE_P(Files, Registration,
                         testing::Values(RegistrationOf{"TAVRO_Glimmark.mof", "glimmark.reg",
                                                        "GlimmarkProvider"},
                                         RegistrationOf{"TAVRO_ComputerSystem.mof", "computer-system.reg",
                                                        "TavroComputerSystem"}));

} // namespace
