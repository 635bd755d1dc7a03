// A broker that lets any single call fail, in any way: no operation may crash, leak or return anything but a
// status that somebody set, and the next request is whole.

#include "EntryPoints.h"
#include "support/ProviderFixture.h"

#include <functional>
#include <iostream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using ::testing::AnyOf;
using ::testing::IsEmpty;

namespace {

constexpr auto glimmark = "TAVRO_Glimmark";
constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";
constexpr auto computerSystem = "TAVRO_ComputerSystem";
constexpr auto elementCapabilities = "TAVRO_GlimmarkElementCapabilities";
constexpr auto systemDevice = "TAVRO_GlimmarkSystemDevice";

class FailingBroker;

struct Operation
{
    std::string name;
    std::function<CMPIStatus(FailingBroker&)> run;
};

void PrintTo(const Operation& operation, std::ostream* stream)
{
    *stream << operation.name;
}

class FailingBroker : public ProviderFixture, public ::testing::WithParamInterface<Operation>
{
public:
    FailingBroker()
    {
        MadeInventory::set({{"a", "1", 1, 1}, {"b", "2", 20, 3}});
        setComputerSystems({"one", "two"});
    }

    CMPIObjectPath* path(const std::string& className, const std::string& key = "",
                         const std::string& value = "")
    {
        if (key.empty())
            return ref(className);
        return ref(className, {{key, value}});
    }

    CMPIStatus names(CMPIInstanceMI* mi, const CMPIObjectPath* classPath)
    {
        return mi->ft->enumerateInstanceNames(mi, ctx(), rslt(), classPath);
    }
    CMPIStatus instances(CMPIInstanceMI* mi, const CMPIObjectPath* classPath)
    {
        return mi->ft->enumerateInstances(mi, ctx(), rslt(), classPath, nullptr);
    }
    CMPIStatus get(CMPIInstanceMI* mi, const CMPIObjectPath* instancePath)
    {
        return mi->ft->getInstance(mi, ctx(), rslt(), instancePath, nullptr);
    }
    CMPIStatus traverse(CMPIAssociationMI* mi, int operation, const CMPIObjectPath* from,
                        const char* assocClass)
    {
        switch (operation) {
        case 0:
            return mi->ft->associators(mi, ctx(), rslt(), from, assocClass, nullptr, nullptr, nullptr,
                                       nullptr);
        case 1:
            return mi->ft->associatorNames(mi, ctx(), rslt(), from, assocClass, nullptr, nullptr, nullptr);
        case 2:
            return mi->ft->references(mi, ctx(), rslt(), from, nullptr, nullptr, nullptr);
        default:
            return mi->ft->referenceNames(mi, ctx(), rslt(), from, nullptr, nullptr);
        }
    }

    CMPIInstanceMI* glimmarks()
    {
        return GlimmarkProfileProvider_Create_InstanceMI(host.cmpiBroker(), ctx(), nullptr);
    }
    CMPIInstanceMI* capability()
    {
        return GlimmarkCapabilitiesProvider_Create_InstanceMI(host.cmpiBroker(), ctx(), nullptr);
    }
    CMPIInstanceMI* elements()
    {
        return GlimmarkElementCapabilitiesProvider_Create_InstanceMI(host.cmpiBroker(), ctx(), nullptr);
    }
    CMPIInstanceMI* devices()
    {
        return GlimmarkSystemDeviceProvider_Create_InstanceMI(host.cmpiBroker(), ctx(), nullptr);
    }
    CMPIAssociationMI* elementsTraversal()
    {
        return GlimmarkElementCapabilitiesProvider_Create_AssociationMI(host.cmpiBroker(), ctx(), nullptr);
    }
    CMPIAssociationMI* devicesTraversal()
    {
        return GlimmarkSystemDeviceProvider_Create_AssociationMI(host.cmpiBroker(), ctx(), nullptr);
    }

