// The function tables as a layer over the broker sees them.

#include "BrokerFixture.h"

#include <cstring>

namespace cimhost {

namespace {

TEST(TablesTest, HaveNoEmptySlot)
{
    Broker broker({}, {});
    const auto expectFull = [](const auto& table, std::size_t slotsFrom) {
        const auto* const bytes = reinterpret_cast<const unsigned char*>(&table);
        for (std::size_t offset = slotsFrom; offset < sizeof table; offset += sizeof(void*)) {
            const void* slot = nullptr;
            std::memcpy(&slot, bytes + offset, sizeof slot);
            EXPECT_NE(slot, nullptr) << "at offset " << offset << " of a table of " << sizeof table;
        }
    };
    const FunctionTables& tables = broker.tables();
    expectFull(tables.broker, 8); // after capabilities and version
    expectFull(tables.enc, 8);
    expectFull(tables.ext, 8);
    expectFull(tables.mem, 8);
    expectFull(tables.context, 8);
    expectFull(tables.result, 8);
    expectFull(tables.string, 8);
    expectFull(tables.array, 8);
    expectFull(tables.enumeration, 8);
    expectFull(tables.instance, 8);
    expectFull(tables.objectPath, 8);
    expectFull(tables.args, 8);
    expectFull(tables.dateTime, 8);
    expectFull(tables.error, 8);
    for (const CMPIVersion version :
         {tables.enc.ftVersion, tables.ext.ftVersion, tables.mem.ftVersion, tables.context.ftVersion,
          tables.result.ftVersion, tables.string.ftVersion, tables.array.ftVersion,
          tables.enumeration.ftVersion, tables.instance.ftVersion, tables.objectPath.ftVersion,
          tables.args.ftVersion, tables.dateTime.ftVersion, tables.error.ftVersion})
        EXPECT_EQ(version, 200);
}

// A layer that counts; slots are plain functions, and so are its own.

FunctionTables original;
std::vector<std::string> calls;

CMPIString* countedNewString(const CMPIBroker* broker, const char* text, CMPIStatus* rc)
{
    calls.push_back(std::string("newString ") + text);
    return original.enc.newString(broker, text, rc);
}

CMPIStatus countedAddKey(const CMPIObjectPath* path, const char* name, const CMPIValue* value,
                         const CMPIType type)
{
    calls.push_back(std::string("addKey ") + name);
    return original.objectPath.addKey(path, name, value, type);
}

const char* countedGetCharPtr(const CMPIString* string, CMPIStatus* rc)
{
    calls.emplace_back("getCharPtr");
    return original.string.getCharPtr(string, rc);
}

TEST(TablesTest, ShowALayerTheProvidersCallsOnly)
{
    Broker broker(sampleRegistration({"Thing"}), {SAMPLE_DIRECTORY});
    original = broker.tables();
    calls.clear();
    broker.tables().enc.newString = countedNewString;
    broker.tables().objectPath.addKey = countedAddKey;
    broker.tables().string.getCharPtr = countedGetCharPtr;

    EXPECT_EQ(broker.getInstance(thingPath("four")).status.message, "no such thing");
    // The provider reads the key that it was asked for; the message is read by the broker itself.
    EXPECT_THAT(calls, testing::ElementsAre("getCharPtr", "newString no such thing"));
    calls.clear();
    broker.enumerateInstanceNames(classPath("TEST_Thing"));
    EXPECT_THAT(calls, testing::ElementsAre("getCharPtr", "addKey Name", "getCharPtr", "addKey Name"));
}

CMPIObjectPath* noPath(const CMPIBroker* /*broker*/, const char* /*nameSpace*/, const char* /*className*/,
                       CMPIStatus* /*rc*/)
{
    return nullptr;
}

TEST(TablesTest, LetALayerMakeCallsFail)
{
    Broker broker({}, {});
    broker.tables().enc.newObjectPath = noPath;
    const CMPIBroker* const mb = broker.cmpiBroker();
    EXPECT_EQ(mb->eft->newObjectPath(mb, testNameSpace, "TEST_Thing", nullptr), nullptr);
    Request request(broker);
    EXPECT_NE(request.path(thingPath("one")), nullptr);
}

} // namespace

} // namespace cimhost
