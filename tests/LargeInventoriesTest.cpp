// Result lists and the list of records are counted with 16 bits. What each operation makes of inventories
// around and beyond that limit: how many paths or instances, which status, and whether it calls returnDone.

#include "testing/Operations.h"
#include "testing/ProviderFixture.h"

#include <algorithm>
#include <cstddef>
#include <map>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace LargeInventoriesTests {

namespace {

#ifdef GLIMMARK_SANITIZED
// Without the size whose answers are the longest: a sanitizer takes minutes for it.
constexpr std::size_t sizes[] = {1, 1'000, 65'536, 65'537};
#else
constexpr std::size_t sizes[] = {1, 1'000, 65'535, 65'536, 65'537, 200'000};
#endif

/// How many records an inventory becomes: its size modulo 65,536.
const std::map<std::size_t, std::size_t> recordsOf{{1, 1},      {1'000, 1'000}, {65'535, 65'535},
                                                   {65'536, 0}, {65'537, 1},    {200'000, 3'392}};

enum class Count
{
    none,
    one,
    oneIfAny, ///< one if there are records at all
    each      ///< one for each record
};

enum class Done
{
    never,
    always,
    ifAny ///< if there are records at all
};

struct Expected
{
    Count paths;
    Count instances;
    Done done;
    CMPIrc code = CMPI_RC_OK;
    CMPIrc codeWithoutRecords = code;
};

const Expected refused{Count::none, Count::none, Done::never, CMPI_RC_ERR_FAILED};
const Expected withoutKeys{Count::none, Count::none, Done::always, CMPI_RC_ERR_FAILED};
const Expected nothing{Count::none, Count::none, Done::always};
const Expected nothingAndNotDone{Count::none, Count::none, Done::never};
const Expected onePath{Count::one, Count::none, Done::never};
const Expected oneInstance{Count::none, Count::one, Done::never};
const Expected eachPath{Count::each, Count::none, Done::never};
const Expected eachInstance{Count::none, Count::each, Done::never};

const std::map<std::string, Expected> expectations{
    {"TAVRO_Glimmark_EnumInstanceNames", {Count::each, Count::none, Done::ifAny}},
    {"TAVRO_Glimmark_EnumInstances", {Count::none, Count::each, Done::always}},
    {"TAVRO_Glimmark_GetInstance_ByIdentifier", {Count::none, Count::oneIfAny, Done::ifAny}},
    // That the key looked for is missing stays the status until another call of the broker succeeds.
    {"TAVRO_Glimmark_GetInstance_ByPath",
     {Count::none, Count::none, Done::always, CMPI_RC_OK, CMPI_RC_ERR_NOT_FOUND}},
    {"TAVRO_Glimmark_GetInstance_WithoutKeys", withoutKeys},

    {"TAVRO_GlimmarkCapabilities_EnumInstanceNames", {Count::one, Count::none, Done::always}},
    {"TAVRO_GlimmarkCapabilities_EnumInstances", {Count::none, Count::one, Done::always}},
    {"TAVRO_GlimmarkCapabilities_GetInstance_ByIdentifier", {Count::none, Count::one, Done::always}},
    {"TAVRO_GlimmarkCapabilities_GetInstance_ByPath",
     {Count::none, Count::none, Done::always, CMPI_RC_ERR_NOT_FOUND}},
    {"TAVRO_GlimmarkCapabilities_GetInstance_WithoutKeys", withoutKeys},

    {"TAVRO_GlimmarkElementCapabilities_EnumInstanceNames", {Count::each, Count::none, Done::ifAny}},
    {"TAVRO_GlimmarkElementCapabilities_EnumInstances", {Count::none, Count::each, Done::always}},
    {"TAVRO_GlimmarkElementCapabilities_GetInstance_ByPath", {Count::none, Count::oneIfAny, Done::always}},
    {"TAVRO_GlimmarkElementCapabilities_GetInstance_OfNothing", nothing},
    {"TAVRO_GlimmarkElementCapabilities_GetInstance_WithoutKeys", withoutKeys},
    // The path of the request need not exist.
    {"TAVRO_GlimmarkElementCapabilities_Associators_From_TAVRO_Glimmark", oneInstance},
    {"TAVRO_GlimmarkElementCapabilities_AssociatorNames_From_TAVRO_Glimmark", onePath},
    {"TAVRO_GlimmarkElementCapabilities_References_From_TAVRO_Glimmark", oneInstance},
    {"TAVRO_GlimmarkElementCapabilities_ReferenceNames_From_TAVRO_Glimmark", onePath},
    {"TAVRO_GlimmarkElementCapabilities_Associators_From_TAVRO_GlimmarkCapabilities", eachInstance},
    {"TAVRO_GlimmarkElementCapabilities_AssociatorNames_From_TAVRO_GlimmarkCapabilities", eachPath},
    {"TAVRO_GlimmarkElementCapabilities_References_From_TAVRO_GlimmarkCapabilities", eachInstance},
    {"TAVRO_GlimmarkElementCapabilities_ReferenceNames_From_TAVRO_GlimmarkCapabilities", eachPath},
    {"TAVRO_GlimmarkElementCapabilities_Associators_From_CIM_AlarmDevice", refused},
    {"TAVRO_GlimmarkElementCapabilities_AssociatorNames_From_CIM_AlarmDevice", refused},
    {"TAVRO_GlimmarkElementCapabilities_References_From_CIM_AlarmDevice", refused},
    {"TAVRO_GlimmarkElementCapabilities_ReferenceNames_From_CIM_AlarmDevice", refused},

    {"TAVRO_GlimmarkSystemDevice_EnumInstanceNames", {Count::each, Count::none, Done::ifAny}},
    {"TAVRO_GlimmarkSystemDevice_EnumInstances", {Count::none, Count::each, Done::always}},
    {"TAVRO_GlimmarkSystemDevice_GetInstance_ByPath", {Count::none, Count::oneIfAny, Done::always}},
    {"TAVRO_GlimmarkSystemDevice_GetInstance_OfNothing", nothing},
    {"TAVRO_GlimmarkSystemDevice_GetInstance_WithoutKeys", withoutKeys},
    {"TAVRO_GlimmarkSystemDevice_Associators_From_TAVRO_Glimmark", oneInstance},
    {"TAVRO_GlimmarkSystemDevice_AssociatorNames_From_TAVRO_Glimmark", onePath},
    {"TAVRO_GlimmarkSystemDevice_References_From_TAVRO_Glimmark", oneInstance},
    {"TAVRO_GlimmarkSystemDevice_ReferenceNames_From_TAVRO_Glimmark", onePath},
    {"TAVRO_GlimmarkSystemDevice_Associators_From_TAVRO_ComputerSystem", eachInstance},
    {"TAVRO_GlimmarkSystemDevice_AssociatorNames_From_TAVRO_ComputerSystem", eachPath},
    {"TAVRO_GlimmarkSystemDevice_References_From_TAVRO_ComputerSystem", eachInstance},
    {"TAVRO_GlimmarkSystemDevice_ReferenceNames_From_TAVRO_ComputerSystem", eachPath},
    {"TAVRO_GlimmarkSystemDevice_Associators_From_CIM_AlarmDevice", nothingAndNotDone},
    {"TAVRO_GlimmarkSystemDevice_AssociatorNames_From_CIM_AlarmDevice", nothingAndNotDone},
    {"TAVRO_GlimmarkSystemDevice_References_From_CIM_AlarmDevice", refused},
    {"TAVRO_GlimmarkSystemDevice_ReferenceNames_From_CIM_AlarmDevice", refused},
};

std::size_t number(Count count, std::size_t records)
{
    switch (count) {
    case Count::none:
        return 0;
    case Count::one:
        return 1;
    case Count::oneIfAny:
        return records > 0 ? 1 : 0;
    case Count::each:
        break;
    }
    return records;
}

int number(Done done, std::size_t records)
{
    return done == Done::always || (done == Done::ifAny && records > 0) ? 1 : 0;
}

/// So many indicators with identifiers of their own, the first of them "b:/2".
std::vector<MadeInventory::Node> indicators(std::size_t count)
{
    std::vector<MadeInventory::Node> nodes{{"b", "2"}};
    nodes.reserve(count);
    while (nodes.size() < count)
        nodes.push_back({"LED", std::to_string(nodes.size())});
    return nodes;
}

Operation operationNamed(const std::string& name)
{
    const std::vector<Operation> all = allOperations();
    return *std::find_if(all.begin(), all.end(),
                         [&](const Operation& operation) { return operation.name == name; });
}

class LargeInventories : public ProviderFixture
{
protected:
    LargeInventories()
    {
        setComputerSystems({"one"});
        RecordedLog::keep(false);
    }
    ~LargeInventories() override { RecordedLog::keep(true); }

    /// Of the broker without the recording layer.
    Outcome ask(const Operation& operation) { return ::ask(plain, operation); }

    cimhost::Broker plain{computerSystemRegistration(), {providerDirectory()}};
};

class LargeInventoriesOf : public LargeInventories, public ::testing::WithParamInterface<Operation>
{};

INSTANTIATE_TEST_SUITE_P(All, LargeInventoriesOf, ::testing::ValuesIn(allOperations()),
                         [](const auto& suite) { return suite.param.name; });

} // namespace

TEST_P(LargeInventoriesOf, AreCountedWith16Bits)
{
    const Expected& expected = expectations.at(GetParam().name);
    for (const std::size_t size : sizes) {
        SCOPED_TRACE(std::to_string(size) + " indicators");
        MadeInventory::set(indicators(size));
        const auto [answer, doneCount] = ask(GetParam());
        const std::size_t records = recordsOf.at(size);
        EXPECT_EQ(answer.paths.size(), number(expected.paths, records));
        EXPECT_EQ(answer.instances.size(), number(expected.instances, records));
        EXPECT_EQ(answer.status.code, records > 0 ? expected.code : expected.codeWithoutRecords);
        EXPECT_EQ(doneCount, number(expected.done, records));
    }
}

TEST_F(LargeInventories, AreCountedForEachComputerSystemOfTheNames)
{
    // The list of the first system goes on with the second: 66,000 entries, of which 464 are walked.
    setComputerSystems({"one", "two"});
    MadeInventory::set(indicators(33'000));
    EXPECT_EQ(ask(operationNamed("TAVRO_GlimmarkSystemDevice_EnumInstanceNames")).answer.paths.size(),
              33'464U);
    // The list of all instances is cut where it is returned.
    EXPECT_EQ(ask(operationNamed("TAVRO_GlimmarkSystemDevice_EnumInstances")).answer.instances.size(), 464U);
}

} // namespace LargeInventoriesTests
