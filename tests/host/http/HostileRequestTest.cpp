// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What no well-behaved client sends. Whatever it is, the next client is served.

#include "tests/host/http/HttpTest.h"

namespace HttpTests {

namespace {

using testing::AnyOf;
using testing::Eq;
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

    std::string firstReplyTo(const std::string& bytes)
    {
        HttpClient client = connect();
        client.trySend(bytes);
        client.endSending();
        return client.receiveSome().substr(0, 12);
    }
};

TEST_F(HostileRequestTest, NoHttpIsRefused)
{
    for (const std::string& bytes : {std::string("\r\n\r\n\r\n\r\n"), std::string("hello\r\n\r\n"),
             std::string("POST\r\n\r\n"), std::string("POST /cimom HTTP/9.9\r\n\r\n"),
             std::string(100, '\0') + "\r\n\r\n", std::string("\x16\x03\x01\x02\x00\x01\x00", 7),
             std::string(100'000, 'A'), std::string("GET / HTTP/1.1\r\nbroken\r\n\r\n")}) {
        const std::string reply = firstReplyTo(bytes);
        if (!reply.empty()) {
            EXPECT_THAT(reply, StartsWith("HTTP/1.")) << bytes.substr(0, 40);
            EXPECT_THAT(reply.substr(9, 1), AnyOf(Eq("4"), Eq("5"))) << bytes.substr(0, 40);
        }
    }
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
    for (int i = 0; i < 100 && operations.answersAlive != 0; ++i)
        std::this_thread::sleep_for(50ms);
    EXPECT_EQ(operations.answersAlive, 0);
}

TEST_F(HostileRequestTest, BodiesThatAreNoXmlAreRefused)
{
    for (const std::string& body :
        {std::string("\xFF\xFE\x00\x3C", 4), std::string("<CIM>\xC3\x28</CIM>"),
            std::string(1000, '\0'), bodyFor("EnumerateClasses").substr(0, 150)})
        EXPECT_EQ(ask(post("", body)).field("cimerror"), "request-not-well-formed");
    std::string deep;
    for (int i = 0; i < 10'000; ++i)
        deep += "<VALUE>";
    EXPECT_EQ(ask(post("", deep)).field("cimerror"), "request-not-valid");
    EXPECT_EQ(ask(post("", "<!DOCTYPE CIM [<!ENTITY a 'b'>]>" + bodyFor("EnumerateClasses")))
                  .field("cimerror"),
        "request-not-valid");
    EXPECT_EQ(operations.calls, 0);
}

TEST_F(HostileRequestTest, LengthsThatContradictTheBodyAreNoDanger)
{
    const std::string body = bodyFor("EnumerateClasses");
    const auto withLength = [&](std::size_t length) {
        return "POST /cimom HTTP/1.1\r\n" + usualFields +
               "Content-Length: " + std::to_string(length) + "\r\n\r\n" + body;
    };
    EXPECT_THAT(firstReplyTo(withLength(body.size() - 10)), Eq("HTTP/1.1 400"));
    HttpClient waiting = connect();
    waiting.send(withLength(body.size() + 10));
    EXPECT_TRUE(waiting.isClosed());
    EXPECT_THAT(
        firstReplyTo("POST /cimom HTTP/1.1\r\n" + usualFields + "\r\n" + body), Eq("HTTP/1.1 411"));
    EXPECT_THAT(firstReplyTo("POST /cimom HTTP/1.1\r\n" + usualFields + lengthField(body) +
                             "Content-Length: 5\r\n\r\n" + body),
        Eq("HTTP/1.1 400"));
    EXPECT_THAT(firstReplyTo(post("Transfer-Encoding: chunked\r\n")), Eq("HTTP/1.1 400"));
}

TEST_F(HostileRequestTest, ChunksThatMakeNoSenseEndTheConnection)
{
    const std::string head =
        "POST /cimom HTTP/1.1\r\n" + usualFields + "Transfer-Encoding: chunked\r\n\r\n";
    for (const std::string chunks : {"xyz\r\n", "-1\r\n", "fffffffffffffffff\r\n", "5\r\nabcdefgh",
             "\r\n\r\n", "5;ext=\"\r\n", "0\r\nTrailer"}) {
        HttpClient client = connect();
        client.trySend(head + chunks);
        client.endSending();
        const std::string reply = client.receiveSome();
        EXPECT_TRUE(reply.empty() || reply.starts_with("HTTP/1.1 4")) << chunks << reply;
    }
    EXPECT_EQ(operations.calls, 0);
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
