// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// POSIX threads as they are. Nothing here keeps an exception from passing: ending or
// cancelling a thread unwinds its stack with one.

#include "host/broker/Tables.h"

#include <pthread.h>

#include <cerrno>
#include <ctime>
#include <memory>
#include <new>
#include <type_traits>

namespace Host {

namespace {

static_assert(std::is_same_v<pthread_once_t, int>);
static_assert(std::is_same_v<pthread_key_t, unsigned int>);
static_assert(sizeof(pthread_t) == sizeof(void*));

pthread_t threadOf(void* handle)
{
    return reinterpret_cast<pthread_t>(handle);
}

// Library names are the provider's to know.
char* resolveFileName(const char*)
{
    return nullptr;
}

void* newThread(CMPIThreadFunc function, void* parameter, int isDetached)
{
    pthread_t thread{};
    if (function == nullptr || pthread_create(&thread, nullptr, function, parameter) != 0)
        return nullptr;
    if (isDetached != 0)
        pthread_detach(thread);
    return reinterpret_cast<void*>(thread);
}

int joinThread(void* thread, void** returned)
{
    return thread == nullptr ? ESRCH : pthread_join(threadOf(thread), returned);
}

int exitThread(void* returned)
{
    pthread_exit(returned);
}

int cancelThread(void* thread)
{
    return thread == nullptr ? ESRCH : pthread_cancel(threadOf(thread));
}

int threadSleep(CMPIUint32 milliseconds)
{
    const timespec duration{static_cast<time_t>(milliseconds / 1000),
        static_cast<long>(milliseconds % 1000) * 1'000'000};
    return nanosleep(&duration, nullptr);
}

int threadOnce(int* once, CMPIThreadOnceFunc function)
{
    return once == nullptr || function == nullptr ? EINVAL : pthread_once(once, function);
}

int createThreadKey(unsigned int* key, CMPIThreadKeyCleanupFunc cleanup)
{
    return key == nullptr ? EINVAL : pthread_key_create(key, cleanup);
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

struct Attributes {
    explicit Attributes(bool isRecursive)
    {
        pthread_mutexattr_init(&value);
        pthread_mutexattr_settype(
            &value, isRecursive ? PTHREAD_MUTEX_RECURSIVE : PTHREAD_MUTEX_NORMAL);
    }
    ~Attributes() { pthread_mutexattr_destroy(&value); }
    Attributes(const Attributes&) = delete;
    Attributes& operator=(const Attributes&) = delete;

    pthread_mutexattr_t value{};
};

struct Mutex {
    explicit Mutex(bool isRecursive)
    {
        const Attributes attributes(isRecursive);
        pthread_mutex_init(&value, &attributes.value);
    }
    ~Mutex() { pthread_mutex_destroy(&value); }
    Mutex(const Mutex&) = delete;
    Mutex& operator=(const Mutex&) = delete;

    pthread_mutex_t value{};
};

struct Condition {
    Condition() { pthread_cond_init(&value, nullptr); }
    ~Condition() { pthread_cond_destroy(&value); }
    Condition(const Condition&) = delete;
    Condition& operator=(const Condition&) = delete;

    pthread_cond_t value{};
};

// Handed to the provider, which gives it back to a destroy function.
template <typename T, typename... Arguments>
void* makeOwned(Arguments... arguments)
{
    try {
        return std::make_unique<T>(arguments...).release();
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

template <typename T>
void destroy(void* owned)
{
    std::unique_ptr<T>(static_cast<T*>(owned)).reset();
}

void* newMutex(int isRecursive)
{
    return makeOwned<Mutex>(isRecursive != 0);
}

void lockMutex(void* mutex)
{
    if (mutex != nullptr)
        pthread_mutex_lock(&static_cast<Mutex*>(mutex)->value);
}

void unlockMutex(void* mutex)
{
    if (mutex != nullptr)
        pthread_mutex_unlock(&static_cast<Mutex*>(mutex)->value);
}

void* newCondition(int)
{
    return makeOwned<Condition>();
}

int condWait(void* condition, void* mutex)
{
    if (condition == nullptr || mutex == nullptr)
        return EINVAL;
    return pthread_cond_wait(
        &static_cast<Condition*>(condition)->value, &static_cast<Mutex*>(mutex)->value);
}

// Until a time of the real-time clock.
int timedCondWait(void* condition, void* mutex, timespec* until)
{
    if (condition == nullptr || mutex == nullptr || until == nullptr)
        return EINVAL;
    return pthread_cond_timedwait(
        &static_cast<Condition*>(condition)->value, &static_cast<Mutex*>(mutex)->value, until);
}

// Wakes one waiter.
int signalCondition(void* condition)
{
    return condition == nullptr ? EINVAL
                                : pthread_cond_signal(&static_cast<Condition*>(condition)->value);
}

} // namespace

const CMPIBrokerExtFT operatingSystemFunctions = {
    .ftVersion = CMPIVersion200,
    .resolveFileName = &resolveFileName,
    .newThread = &newThread,
    .joinThread = &joinThread,
    .exitThread = &exitThread,
    .cancelThread = &cancelThread,
    .threadSleep = &threadSleep,
    .threadOnce = &threadOnce,
    .createThreadKey = &createThreadKey,
    .destroyThreadKey = &destroyThreadKey,
    .getThreadSpecific = &getThreadSpecific,
    .setThreadSpecific = &setThreadSpecific,
    .newMutex = &newMutex,
    .destroyMutex = &destroy<Mutex>,
    .lockMutex = &lockMutex,
    .unlockMutex = &unlockMutex,
    .newCondition = &newCondition,
    .destroyCondition = &destroy<Condition>,
    .condWait = &condWait,
    .timedCondWait = &timedCondWait,
    .signalCondition = &signalCondition,
};

} // namespace Host
