// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// How the server ends.

#include "host/http/Timer.h"
#include "host/http/WorkerPool.h"
#include "tests/host/http/HttpTest.h"
#include "tests/support/LogCapture.h"

#include <condition_variable>
#include <fcntl.h>
#include <future>

namespace HttpTests {

namespace {

using namespace std::chrono_literals;

class StopTest : public HttpTest {
protected:
    // Waits until an operation runs.
    void waitForWork()
    {
        for (int i = 0; i < 500 && operations.calls == 0; ++i)
            std::this_thread::sleep_for(10ms);
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
    server->stopAccepting();
    EXPECT_FALSE(server->waitUntilQuiet(10ms));
    EXPECT_THROW(connect(), std::system_error);
    EXPECT_TRUE(idle.isClosed());
    const HttpReply reply = running.receive();
    EXPECT_EQ(reply.status, 200);
    EXPECT_EQ(reply.field("connection"), "close");
    EXPECT_TRUE(running.isClosed());
    EXPECT_TRUE(server->waitUntilQuiet(5s));
}

TEST_F(StopTest, LargeAnswersAreFetchedToTheirEnd)
{
    operations.answerWith(std::string(10'000, 'x'), 2000);
    start();
    HttpClient client = connect();
    client.send(post());
    ASSERT_TRUE(client.hasReplyWithin(5s));
    server->stopAccepting();
    EXPECT_FALSE(server->waitUntilQuiet(100ms));
    EXPECT_EQ(client.receive().body.size(), 20'000'000U);
    EXPECT_TRUE(server->waitUntilQuiet(5s));
    EXPECT_TRUE(client.isClosed()); // though its head was sent when nobody thought of an end
}

TEST_F(StopTest, HalfSentRequestsAreNotWaitedForLong)
{
    start();
    HttpClient headless = connect();
    headless.send(post().substr(0, 200));
    HttpClient bodyless = connect();
    bodyless.send(post().substr(0, post().size() - 1));
    EXPECT_EQ(ask(post()).status, 200); // by now the server has seen the others' beginning
    server->stopAccepting();
    EXPECT_TRUE(server->waitUntilQuiet(8s));
    EXPECT_TRUE(headless.isClosed());
    EXPECT_TRUE(bodyless.isClosed());
}

TEST_F(StopTest, RequestThatIsComingInIsCarriedOut)
{
    start();
    HttpClient client = connect();
    client.send(post().substr(0, 200));
    EXPECT_EQ(ask(post()).status, 200);
    server->stopAccepting();
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
    EXPECT_TRUE(server->waitUntilQuiet(0ms));
    server->stopAccepting();
    server->stopAccepting();
    EXPECT_TRUE(server->waitUntilQuiet(0ms));
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

TEST(TimerTest, DoesThingsInTheirOrderAndAtTheEndAllThatIsLeft)
{
    std::vector<int> done;
    {
        Host::Http::Timer timer;
        const auto now = std::chrono::steady_clock::now();
        timer.at(now + 3600s, [&] { done.push_back(4); });
        timer.at(now + 40ms, [&] { done.push_back(2); });
        timer.at(now + 20ms, [&] { done.push_back(1); });
        timer.at(now + 60ms, [&] { done.push_back(3); });
        std::this_thread::sleep_until(now + 200ms);
        timer.end();
        timer.at(now + 3600s, [&] { done.push_back(5); });
    }
    EXPECT_EQ(done, (std::vector<int>{1, 2, 3, 4, 5}));
}

TEST(TimerTest, HurriesWithWhatMayBeSooner)
{
    std::vector<int> done;
    Host::Http::Timer timer;
    const auto later = std::chrono::steady_clock::now() + 3600s;
    std::promise<void> last;
    timer.at(later, [&] { done.push_back(4); });
    timer.atOrSooner(later, [&] { done.push_back(1); });
    timer.atOrSooner(later + 1s, [&] { done.push_back(2); });
    timer.hurry();
    timer.atOrSooner(later, [&] {
        done.push_back(3);
        last.set_value();
    });
    EXPECT_EQ(last.get_future().wait_for(10s), std::future_status::ready);
    timer.end();
    EXPECT_EQ(done, (std::vector<int>{1, 2, 3, 4}));
}

TEST(TimerTest, GoesOnWhenSomethingFails)
{
    const Testing::LogCapture log(6000);
    int done = 0;
    {
        Host::Http::Timer timer;
        timer.at({}, [] { throw std::runtime_error("it went wrong"); });
        timer.at({}, [] { throw 1; });
        timer.at({}, [&] { ++done; });
        timer.end();
        timer.at({}, [] { throw std::runtime_error("it is too late"); });
    }
    EXPECT_EQ(done, 1);
    ASSERT_EQ(log.log().size(), 3U);
    EXPECT_EQ(log.log()[0].text, "it went wrong");
    EXPECT_EQ(log.log()[2].text, "it is too late");
}

TEST(WorkerPoolTest, BoundsThoseWhoWaitAndFinishesThem)
{
    std::atomic<int> done{0};
    std::mutex gate;
    std::atomic<int> running{0};
    {
        Host::Http::WorkerPool pool(2, 3);
        std::unique_lock closed(gate);
        const auto job = [&] {
            ++running;
            const std::lock_guard open(gate);
            ++done;
        };
        EXPECT_TRUE(pool.take(job));
        EXPECT_TRUE(pool.take(job));
        while (running < 2)
            std::this_thread::yield();
        for (int i = 0; i < 3; ++i)
            EXPECT_TRUE(pool.take(job));
        EXPECT_FALSE(pool.take(job));
        closed.unlock();
    }
    EXPECT_EQ(done, 5);
}

} // namespace

} // namespace HttpTests
