// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The bounds that connections share, without sockets.

#include "host/http/Connections.h"
#include "host/http/UnsentObjects.h"
#include "host/http/WorkSlots.h"

#include <gtest/gtest.h>

#include <atomic>
#include <mutex>
#include <thread>
#include <vector>

namespace HttpTests {

namespace {

TEST(ConnectionsTest, AreNotTooManyHoweverManyAddThem)
{
    Host::Http::Limits limits;
    limits.maximumConnections = 20;
    Host::Http::Connections connections(limits);
    const Host::Http::Address client("127.0.0.1", 0);
    std::mutex mutex;
    std::vector<Host::Http::ClientConnection*> added;
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            for (int n = 0; n < 50; ++n)
                if (auto* const connection = connections.add(-1, client, nullptr)) {
                    const std::lock_guard lock(mutex);
                    added.push_back(connection);
                }
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(added.size(), 20U);
    for (auto* const connection : added)
        connections.remove(*connection);
    EXPECT_NE(connections.add(-1, client, nullptr), nullptr);
}

TEST(UnsentObjectsTest, AreBoundedButForOneAnswerThatIsAlone)
{
    Host::Http::UnsentObjects unsent(10);
    {
        const auto large = unsent.hold(100);
        EXPECT_NE(large, nullptr);
        EXPECT_EQ(unsent.hold(1), nullptr);
        EXPECT_NE(unsent.hold(0), nullptr);
    }
    const auto one = unsent.hold(4);
    auto other = unsent.hold(6);
    EXPECT_NE(other, nullptr);
    EXPECT_EQ(unsent.hold(1), nullptr);
    other.reset();
    EXPECT_EQ(unsent.hold(7), nullptr);
    EXPECT_NE(unsent.hold(6), nullptr);
}

TEST(WorkSlotsTest, ServeThoseWhoWaitAndRefuseMore)
{
    Host::Http::WorkSlots slots(1, 2);
    auto first = slots.take();
    std::atomic<int> served = 0;
    std::atomic<int> refused = 0;
    std::vector<std::jthread> others;
    for (int i = 0; i < 3; ++i)
        others.emplace_back([&] { ++(slots.take() ? served : refused); });
    while (refused == 0)
        std::this_thread::yield();
    EXPECT_EQ(served, 0);
    first.reset();
    others.clear();
    EXPECT_EQ(served, 2);
    EXPECT_EQ(refused, 1);
    EXPECT_NE(slots.take(), nullptr);
}

} // namespace

} // namespace HttpTests
