// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The bounds that connections share, without sockets.

#include "host/http/Connections.h"
#include "host/http/UnsentObjects.h"
#include "host/http/WorkSlots.h"
#include "platform/utilities/Descriptor.h"

#include <gtest/gtest.h>

#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <mutex>
#include <thread>
#include <vector>

namespace HttpTests {

namespace {

using Host::Http::ClientConnection;
using Host::Http::Connections;
using Host::Http::Phase;

const Host::Http::Address someAddress("127.0.0.1", 0);

TEST(ConnectionsTest, AreNotTooManyHoweverManyAddThem)
{
    Host::Http::Limits limits;
    limits.maximumConnections = 20;
    Connections connections(limits);
    std::mutex mutex;
    std::vector<ClientConnection*> added;
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            for (int n = 0; n < 50; ++n)
                if (auto* const connection = connections.add(-1, someAddress, nullptr)) {
                    connections.enter(*connection, Phase::receiving);
                    const std::lock_guard lock(mutex);
                    added.push_back(connection);
                }
        });
    for (std::thread& thread : threads)
        thread.join();
    // The request of one may have begun just after it made room for another one.
    EXPECT_EQ(std::ranges::count(added, false, &ClientConnection::isLeaving), 20);
    EXPECT_EQ(connections.add(-1, someAddress, nullptr), nullptr);
    for (auto* const connection : added)
        connections.remove(*connection);
    EXPECT_NE(connections.add(-1, someAddress, nullptr), nullptr);
}

TEST(ConnectionsTest, MakeRoomFirstWhereTheyHadTheLeastUse)
{
    Host::Http::Limits limits;
    limits.maximumConnections = 6;
    Connections connections(limits);
    const auto add = [&](const std::vector<Phase>& phases) {
        ClientConnection* const connection = connections.add(-1, someAddress, nullptr);
        for (const Phase phase : phases)
            connections.enter(*connection, phase);
        return connection;
    };
    const std::vector<Phase> operation{
        Phase::receiving, Phase::working, Phase::answering, Phase::idle};
    auto* const operated = add(operation);
    auto* const operatedLater = add(operation);
    auto* const fetched = add({Phase::receiving, Phase::working, Phase::fetching, Phase::idle});
    auto* const silent = add({});
    auto* const silentLater = add({});
    for (auto* const each : {silent, silentLater})
        each->deadline -= std::chrono::seconds(3);
    const auto* const busy = add({Phase::receiving});
    for (const auto* const each : {silent, silentLater, fetched, operated, operatedLater}) {
        EXPECT_FALSE(each->isLeaving);
        EXPECT_NE(add({Phase::receiving}), nullptr);
        EXPECT_TRUE(each->isLeaving);
    }
    EXPECT_EQ(connections.add(-1, someAddress, nullptr), nullptr);
    EXPECT_FALSE(busy->isLeaving);
}

TEST(ConnectionsTest, NewOneStaysWhereAnotherIsIdle)
{
    Host::Http::Limits limits;
    limits.maximumConnections = 2;
    Connections connections(limits);
    ClientConnection* const operated = connections.add(-1, someAddress, nullptr);
    connections.enter(*operated, Phase::answering);
    connections.enter(*operated, Phase::idle);
    const auto* const added = connections.add(-1, someAddress, nullptr);
    EXPECT_NE(connections.add(-1, someAddress, nullptr), nullptr);
    EXPECT_TRUE(operated->isLeaving);
    EXPECT_FALSE(added->isLeaving);
    EXPECT_NE(connections.add(-1, someAddress, nullptr), nullptr);
    EXPECT_TRUE(added->isLeaving);
}

TEST(ConnectionsTest, RequestThatArrivesTooSlowlyMakesRoomBeforeNewOnes)
{
    Host::Http::Limits limits;
    limits.maximumConnections = 3;
    Connections connections(limits);
    ClientConnection* const slow = connections.add(-1, someAddress, nullptr);
    connections.enter(*slow, Phase::receiving);
    slow->deadline -= std::chrono::seconds(3);
    ClientConnection* const operated = connections.add(-1, someAddress, nullptr);
    connections.enter(*operated, Phase::answering);
    connections.enter(*operated, Phase::idle);
    const auto* const added = connections.add(-1, someAddress, nullptr);
    for (const auto* const each : {operated, slow}) {
        EXPECT_FALSE(each->isLeaving);
        connections.enter(*connections.add(-1, someAddress, nullptr), Phase::receiving);
        EXPECT_TRUE(each->isLeaving);
    }
    EXPECT_FALSE(added->isLeaving);
}

TEST(ConnectionsTest, RequestThatHasYetToBeReadKeepsItsConnection)
{
    std::array<int, 2> sockets{};
    ASSERT_EQ(::socketpair(AF_UNIX, SOCK_STREAM, 0, sockets.data()), 0);
    const Vorn::Descriptor first(sockets[0]);
    const Vorn::Descriptor second(sockets[1]);
    Host::Http::Limits limits;
    limits.maximumConnections = 1;
    Connections connections(limits);
    const auto* const added = connections.add(first.number(), someAddress, nullptr);
    ASSERT_EQ(::write(second.number(), "P", 1), 1);
    EXPECT_EQ(connections.add(-1, someAddress, nullptr), nullptr);
    EXPECT_FALSE(added->isLeaving);
    char byte = 0;
    ASSERT_EQ(::read(first.number(), &byte, 1), 1);
    EXPECT_NE(connections.add(-1, someAddress, nullptr), nullptr);
    EXPECT_TRUE(added->isLeaving);
}

TEST(ConnectionsTest, AddressWithTooManyMakesRoomAmongItsOwn)
{
    Host::Http::Limits limits;
    limits.maximumConnections = 3;
    limits.maximumConnectionsPerAddress = 2;
    Connections connections(limits);
    const auto* const other = connections.add(-1, Host::Http::Address("127.0.0.2", 0), nullptr);
    const auto* const first = connections.add(-1, someAddress, nullptr);
    EXPECT_NE(connections.add(-1, someAddress, nullptr), nullptr);
    EXPECT_NE(connections.add(-1, someAddress, nullptr), nullptr);
    EXPECT_TRUE(first->isLeaving);
    EXPECT_FALSE(other->isLeaving);
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
