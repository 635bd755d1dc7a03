// What the operations make of answers that the factory of today never gives: getting all instances with a
// result other than 0, and instances where it collects none. Two functions of the factory stand here in the
// place of the library's, whose calls the loader binds to those of the executable.

#include "GlimmarkFactory.h"
#include "support/Operations.h"
#include "support/ProviderFixture.h"

#include "cim/Values.h"

#include <algorithm>
#include <functional>
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

} // namespace Tavro::GlimmarkProvider

namespace {

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

    static Operation operation()
    {
        const auto all = allOperations();
        return *std::find_if(all.begin(), all.end(),
                             [](const Operation& one) { return one.name == GetParam(); });
    }
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

} // namespace

TEST_P(OperationsOfAFailingFactory, EndAtOnceWithTheirStatus)
{
    getInstances = failWithOneInstance;
    const Outcome outcome = ask(host, operation());
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
    const auto all = allOperations();
    const auto search = std::find_if(all.begin(), all.end(), [](const Operation& one) {
        return one.name == "TAVRO_GlimmarkCapabilities_GetInstance_ByPath";
    });
    ASSERT_NE(search, all.end());
    const Outcome outcome = ask(host, *search);
    EXPECT_EQ(outcome.answer.instances.size(), 2U);
    EXPECT_EQ(outcome.doneCount, 1);
}
