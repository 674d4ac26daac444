// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What is counted of clients, without clients.

#include "host/http/Connections.h"
#include "host/http/UnsentObjects.h"

#include <gtest/gtest.h>

#include <mutex>
#include <sys/socket.h>
#include <unistd.h>

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

TEST(ConnectionsTest, OneTooManyAtAnAddressEnds)
{
    Host::Http::Limits limits;
    limits.maximumConnectionsPerAddress = 1;
    Host::Http::Connections connections(limits);
    int ends[2];
    ASSERT_EQ(::socketpair(AF_UNIX, SOCK_STREAM, 0, ends), 0);
    EXPECT_NE(connections.add(-1, {"127.0.0.1", 1}, nullptr), nullptr);
    EXPECT_NE(connections.add(-1, {"127.0.0.2", 1}, nullptr), nullptr);
    EXPECT_EQ(connections.add(ends[0], {"127.0.0.1", 2}, nullptr), nullptr);
    char byte = 0;
    EXPECT_EQ(::recv(ends[1], &byte, 1, MSG_DONTWAIT), 0);
    for (const int end : ends)
        ::close(end);
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

} // namespace

} // namespace HttpTests
