// The six entry points, the function tables and the operations with a fixed answer, and what every operation
// does without a broker.

#include "EntryPoints.h"
#include "testing/ProviderFixture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace EntryPointsTests {

using ::testing::IsEmpty;

namespace {

using CreateInstanceMI = CMPIInstanceMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
using CreateAssociationMI = CMPIAssociationMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

template <class Create>
struct Provider
{
    Create create;
    const char* miName;
};

using InstanceProvider = Provider<CreateInstanceMI>;
using AssociationProvider = Provider<CreateAssociationMI>;

template <class Create>
void PrintTo(const Provider<Create>& provider, std::ostream* stream)
{
    *stream << provider.miName;
}

class InstanceProviders : public ProviderFixture, public ::testing::WithParamInterface<InstanceProvider>
{
protected:
    CMPIInstanceMI* mi = GetParam().create(host.cmpiBroker(), ctx(), nullptr);
};

class AssociationProviders : public ProviderFixture, public ::testing::WithParamInterface<AssociationProvider>
{
protected:
    CMPIAssociationMI* mi = GetParam().create(host.cmpiBroker(), ctx(), nullptr);
};

INSTANTIATE_TEST_SUITE_P(Every, InstanceProviders,
                         ::testing::Values(InstanceProvider{&GlimmarkProfileProvider_Create_InstanceMI,
                                                            "instanceGlimmarkProfileProvider"},
                                           InstanceProvider{&GlimmarkCapabilitiesProvider_Create_InstanceMI,
                                                            "instanceGlimmarkCapabilitiesProvider"},
                                           InstanceProvider{
                                               &GlimmarkElementCapabilitiesProvider_Create_InstanceMI,
                                               "instanceGlimmarkElementCapabilitiesProvider"},
                                           InstanceProvider{&GlimmarkSystemDeviceProvider_Create_InstanceMI,
                                                            "instanceGlimmarkSystemDeviceProvider"}));

INSTANTIATE_TEST_SUITE_P(
    Every, AssociationProviders,
    ::testing::Values(AssociationProvider{&GlimmarkElementCapabilitiesProvider_Create_AssociationMI,
                                          "associationGlimmarkElementCapabilitiesProvider"},
                      AssociationProvider{&GlimmarkSystemDeviceProvider_Create_AssociationMI,
                                          "associationGlimmarkSystemDeviceProvider"}));

void expectFixedAnswer(const CMPIStatus& status, CMPIrc code)
{
    EXPECT_EQ(status.rc, code);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_THAT(Logged::lines(), IsEmpty());
}

} // namespace

TEST_P(InstanceProviders, HaveATableOfVersion200WithTheirName)
{
    ASSERT_NE(mi, nullptr);
    EXPECT_EQ(mi->hdl, nullptr);
    EXPECT_EQ(mi->ft->ftVersion, 200);
    EXPECT_EQ(mi->ft->miVersion, 200);
    EXPECT_STREQ(mi->ft->miName, GetParam().miName);
}

TEST_P(InstanceProviders, AreMadeWithoutACallAndWithoutAWord)
{
    CMPIStatus status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    EXPECT_EQ(GetParam().create(host.cmpiBroker(), ctx(), &status), mi)
        << "one record, whenever it is asked for";
    EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_THAT(broker.calls(), IsEmpty());
    EXPECT_THAT(Logged::lines(), IsEmpty());
}

TEST_P(InstanceProviders, AnswerWhatChangesSomethingWithNotSupported)
{
    const CMPIInstanceMIFT& table = *mi->ft;
    const CMPIObjectPath* const path = ref("TAVRO_Glimmark", {{"DeviceID", "a"}});
    const CMPIInstance* const instance = request->instance({});
    const auto notSupported = CMPI_RC_ERR_NOT_SUPPORTED;
    expectFixedAnswer(table.createInstance(mi, ctx(), rslt(), path, instance), notSupported);
    expectFixedAnswer(table.modifyInstance(mi, ctx(), rslt(), path, instance, nullptr), notSupported);
    expectFixedAnswer(table.deleteInstance(mi, ctx(), rslt(), path), notSupported);
    expectFixedAnswer(table.execQuery(mi, ctx(), rslt(), path, "select * from x", "WQL"), notSupported);
    EXPECT_THAT(broker.calls(), IsEmpty());
}

TEST_P(InstanceProviders, AnswerWhatChangesSomethingWhateverTheArguments)
{
    const CMPIInstanceMIFT& table = *mi->ft;
    const auto notSupported = CMPI_RC_ERR_NOT_SUPPORTED;
    expectFixedAnswer(table.createInstance(nullptr, nullptr, nullptr, nullptr, nullptr), notSupported);
    expectFixedAnswer(table.modifyInstance(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr),
                      notSupported);
    expectFixedAnswer(table.deleteInstance(nullptr, nullptr, nullptr, nullptr), notSupported);
    expectFixedAnswer(table.execQuery(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr), notSupported);
}

