// The services of the operating system.

#include "BrokerFixture.h"

#include <atomic>
#include <cerrno>
#include <chrono>
#include <cstdlib>

#include <pthread.h>

namespace cimhost {

namespace {

class OsTest : public RequestFixture
{
protected:
    const CMPIBrokerExtFT& xft_ = *mb()->xft;
};

void* answer(void* parm)
{
    return parm;
}

TEST_F(OsTest, NamesLibraries)
{
    char* const name = xft_.resolveFileName("Thing");
    EXPECT_STREQ(name, "libThing.so");
    std::free(name);
    EXPECT_EQ(xft_.resolveFileName(nullptr), nullptr);
    expectMisuse("CMPIBrokerExtFT.resolveFileName: an argument is null");
}

TEST_F(OsTest, RunsThreads)
{
    void* const thread = xft_.newThread(answer, this, 0);
    ASSERT_NE(thread, nullptr);
    void* result = nullptr;
    EXPECT_EQ(xft_.joinThread(thread, &result), 0);
    EXPECT_EQ(result, this);
}

TEST_F(OsTest, EndsThreads)
{
    static const CMPIBrokerExtFT* services = nullptr;
    services = &xft_;
    void* const leaving = xft_.newThread(
        [](void* parm) -> void* {
            services->exitThread(parm);
            return nullptr;
        },
        this, 0);
    void* result = nullptr;
    EXPECT_EQ(xft_.joinThread(leaving, &result), 0);
    EXPECT_EQ(result, this);

    // Its functions keep nothing on the stack: a cancelled thread leaves the address sanitizer's marks
    // of such things behind.
    void* const waiting = xft_.newThread(
        [](void*) -> void* {
            for (;;)
                pthread_testcancel();
        },
        nullptr, 0);
    EXPECT_EQ(xft_.cancelThread(waiting), 0);
    EXPECT_EQ(xft_.joinThread(waiting, &result), 0);
}

TEST_F(OsTest, DetachesThreads)
{
    static std::atomic<bool> done{false};
    done = false;
    ASSERT_NE(xft_.newThread(
                  [](void*) -> void* {
                      done = true;
                      return nullptr;
                  },
                  nullptr, 1),
              nullptr);
    while (!done)
        xft_.threadSleep(1);
}

TEST_F(OsTest, Sleeps)
{
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(xft_.threadSleep(20), 0);
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(20));
}

TEST_F(OsTest, RunsThingsOnce)
{
    static int runs = 0;
    static int once = 0;
    for (int i = 0; i < 2; ++i)
        EXPECT_EQ(xft_.threadOnce(&once, [] { ++runs; }), 0);
    EXPECT_EQ(runs, 1);
}

TEST_F(OsTest, KeepsValuesOfThreads)
{
    static unsigned int key = 0;
    static int cleaned = 0;
    ASSERT_EQ(xft_.createThreadKey(&key, [](void*) { ++cleaned; }), 0);
    EXPECT_EQ(xft_.getThreadSpecific(key), nullptr);
    EXPECT_EQ(xft_.setThreadSpecific(key, this), 0);
    EXPECT_EQ(xft_.getThreadSpecific(key), this);

    static const CMPIBrokerExtFT* services = nullptr;
    services = &xft_;
    void* const thread = xft_.newThread(
        [](void* parm) -> void* {
            void* const before = services->getThreadSpecific(key);
            services->setThreadSpecific(key, parm);
            return before;
        },
        this, 0);
    void* result = this;
    xft_.joinThread(thread, &result);
    EXPECT_EQ(result, nullptr);
    EXPECT_EQ(cleaned, 1);
    EXPECT_EQ(xft_.setThreadSpecific(key, nullptr), 0);
    EXPECT_EQ(xft_.destroyThreadKey(key), 0);
}

/// What two threads of the tests share.
struct Shared
{
    const CMPIBrokerExtFT* services;
    void* mutex;
    void* condition;
    int count;
};

TEST_F(OsTest, LocksMutexes)
{
    Shared shared{&xft_, xft_.newMutex(0), nullptr, 0};
    const auto work = [](void* parm) -> void* {
        auto& own = *static_cast<Shared*>(parm);
        for (int i = 0; i < 1000; ++i) {
            own.services->lockMutex(own.mutex);
            own.services->lockMutex(own.mutex); // its holder may
            ++own.count;
            own.services->unlockMutex(own.mutex);
            own.services->unlockMutex(own.mutex);
        }
        return nullptr;
    };
    void* const first = xft_.newThread(work, &shared, 0);
    void* const second = xft_.newThread(work, &shared, 0);
    xft_.joinThread(first, nullptr);
    xft_.joinThread(second, nullptr);
    EXPECT_EQ(shared.count, 2000);
    xft_.destroyMutex(shared.mutex);
}

TEST_F(OsTest, WaitsForConditions)
{
    Shared shared{&xft_, xft_.newMutex(0), xft_.newCondition(0), 0};
    void* const thread = xft_.newThread(
        [](void* parm) -> void* {
            auto& own = *static_cast<Shared*>(parm);
            own.services->lockMutex(own.mutex);
            own.count = 1;
            own.services->signalCondition(own.condition);
            own.services->unlockMutex(own.mutex);
            return nullptr;
        },
        &shared, 0);
    xft_.lockMutex(shared.mutex);
    while (shared.count == 0)
        EXPECT_EQ(xft_.condWait(shared.condition, shared.mutex), 0);
    xft_.unlockMutex(shared.mutex);
    xft_.joinThread(thread, nullptr);

    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    xft_.lockMutex(shared.mutex);
    EXPECT_EQ(xft_.timedCondWait(shared.condition, shared.mutex, &now), ETIMEDOUT);
    xft_.unlockMutex(shared.mutex);
    xft_.destroyCondition(shared.condition);
    xft_.destroyMutex(shared.mutex);
}

TEST_F(OsTest, ReportsNullArguments)
{
    timespec now{};
    void* const mutex = xft_.newMutex(0);
    const auto expectReport = [&](const char* service) {
        expectMisuse(std::string("CMPIBrokerExtFT.") + service + ": an argument is null");
    };
    EXPECT_EQ(xft_.newThread(nullptr, nullptr, 0), nullptr);
    expectReport("newThread");
    EXPECT_EQ(xft_.joinThread(nullptr, nullptr), EINVAL);
    expectReport("joinThread");
    EXPECT_EQ(xft_.cancelThread(nullptr), EINVAL);
    expectReport("cancelThread");
    EXPECT_EQ(xft_.threadOnce(nullptr, [] {}), EINVAL);
    expectReport("threadOnce");
    EXPECT_EQ(xft_.createThreadKey(nullptr, nullptr), EINVAL);
    expectReport("createThreadKey");
    xft_.lockMutex(nullptr);
    expectReport("lockMutex");
    xft_.unlockMutex(nullptr);
    expectReport("unlockMutex");
    xft_.destroyMutex(nullptr);
    expectReport("destroyMutex");
    xft_.destroyCondition(nullptr);
    expectReport("destroyCondition");
    EXPECT_EQ(xft_.condWait(nullptr, mutex), EINVAL);
    expectReport("condWait");
    EXPECT_EQ(xft_.timedCondWait(nullptr, mutex, &now), EINVAL);
    expectReport("timedCondWait");
    EXPECT_EQ(xft_.signalCondition(nullptr), EINVAL);
    expectReport("signalCondition");
    xft_.destroyMutex(mutex);
}

} // namespace

} // namespace cimhost
