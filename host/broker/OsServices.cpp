#include "broker/Scope.h"
#include "broker/Tables.h"

#include <cerrno>
#include <cstdint>
#include <cstring>
#include <ctime>
#include <memory>
#include <string>
#include <type_traits>

#include <pthread.h>

namespace cimhost {

namespace {

// What the interface calls int, unsigned int and void* is handed to the thread library as it is.
static_assert(std::is_same_v<pthread_once_t, int>);
static_assert(std::is_same_v<pthread_key_t, unsigned int>);
static_assert(std::is_same_v<pthread_t, std::uintptr_t>);

/// Reports an argument that is null but must not be. These services know no broker: the report goes
/// to that of the thread's request, if any.
bool present(const void* argument, const char* service)
{
    Core* const core = Scope::currentCore();
    if (argument == nullptr && core != nullptr)
        core->tellMisuse(std::string("CMPIBrokerExtFT.") + service + ": an argument is null");
    return argument != nullptr;
}

/// The name of a library's file; the caller frees it with free().
char* resolveFileName(const char* libName)
{
    if (!present(libName, "resolveFileName"))
        return nullptr;
    return strdup(("lib" + std::string(libName) + ".so").c_str());
}

pthread_t threadOf(void* thread)
{
    return reinterpret_cast<pthread_t>(thread);
}

void* newThread(CMPIThreadFunc start, void* parm, int detached)
{
    if (!present(reinterpret_cast<const void*>(start), "newThread"))
        return nullptr;
    pthread_attr_t attributes{};
    if (pthread_attr_init(&attributes) != 0)
        return nullptr;
    pthread_attr_setdetachstate(&attributes,
                                detached != 0 ? PTHREAD_CREATE_DETACHED : PTHREAD_CREATE_JOINABLE);
    pthread_t thread{};
    const int error = pthread_create(&thread, &attributes, start, parm);
    pthread_attr_destroy(&attributes);
    // The interface has a pointer where the thread library has a number.
    return error == 0 ? reinterpret_cast<void*>(thread) : nullptr; // NOLINT(performance-no-int-to-ptr)
}

int joinThread(void* thread, void** result)
{
    return present(thread, "joinThread") ? pthread_join(threadOf(thread), result) : EINVAL;
}

int exitThread(void* result)
{
    pthread_exit(result);
}

int cancelThread(void* thread)
{
    return present(thread, "cancelThread") ? pthread_cancel(threadOf(thread)) : EINVAL;
}

int threadSleep(CMPIUint32 milliseconds)
{
    timespec rest{static_cast<std::time_t>(milliseconds / 1000),
                  static_cast<long>(milliseconds % 1000) * 1'000'000};
    while (nanosleep(&rest, &rest) != 0)
        if (errno != EINTR)
            return errno;
    return 0;
}

int threadOnce(int* once, CMPIThreadOnceFunc function)
{
    if (!present(once, "threadOnce") || !present(reinterpret_cast<const void*>(function), "threadOnce"))
        return EINVAL;
    return pthread_once(once, function);
}

int createThreadKey(unsigned int* key, CMPIThreadKeyCleanupFunc cleanup)
{
    return present(key, "createThreadKey") ? pthread_key_create(key, cleanup) : EINVAL;
}

int destroyThreadKey(unsigned int key)
{
    return pthread_key_delete(key);
}

void* getThreadSpecific(unsigned int key)
{
    return pthread_getspecific(key);
}

int setThreadSpecific(unsigned int key, void* value)
{
    return pthread_setspecific(key, value);
}

/// A mutex that its holder may lock again, as the interface has it for any `opt`.
void* newMutex(int /*opt*/)
{
    auto mutex = std::make_unique<pthread_mutex_t>();
    pthread_mutexattr_t attributes{};
    pthread_mutexattr_init(&attributes);
    pthread_mutexattr_settype(&attributes, PTHREAD_MUTEX_RECURSIVE);
    const int error = pthread_mutex_init(mutex.get(), &attributes);
    pthread_mutexattr_destroy(&attributes);
    return error == 0 ? mutex.release() : nullptr;
}

void destroyMutex(void* mutex)
{
    if (!present(mutex, "destroyMutex"))
        return;
    const std::unique_ptr<pthread_mutex_t> owned(static_cast<pthread_mutex_t*>(mutex));
    pthread_mutex_destroy(owned.get());
}

void lockMutex(void* mutex)
{
    if (present(mutex, "lockMutex"))
        pthread_mutex_lock(static_cast<pthread_mutex_t*>(mutex));
}

void unlockMutex(void* mutex)
{
    if (present(mutex, "unlockMutex"))
        pthread_mutex_unlock(static_cast<pthread_mutex_t*>(mutex));
}

void* newCondition(int /*opt*/)
{
    auto condition = std::make_unique<pthread_cond_t>();
    return pthread_cond_init(condition.get(), nullptr) == 0 ? condition.release() : nullptr;
}

void destroyCondition(void* condition)
{
    if (!present(condition, "destroyCondition"))
        return;
    const std::unique_ptr<pthread_cond_t> owned(static_cast<pthread_cond_t*>(condition));
    pthread_cond_destroy(owned.get());
}

int condWait(void* condition, void* mutex)
{
    if (!present(condition, "condWait") || !present(mutex, "condWait"))
        return EINVAL;
    return pthread_cond_wait(static_cast<pthread_cond_t*>(condition), static_cast<pthread_mutex_t*>(mutex));
}

/// \param until  a point in time of the real-time clock
int timedCondWait(void* condition, void* mutex, timespec* until)
{
    if (!present(condition, "timedCondWait") || !present(mutex, "timedCondWait") ||
        !present(until, "timedCondWait"))
        return EINVAL;
    return pthread_cond_timedwait(static_cast<pthread_cond_t*>(condition),
                                  static_cast<pthread_mutex_t*>(mutex), until);
}

int signalCondition(void* condition)
{
    return present(condition, "signalCondition")
               ? pthread_cond_signal(static_cast<pthread_cond_t*>(condition))
               : EINVAL;
}

} // namespace

CMPIBrokerExtFT osServices()
{
    return {servedVersion,     resolveFileName,   newThread,        joinThread,      exitThread,
            cancelThread,      threadSleep,       threadOnce,       createThreadKey, destroyThreadKey,
            getThreadSpecific, setThreadSpecific, newMutex,         destroyMutex,    lockMutex,
            unlockMutex,       newCondition,      destroyCondition, condWait,        timedCondWait,
            signalCondition};
}

} // namespace cimhost