TEST_P(InstanceProviders, HaveNothingToCleanUp)
{
    for (const CMPIBoolean terminating : {CMPIBoolean{0}, CMPIBoolean{1}})
        expectFixedAnswer(mi->ft->cleanup(mi, ctx(), terminating), CMPI_RC_OK);
    EXPECT_THAT(broker.calls(), IsEmpty());
}

TEST_P(InstanceProviders, FollowNoNullPointer)
{
    MadeInventory::set({{"a", "1"}});
    const CMPIInstanceMIFT& table = *mi->ft;
    table.enumerateInstanceNames(nullptr, nullptr, nullptr, nullptr);
    table.enumerateInstances(nullptr, nullptr, nullptr, nullptr, nullptr);
    const CMPIStatus status = table.getInstance(nullptr, nullptr, nullptr, nullptr, nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED) << "a null path has no keys";
}

TEST_P(InstanceProviders, WithoutABrokerReportAMissingKeyWithoutAMessage)
{
    mi = GetParam().create(nullptr, nullptr, nullptr);
    const CMPIStatus status = mi->ft->getInstance(mi, ctx(), rslt(), ref("TAVRO_Glimmark"), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_THAT(broker.calls({"newString", "trace"}), IsEmpty());
}

TEST_P(InstanceProviders, WithoutABrokerReturnNothing)
{
    MadeInventory::set({{"a", "1"}, {"b", "2"}});
    mi = GetParam().create(nullptr, nullptr, nullptr);
    const CMPIObjectPath* const path = ref("TAVRO_Glimmark", {{"DeviceID", "a:/1"}});
    mi->ft->enumerateInstanceNames(mi, ctx(), rslt(), path);
    mi->ft->enumerateInstances(mi, ctx(), rslt(), path, nullptr);
    mi->ft->getInstance(mi, ctx(), rslt(), path, nullptr);
    const auto answered = answer({CMPI_RC_OK, nullptr});
    EXPECT_THAT(answered.paths, IsEmpty());
    EXPECT_THAT(answered.instances, IsEmpty());
    EXPECT_THAT(broker.calls({"newString", "newObjectPath", "trace"}), IsEmpty());
}

TEST_P(InstanceProviders, TakeTheNewerBroker)
{
    GetParam().create(nullptr, nullptr, nullptr);
    mi = GetParam().create(host.cmpiBroker(), nullptr, nullptr);
    const CMPIStatus status = mi->ft->getInstance(mi, ctx(), rslt(), ref("TAVRO_Glimmark"), nullptr);
    EXPECT_EQ(message(status), "At least one key should be passed");
}

TEST_P(AssociationProviders, HaveATableOfVersion200WithTheirName)
{
    ASSERT_NE(mi, nullptr);
    EXPECT_EQ(mi->hdl, nullptr);
    EXPECT_EQ(mi->ft->ftVersion, 200);
    EXPECT_EQ(mi->ft->miVersion, 200);
    EXPECT_STREQ(mi->ft->miName, GetParam().miName);
}

TEST_P(AssociationProviders, AreMadeWithoutACallAndWithoutAWord)
{
    CMPIStatus status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    EXPECT_EQ(GetParam().create(host.cmpiBroker(), ctx(), &status), mi);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_THAT(broker.calls(), IsEmpty());
    EXPECT_THAT(Logged::lines(), IsEmpty());
}

TEST_P(AssociationProviders, HaveNothingToCleanUp)
{
    for (const CMPIBoolean terminating : {CMPIBoolean{0}, CMPIBoolean{1}})
        expectFixedAnswer(mi->ft->cleanup(mi, ctx(), terminating), CMPI_RC_OK);
}

TEST_P(AssociationProviders, FollowNoNullPointer)
{
    MadeInventory::set({{"a", "1"}});
    const CMPIAssociationMIFT& table = *mi->ft;
    table.associators(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr);
    table.associatorNames(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr);
    table.references(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr);
    const CMPIStatus status = table.referenceNames(nullptr, nullptr, nullptr, nullptr, nullptr, nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED) << "a null path has no class to start from";
}

TEST_P(AssociationProviders, WithoutABrokerReportFailuresWithoutAMessage)
{
    mi = GetParam().create(nullptr, nullptr, nullptr);
    const CMPIObjectPath* const path = ref("TAVRO_Glimmark", {{"DeviceID", "a:/1"}});
    const CMPIStatus references = mi->ft->references(mi, ctx(), rslt(), path, nullptr, nullptr, nullptr);
    EXPECT_EQ(references.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(references.msg, nullptr);
    const CMPIStatus names = mi->ft->referenceNames(mi, ctx(), rslt(), path, nullptr, nullptr);
    EXPECT_EQ(names.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(names.msg, nullptr);
    EXPECT_THAT(broker.calls({"newString", "newObjectPath", "trace"}), IsEmpty());
}

} // namespace EntryPointsTests
