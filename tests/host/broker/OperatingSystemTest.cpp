// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Threads, mutexes and conditions of the broker.

#include "tests/host/broker/BrokerTest.h"

#include <pthread.h>

#include <cerrno>
#include <ctime>

namespace HostTests {

class OperatingSystemTest : public BrokerTest {
protected:
    const CMPIBrokerExtFT& os = *mb->xft;
};

TEST_F(OperatingSystemTest, RunsAThreadAndJoinsIt)
{
    int parameter = 1;
    void* const thread = os.newThread(
        [](void* given) -> void* {
            *static_cast<int*>(given) = 2;
            return given;
        },
        &parameter, 0);
    ASSERT_NE(thread, nullptr);
    void* returned = nullptr;
    EXPECT_EQ(os.joinThread(thread, &returned), 0);
    EXPECT_EQ(returned, &parameter);
    EXPECT_EQ(parameter, 2);
}

TEST_F(OperatingSystemTest, AThreadCanEndItself)
{
    struct Given {
        const CMPIBrokerExtFT& os;
        bool isUnwound;
    } given{os, false};
    void* const thread = os.newThread(
        [](void* parameter) -> void* {
            struct Unwinding {
                ~Unwinding() { given->isUnwound = true; }
                Given* given;
            } unwinding{static_cast<Given*>(parameter)};
            unwinding.given->os.exitThread(parameter);
            return nullptr;
        },
        &given, 0);
    void* returned = nullptr;
    EXPECT_EQ(os.joinThread(thread, &returned), 0);
    EXPECT_EQ(returned, &given);
    EXPECT_TRUE(given.isUnwound);
}

TEST_F(OperatingSystemTest, AThreadCanBeCancelled)
{
    void* const thread = os.newThread(
        [](void* parameter) -> void* {
            for (;;)
                static_cast<const CMPIBrokerExtFT*>(parameter)->threadSleep(1);
        },
        const_cast<CMPIBrokerExtFT*>(&os), 0);
    EXPECT_EQ(os.cancelThread(thread), 0);
    void* returned = nullptr;
    EXPECT_EQ(os.joinThread(thread, &returned), 0);
    EXPECT_EQ(returned, PTHREAD_CANCELED);
}

TEST_F(OperatingSystemTest, MutexesExclude)
{
    struct Given {
        const CMPIBrokerExtFT& os;
        void* mutex;
        int count;
    } given{os, os.newMutex(0), 0};
    const auto work = [](void* parameter) -> void* {
        auto& shared = *static_cast<Given*>(parameter);
        for (int i = 0; i < 1000; ++i) {
            shared.os.lockMutex(shared.mutex);
            ++shared.count;
            shared.os.unlockMutex(shared.mutex);
        }
        return nullptr;
    };
    void* const first = os.newThread(work, &given, 0);
    void* const second = os.newThread(work, &given, 0);
    os.joinThread(first, nullptr);
    os.joinThread(second, nullptr);
    EXPECT_EQ(given.count, 2000);
    os.destroyMutex(given.mutex);
}

TEST_F(OperatingSystemTest, ARecursiveMutexCanBeLockedTwice)
{
    void* const mutex = os.newMutex(1);
    os.lockMutex(mutex);
    os.lockMutex(mutex);
    os.unlockMutex(mutex);
    os.unlockMutex(mutex);
    os.destroyMutex(mutex);
}

TEST_F(OperatingSystemTest, ConditionsWake)
{
    struct Given {
        const CMPIBrokerExtFT& os;
        void* mutex;
        void* condition;
        bool isReady;
    } given{os, os.newMutex(0), os.newCondition(0), false};
    void* const thread = os.newThread(
        [](void* parameter) -> void* {
            auto& shared = *static_cast<Given*>(parameter);
            shared.os.lockMutex(shared.mutex);
            shared.isReady = true;
            shared.os.signalCondition(shared.condition);
            shared.os.unlockMutex(shared.mutex);
            return nullptr;
        },
        &given, 0);
    os.lockMutex(given.mutex);
    while (!given.isReady)
        EXPECT_EQ(os.condWait(given.condition, given.mutex), 0);
    os.unlockMutex(given.mutex);
    os.joinThread(thread, nullptr);
    os.destroyCondition(given.condition);
    os.destroyMutex(given.mutex);
}

TEST_F(OperatingSystemTest, WaitingEndsAtItsTime)
{
    void* const mutex = os.newMutex(0);
    void* const condition = os.newCondition(0);
    timespec past{1, 0};
    os.lockMutex(mutex);
    EXPECT_EQ(os.timedCondWait(condition, mutex, &past), ETIMEDOUT);
    os.unlockMutex(mutex);
    os.destroyCondition(condition);
    os.destroyMutex(mutex);
}

TEST_F(OperatingSystemTest, ThreadKeysHoldAValuePerThread)
{
    unsigned key = 0;
    int value = 0;
    ASSERT_EQ(os.createThreadKey(&key, nullptr), 0);
    EXPECT_EQ(os.getThreadSpecific(key), nullptr);
    EXPECT_EQ(os.setThreadSpecific(key, &value), 0);
    EXPECT_EQ(os.getThreadSpecific(key), &value);
    EXPECT_EQ(os.destroyThreadKey(key), 0);
}

TEST_F(OperatingSystemTest, OnceIsOnce)
{
    static int runs = 0;
    static int once = 0;
    runs = once = 0;
    EXPECT_EQ(os.threadOnce(&once, [] { ++runs; }), 0);
    EXPECT_EQ(os.threadOnce(&once, [] { ++runs; }), 0);
    EXPECT_EQ(runs, 1);
}

TEST_F(OperatingSystemTest, SurvivesNothing)
{
    EXPECT_EQ(os.resolveFileName("library"), nullptr);
    EXPECT_EQ(os.newThread(nullptr, nullptr, 0), nullptr);
    EXPECT_EQ(os.joinThread(nullptr, nullptr), ESRCH);
    EXPECT_EQ(os.cancelThread(nullptr), ESRCH);
    EXPECT_EQ(os.threadSleep(0), 0);
    EXPECT_EQ(os.threadOnce(nullptr, nullptr), EINVAL);
    EXPECT_EQ(os.createThreadKey(nullptr, nullptr), EINVAL);
    os.lockMutex(nullptr);
    os.unlockMutex(nullptr);
    os.destroyMutex(nullptr);
    os.destroyCondition(nullptr);
    EXPECT_EQ(os.condWait(nullptr, nullptr), EINVAL);
    EXPECT_EQ(os.timedCondWait(nullptr, nullptr, nullptr), EINVAL);
    EXPECT_EQ(os.signalCondition(nullptr), EINVAL);
}

} // namespace HostTests
