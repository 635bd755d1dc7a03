// What the operations make of answers that the factory of today never gives: instances beside a result other
// than 0, instances of another class, lists with null pointers. Functions of the factory stand here in the
// place of the library's: in the build of it that this program is run with, the loader binds the library's calls
// to those of the executable.

#include "GlimmarkFactory.h"
#include "testing/Operations.h"
#include "testing/ProviderFixture.h"

#include "cim/Values.h"

#include <algorithm>
#include <functional>
#include <stdexcept>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using ::testing::Contains;
using ::testing::IsEmpty;
using ::testing::StartsWith;

namespace {

/// What stands for getting the instances of either class, one or all.
using GetInstances =
    std::function<int(const CMPIBroker*, const CMPIObjectPath*, std::vector<CMPIInstance*>&, CMPIStatus*)>;
GetInstances getInstances;

/// What stands for getting the paths of all indicators.
std::function<int(const CMPIBroker*, const CMPIObjectPath*, std::vector<CMPIObjectPath*>&)> getPaths;

} // namespace

namespace Tavro::GlimmarkProvider {

int GlimmarkFactory::getAllGlimmarkCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                 const char** /*properties*/, bool /*isObjPath*/,
                                                 std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const
{
    return getInstances(broker, ref, instances, rc);
}

int GlimmarkFactory::getAllGlimmarkCapabilitiesCMPIInstances(const CMPIBroker* broker,
                                                             const CMPIObjectPath* ref,
                                                             const char** /*properties*/, bool /*isObjPath*/,
                                                             std::vector<CMPIInstance*>& instances,
                                                             CMPIStatus* rc) const
{
    return getInstances(broker, ref, instances, rc);
}

int GlimmarkFactory::getOneGlimmarkCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                CMPIString* /*key*/, const char** /*properties*/,
                                                std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const
{
    return getInstances(broker, ref, instances, rc);
}

int GlimmarkFactory::getOneGlimmarkCapabilitiesCMPIInstance(const CMPIBroker* broker,
                                                            const CMPIObjectPath* ref, CMPIString* /*key*/,
                                                            const char** /*properties*/,
                                                            std::vector<CMPIInstance*>& instances,
                                                            CMPIStatus* rc) const
{
    return getInstances(broker, ref, instances, rc);
}

int GlimmarkFactory::getAllGlimmarkCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                std::vector<CMPIObjectPath*>& paths, CMPIStatus* /*rc*/) const
{
    return getPaths(broker, ref, paths);
}

} // namespace Tavro::GlimmarkProvider

namespace {

Operation operationCalled(const std::string& name)
{
    const auto all = allOperations();
    const auto found =
        std::find_if(all.begin(), all.end(), [&](const Operation& one) { return one.name == name; });
    return found != all.end() ? *found : throw std::invalid_argument("There is no operation " + name);
}

CMPIInstance* instanceAt(const CMPIBroker* broker, const CMPIObjectPath* path)
{
    return broker->eft->newInstance(broker, path, nullptr);
}

int failWithOneInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                        std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    instances.push_back(instanceAt(broker, ref));
    *rc = {CMPI_RC_ERR_FAILED, nullptr};
    return 2;
}

class OperationsOfAFailingFactory : public ProviderFixture, public ::testing::WithParamInterface<const char*>
{
protected:
    OperationsOfAFailingFactory() { MadeInventory::set({{"b", "2"}}); }
    ~OperationsOfAFailingFactory() override { getInstances = nullptr; }
};

INSTANTIATE_TEST_SUITE_P(
    ThatGetInstances, OperationsOfAFailingFactory,
    ::testing::Values("TAVRO_Glimmark_EnumInstances", "TAVRO_Glimmark_GetInstance_ByIdentifier",
                      "TAVRO_Glimmark_GetInstance_ByPath", "TAVRO_GlimmarkCapabilities_EnumInstances",
                      "TAVRO_GlimmarkCapabilities_GetInstance_ByIdentifier",
                      "TAVRO_GlimmarkCapabilities_GetInstance_ByPath",
                      "TAVRO_GlimmarkElementCapabilities_Associators_From_TAVRO_Glimmark",
                      "TAVRO_GlimmarkElementCapabilities_Associators_From_"
                      "TAVRO_GlimmarkCapabilities",
                      "TAVRO_GlimmarkSystemDevice_Associators_From_TAVRO_ComputerSystem"),
    [](const auto& tested) { return std::string(tested.param); });

class CapabilitiesOfAnotherFactory : public ProviderFixture
{
protected:
    ~CapabilitiesOfAnotherFactory() override { getInstances = nullptr; }
};

class TraversalsFromAComputerSystem : public ProviderFixture,
                                      public ::testing::WithParamInterface<const char*>
{
protected:
    TraversalsFromAComputerSystem()
    {
        getPaths = [](const CMPIBroker* maker, const CMPIObjectPath* /*ref*/,
                      std::vector<CMPIObjectPath*>& paths) {
            paths = {nullptr, maker->eft->newObjectPath(maker, "root/cimv2", "TAVRO_Glimmark", nullptr),
                     nullptr};
            return 0;
        };
    }
    ~TraversalsFromAComputerSystem() override { getPaths = nullptr; }
};

} // namespace

TEST_P(OperationsOfAFailingFactory, EndAtOnceWithTheirStatus)
{
    getInstances = failWithOneInstance;
    const Outcome outcome = ask(host, operationCalled(GetParam()));
    EXPECT_EQ(outcome.answer.status.code, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(outcome.answer.instances, IsEmpty());
    EXPECT_EQ(outcome.doneCount, 0);
    // The operation's own is the first line; it has no EXITING line.
    const auto lines = Logged::flow();
    ASSERT_THAT(lines, Contains(StartsWith("ENTERING ")));
    const std::string name = lines.front().substr(std::string("ENTERING ").size());
    EXPECT_THAT(lines, ::testing::Not(Contains("EXITING " + name)));
}

// The alarm device provider stops at the first.
TEST_F(CapabilitiesOfAnotherFactory, AreReturnedForEachMatchOfTheWholePath)
{
    getInstances = [](const CMPIBroker* maker, const CMPIObjectPath* ref,
                      std::vector<CMPIInstance*>& instances, CMPIStatus* /*rc*/) {
        const auto* const other = maker->eft->newObjectPath(maker, "root/cimv2", "TAVRO_Other", nullptr);
        instances = {instanceAt(maker, ref), nullptr, instanceAt(maker, other), instanceAt(maker, ref)};
        return 0;
    };
    const Outcome outcome = ask(host, operationCalled("TAVRO_GlimmarkCapabilities_GetInstance_ByPath"));
    EXPECT_EQ(outcome.answer.instances.size(), 2U);
    EXPECT_EQ(outcome.doneCount, 1);
}

INSTANTIATE_TEST_SUITE_P(
    OverPaths, TraversalsFromAComputerSystem,
    ::testing::Values("TAVRO_GlimmarkSystemDevice_AssociatorNames_From_TAVRO_ComputerSystem",
                      "TAVRO_GlimmarkSystemDevice_References_From_TAVRO_ComputerSystem",
                      "TAVRO_GlimmarkSystemDevice_ReferenceNames_From_TAVRO_ComputerSystem"),
    [](const auto& tested) { return std::string(tested.param); });

TEST_P(TraversalsFromAComputerSystem, PassOverNullPointers)
{
    const Outcome outcome = ask(host, operationCalled(GetParam()));
    EXPECT_EQ(outcome.answer.status.code, CMPI_RC_OK);
    EXPECT_EQ(outcome.answer.paths.size() + outcome.answer.instances.size(), 1U);
}
