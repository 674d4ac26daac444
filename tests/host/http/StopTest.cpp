// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The shutdown of the server.

#include "tests/host/http/HttpTest.h"

#include <fcntl.h>

namespace HttpTests {

namespace {

using namespace std::chrono_literals;

class StopTest : public HttpTest {
protected:
    // Waits until an operation runs.
    void waitForWork()
    {
        EXPECT_TRUE(Testing::waitUntil([this] { return operations.calls != 0; }));
    }
};

TEST_F(StopTest, RequestsThatRunComeToTheirEnd)
{
    operations.doFirst([](const Message&, const Caller&) { std::this_thread::sleep_for(1s); });
    start();
    HttpClient idle = connect();
    HttpClient running = connect();
    running.send(post());
    waitForWork();
    server->beginShutdown();
    EXPECT_FALSE(server->waitUntilIdle(10ms));
    EXPECT_THROW(connect(), std::system_error);
    EXPECT_TRUE(idle.isClosed());
    const HttpReply reply = running.receive();
    EXPECT_EQ(reply.status, 200);
    EXPECT_EQ(reply.field("connection"), "close");
    EXPECT_TRUE(running.isClosed());
    EXPECT_TRUE(server->waitUntilIdle(5s));
}

TEST_F(StopTest, LargeAnswersAreFetchedToTheirEnd)
{
    operations.answerWith(std::string(10'000, 'x'), 2000);
    start();
    HttpClient client = connect();
    client.send(post());
    ASSERT_TRUE(client.hasReplyWithin(5s));
    server->beginShutdown();
    EXPECT_FALSE(server->waitUntilIdle(100ms));
    EXPECT_EQ(client.receive().body.size(), 20'000'000U);
    EXPECT_TRUE(server->waitUntilIdle(5s));
    EXPECT_TRUE(client.isClosed()); // although its head announced no close
}

TEST_F(StopTest, HalfSentRequestsAreNotWaitedForLong)
{
    start();
    HttpClient headless = connect();
    headless.send(post().substr(0, 200));
    HttpClient bodyless = connect();
    bodyless.send(post().substr(0, post().size() - 1));
    EXPECT_EQ(ask(post()).status, 200); // the server has read the beginning of the others
    server->beginShutdown();
    EXPECT_TRUE(server->waitUntilIdle(8s));
    EXPECT_TRUE(headless.isClosed());
    EXPECT_TRUE(bodyless.isClosed());
}

TEST_F(StopTest, RequestThatIsComingInIsCarriedOut)
{
    start();
    HttpClient client = connect();
    client.send(post().substr(0, 200));
    EXPECT_EQ(ask(post()).status, 200);
    server->beginShutdown();
    client.send(post().substr(200));
    EXPECT_EQ(client.receive().status, 200);
    EXPECT_TRUE(client.isClosed());
}

TEST(ListeningSocketTest, RefusesWithoutGivingItsDescriptorAway)
{
    Host::Http::ListeningSocket socket({{"127.0.0.1", 0}});
    const std::uint16_t port = socket.address().port();
    HttpClient waiting(port);
    socket.refuse();
    EXPECT_THROW(HttpClient{port}, std::system_error);
    EXPECT_NE(::fcntl(socket.descriptor(), F_GETFD), -1);
}

TEST_F(StopTest, ServerWithoutClientsIsQuietAtOnce)
{
    start();
    EXPECT_TRUE(server->waitUntilIdle(0ms));
    server->beginShutdown();
    server->beginShutdown();
    EXPECT_TRUE(server->waitUntilIdle(0ms));
}

TEST_F(StopTest, EndCutsOffWhoeverIsThere)
{
    operations.doFirst([](const Message&, const Caller&) { std::this_thread::sleep_for(200ms); });
    limits.workers = 1;
    start();
    std::vector<HttpClient> clients;
    for (int i = 0; i < 6; ++i)
        clients.push_back(connect());
    for (std::size_t i = 0; i < 4; ++i)
        clients[i].send(post());
    clients[4].send(post().substr(0, 200));
    waitForWork();
    server.reset();
    for (HttpClient& client : clients)
        while (!client.receiveSome().empty())
            continue;
    EXPECT_EQ(operations.answersAlive, 0);
}

TEST_F(StopTest, PortIsFreeForTheNextServer)
{
    for (int i = 0; i < 3; ++i) {
        start({{{"127.0.0.1", port}}});
        EXPECT_EQ(ask(post()).status, 200);
        server.reset();
    }
}

} // namespace

} // namespace HttpTests
