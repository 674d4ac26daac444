// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Hostile requests that are too large for a file of RequestFilesTest or depend on time. After each,
// the next client is served.

#include "tests/host/http/HttpTest.h"

namespace HttpTests {

namespace {

using testing::StartsWith;
using namespace std::chrono_literals;

class HostileRequestTest : public HttpTest {
protected:
    HostileRequestTest()
    {
        limits.idleTimeout = 6s;
        limits.requestTimeout = 2s;
        limits.maximumConnections = 1000;
        limits.maximumConnectionsPerAddress = 1000;
        start();
    }
    void TearDown() override { EXPECT_EQ(ask(post()).status, 200); }
};

TEST_F(HostileRequestTest, LineWithoutEndIsRefused)
{
    HttpClient client = connect();
    client.trySend(std::string(100'000, 'A'));
    EXPECT_THAT(client.receiveSome(), StartsWith("HTTP/1.1 4"));
}

TEST_F(HostileRequestTest, ServerMayEndWhileTheyAreRefused)
{
    for (int i = 0; i < 40; ++i) {
        std::vector<HttpClient> clients;
        for (int n = 0; n < 8; ++n) {
            clients.push_back(connect());
            clients.back().trySend(std::string(100'000, 'A'));
        }
        std::this_thread::sleep_for(std::chrono::microseconds(50 * i));
        server.reset();
        start();
    }
}

TEST_F(HostileRequestTest, QueriesWithoutEndAreCutOff)
{
    for (const int count : {101, 900, 2000}) {
        std::string target = "/cimom?";
        for (int i = 0; i < count; ++i)
            target += "a=1&";
        const auto begin = std::chrono::steady_clock::now();
        HttpClient client = connect();
        client.trySend(post("", cimCall("EnumerateClasses"), target));
        EXPECT_TRUE(client.isClosed()) << count;
        EXPECT_LT(std::chrono::steady_clock::now() - begin, limits.requestTimeout) << count;
    }
    EXPECT_EQ(operations.calls, 0);
    EXPECT_EQ(ask(post("", cimCall("EnumerateClasses"), "/cimom?a=1&b=2")).status, 200);
}

TEST_F(HostileRequestTest, BodyOfElementsInOneAnotherIsRefused)
{
    std::string deep;
    for (int i = 0; i < 10'000; ++i)
        deep += "<VALUE>";
    EXPECT_EQ(ask(post("", deep)).field("cimerror"), "request-not-valid");
    EXPECT_EQ(operations.calls, 0);
}

TEST_F(HostileRequestTest, TruncatedRequestsEndWithTheirConnection)
{
    const std::string whole = post();
    std::vector<HttpClient> clients;
    for (std::size_t length = 0; length < whole.size(); length += 17) {
        clients.push_back(connect());
        clients.back().send(whole.substr(0, length));
        clients.back().endSending();
    }
    const auto begin = std::chrono::steady_clock::now();
    for (HttpClient& client : clients)
        EXPECT_TRUE(client.isClosed());
    EXPECT_LT(std::chrono::steady_clock::now() - begin, limits.idleTimeout);
    EXPECT_EQ(operations.calls, 0);
}

TEST_F(HostileRequestTest, ClientMayEndSendingBehindItsRequest)
{
    operations.doFirst([](const Message&, const Caller&) { std::this_thread::sleep_for(1500ms); });
    HttpClient client = connect();
    client.send(post());
    client.endSending();
    EXPECT_EQ(client.receive().body, "<answer/>");
    EXPECT_TRUE(client.isClosed());
    operations.doFirst(nullptr);
}

TEST_F(HostileRequestTest, ClientsThatVanishLeaveNothingBehind)
{
    operations.doFirst([](const Message&, const Caller&) { std::this_thread::sleep_for(20ms); });
    for (int i = 0; i < 20; ++i) {
        HttpClient client = connect();
        client.send(post());
        client.closeHard();
    }
    operations.answerWith(std::string(10'000, 'x'), 1000);
    for (int i = 0; i < 5; ++i) {
        HttpClient client = connect();
        client.send(post());
        client.receiveSome();
        client.closeHard();
    }
    expectNoAnswerAlive();
}

TEST_F(HostileRequestTest, ThoseWhoBreakOffDoNotHinderTheOthers)
{
    std::vector<std::thread> clients;
    std::atomic<int> served{0};
    for (int i = 0; i < 8; ++i)
        clients.emplace_back([&] {
            for (int n = 0; n < 40; ++n) {
                HttpClient client = connect();
                client.send(n % 2 == 0 ? post() : post().substr(0, 100));
                if (n % 2 == 0 && client.receive().status == 200)
                    ++served;
            }
        });
    for (std::thread& client : clients)
        client.join();
    EXPECT_EQ(served, 160);
}

} // namespace

} // namespace HttpTests
