// Requests from several threads, and threads of a provider's own.

#include "BrokerFixture.h"

#include <atomic>
#include <thread>

namespace cimhost {

namespace {

TEST(ThreadsTest, RequestsRunSideBySide)
{
    std::atomic<int> traces{0};
    Broker broker(sampleRegistration({"Thing", "Asking", "Refusing"}), {SAMPLE_DIRECTORY},
                  {[&](const TraceRecord&) { ++traces; }, {}, {}});
    std::vector<std::thread> threads;
    threads.reserve(4);
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            for (int j = 0; j < 200; ++j) {
                EXPECT_EQ(broker.enumerateInstanceNames(classPath("TEST_Asking")).paths.size(), 2U);
                EXPECT_EQ(broker.getInstance(thingPath("one")).instances.size(), 1U);
                EXPECT_EQ(broker.enumerateInstanceNames(classPath("TEST_Refusing")).status.code,
                          CMPI_RC_ERR_FAILED);
            }
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(traces, 1); // set up once
}

TEST(ThreadsTest, ListenersAreCalledOneAtATime)
{
    int misuses = 0;
    Broker broker({}, {}, {{}, {}, [&](const std::string&) { ++misuses; }});
    std::vector<std::thread> threads;
    threads.reserve(4);
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            const Request request(broker);
            for (int j = 0; j < 1000; ++j)
                broker.tables().string.getCharPtr(nullptr, nullptr);
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(misuses, 4000);
}

TEST(ThreadsTest, LastingObjectsMayBeMadeAndReadAnywhere)
{
    Broker broker({}, {});
    const CMPIBroker* const mb = broker.cmpiBroker();
    CMPIObjectPath* const shared = mb->eft->newObjectPath(mb, testNameSpace, "TEST_Thing", nullptr);
    std::vector<std::thread> threads;
    threads.reserve(4);
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            for (int j = 0; j < 500; ++j) {
                CMPIString* const string = shared->ft->getClassName(shared, nullptr);
                EXPECT_STREQ(string->ft->getCharPtr(string, nullptr), "TEST_Thing");
                CMPIObjectPath* const copy = shared->ft->clone(shared, nullptr);
                EXPECT_EQ(copy->ft->setNameSpace(copy, "root/mine"), CMPI_RC_OK);
                EXPECT_EQ(copy->ft->release(copy), CMPI_RC_OK);
            }
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(read(shared), classPath("TEST_Thing"));
}

class AttachTest : public RequestFixture
{};

TEST_F(AttachTest, AnAttachedThreadHasARequestOfItsOwn)
{
    CMPIContext* const context = mb()->bft->prepareAttachThread(mb(), request_.context());
    ASSERT_NE(context, nullptr);
    EXPECT_EQ(context->ft->getEntryCount(context, nullptr), 2U);
    CMPIString* string = nullptr;
    std::thread([&] {
        EXPECT_EQ(mb()->bft->attachThread(mb(), context), CMPI_RC_OK);
        string = newString("text");
        EXPECT_EQ(read(string), "text");
        EXPECT_EQ(mb()->bft->detachThread(mb(), context), CMPI_RC_OK);
        EXPECT_EQ(read(string), std::nullopt);
    }).join();
    expectNoMisuse();
}

TEST_F(AttachTest, TheEndOfAThreadDetachesIt)
{
    CMPIContext* const context = mb()->bft->prepareAttachThread(mb(), request_.context());
    CMPIString* string = nullptr;
    std::thread([&] {
        EXPECT_EQ(mb()->bft->attachThread(mb(), context), CMPI_RC_OK);
        string = newString("text");
    }).join();
    EXPECT_EQ(read(string), std::nullopt);
}

TEST_F(AttachTest, RefusesAThreadThatIsInARequest)
{
    CMPIContext* const context = mb()->bft->prepareAttachThread(mb(), request_.context());
    EXPECT_EQ(mb()->bft->attachThread(mb(), context), CMPI_RC_ERR_FAILED);
    expectMisuse("CMPIBrokerFT.attachThread: the thread is in a request already");
    EXPECT_EQ(mb()->bft->detachThread(mb(), context), CMPI_RC_ERR_FAILED);
    expectMisuse("CMPIBrokerFT.detachThread: the thread is not attached");
    std::thread([&] {
        EXPECT_EQ(mb()->bft->detachThread(mb(), context), CMPI_RC_ERR_FAILED);
        EXPECT_EQ(mb()->bft->attachThread(mb(), context), CMPI_RC_OK);
        EXPECT_EQ(mb()->bft->attachThread(mb(), context), CMPI_RC_ERR_FAILED);
    }).join();
}

TEST_F(AttachTest, NeedsAContext)
{
    EXPECT_EQ(mb()->bft->prepareAttachThread(mb(), nullptr), nullptr);
    expectMisuse("CMPIBrokerFT.prepareAttachThread: the context is null");
    EXPECT_EQ(mb()->bft->attachThread(mb(), nullptr), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerFT.attachThread: the context is null");
}

} // namespace

} // namespace cimhost