    /// The calls of one whole request of its own.
    std::vector<std::string> request()
    {
        newRequest();
        RecordedLog::clear();
        GetParam().run(*this);
        return broker.calls();
    }
};

std::vector<Operation> allOperations()
{
    std::vector<Operation> all = {
        {"Glimmark_EnumInstanceNames", [](auto& t) { return t.names(t.glimmarks(), t.path(glimmark)); }},
        {"Glimmark_EnumInstances", [](auto& t) { return t.instances(t.glimmarks(), t.path(glimmark)); }},
        {"Glimmark_GetInstance_ByIdentifier",
         [](auto& t) { return t.get(t.glimmarks(), t.path(glimmark, "DeviceID", "b:/2")); }},
        {"Glimmark_GetInstance_ByPath",
         [](auto& t) { return t.get(t.glimmarks(), t.path(glimmark, "Name", "b")); }},
        {"Glimmark_GetInstance_WithoutKeys", [](auto& t) { return t.get(t.glimmarks(), t.path(glimmark)); }},
        {"Capabilities_EnumInstanceNames",
         [](auto& t) { return t.names(t.capability(), t.path(capabilities)); }},
        {"Capabilities_EnumInstances",
         [](auto& t) { return t.instances(t.capability(), t.path(capabilities)); }},
        {"Capabilities_GetInstance_ByIdentifier",
         [](auto& t) {
             return t.get(t.capability(), t.path(capabilities, "InstanceID", "TAVRO:GlimmarkCapabilities1"));
         }},
        {"Capabilities_GetInstance_ByPath",
         [](auto& t) { return t.get(t.capability(), t.path(capabilities, "Name", "x")); }},
        {"ElementCapabilities_EnumInstanceNames",
         [](auto& t) { return t.names(t.elements(), t.path(elementCapabilities)); }},
        {"ElementCapabilities_EnumInstances",
         [](auto& t) { return t.instances(t.elements(), t.path(elementCapabilities)); }},
        {"ElementCapabilities_GetInstance",
         [](auto& t) { return t.get(t.elements(), t.path(elementCapabilities, "ManagedElement", "x")); }},
        {"SystemDevice_EnumInstanceNames",
         [](auto& t) { return t.names(t.devices(), t.path(systemDevice)); }},
        {"SystemDevice_EnumInstances",
         [](auto& t) { return t.instances(t.devices(), t.path(systemDevice)); }},
        {"SystemDevice_GetInstance",
         [](auto& t) { return t.get(t.devices(), t.path(systemDevice, "PartComponent", "x")); }},
    };
    const std::vector<std::string> traversals{"Associators", "AssociatorNames", "References",
                                              "ReferenceNames"};
    for (int i = 0; i < 4; ++i) {
        const std::string& traversal = traversals[static_cast<std::size_t>(i)];
        for (const char* from : {glimmark, capabilities})
            all.push_back({"ElementCapabilities_" + traversal + "_From_" + from, [i, from](auto& t) {
                               return t.traverse(t.elementsTraversal(), i, t.path(from, "Name", "x"),
                                                 elementCapabilities);
                           }});
        for (const char* from : {glimmark, computerSystem})
            all.push_back({"SystemDevice_" + traversal + "_From_" + from, [i, from](auto& t) {
                               return t.traverse(t.devicesTraversal(), i, t.path(from, "Name", "x"),
                                                 systemDevice);
                           }});
    }
    return all;
}

INSTANTIATE_TEST_SUITE_P(Every, FailingBroker, ::testing::ValuesIn(allOperations()),
                         [](const auto& suite) { return suite.param.name; });

} // namespace

TEST_P(FailingBroker, BringsNoOperationDown)
{
    const std::vector<std::string> whole = request();
    ASSERT_THAT(whole, ::testing::Not(IsEmpty()));
    int runs = 0;
    for (const Failure failure : {Failure::nullResult, Failure::noHandle, Failure::errorStatus,
                                  Failure::wrongValue, Failure::nullState, Failure::lostHandle}) {
        for (std::size_t nth = 1; nth <= whole.size(); ++nth) {
            newRequest();
            RecordedLog::clear();
            broker.fail("", static_cast<int>(nth), failure);
            const CMPIStatus status = GetParam().run(*this);
            const auto text = message(status);
            EXPECT_THAT(status.rc, AnyOf(CMPI_RC_OK, CMPI_RC_ERR_FAILED, CMPI_RC_ERR_INVALID_NAMESPACE,
                                         CMPI_RC_ERR_NOT_FOUND, CMPI_RC_ERR_INVALID_HANDLE,
                                         CMPI_RC_ERR_INVALID_PARAMETER))
                << whole[nth - 1] << ", which failed; " << text.value_or("no message");
            ASSERT_GE(broker.calls().size(), nth);
            EXPECT_EQ(broker.calls()[nth - 1], whole[nth - 1])
                << "what comes before a failure is not changed by it";
            EXPECT_EQ(MadeInventory::openCursors(), 0);
            Logged::lines(); // each line whole and given twice
            ++runs;
        }
    }
    EXPECT_EQ(request(), whole) << "the next request is whole";
    std::cout << runs << " runs with one failing call each\n";
    RecordProperty("runs", runs);
}
