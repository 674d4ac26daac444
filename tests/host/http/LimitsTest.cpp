// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Too many clients, too large requests and too slow clients.

#include "tests/host/http/HttpTest.h"
#include "tests/support/LogCapture.h"

#include <condition_variable>

namespace HttpTests {

namespace {

using testing::HasSubstr;
using testing::StartsWith;
using namespace std::chrono_literals;

// Blocks each thread that passes until the gate is opened.
class Gate {
public:
    void pass()
    {
        std::unique_lock lock(mutex_);
        ++waiting_;
        changed_.notify_all();
        changed_.wait(lock, [this] { return isOpen_; });
    }
    void waitFor(int count)
    {
        std::unique_lock lock(mutex_);
        changed_.wait(lock, [&] { return waiting_ >= count; });
    }
    void open()
    {
        const std::lock_guard lock(mutex_);
        isOpen_ = true;
        changed_.notify_all();
    }

private:
    std::mutex mutex_;
    std::condition_variable changed_;
    int waiting_ = 0;
    bool isOpen_ = false;
};

class LimitsTest : public HttpTest {
protected:
    static std::string announced(const std::string& length)
    {
        return "POST /cimom HTTP/1.1\r\n" + usualFields + "Content-Length: " + length + "\r\n\r\n";
    }
};

TEST_F(LimitsTest, FailuresOfTheHttpLibraryAreReportedOnceAMinute)
{
    start();
    const Testing::LogCapture log(4000);
    for (int i = 0; i < 2; ++i)
        EXPECT_EQ(ask(announced("none")).status, 400);
    std::vector<int> levels;
    for (const Testing::LogLine& line : log.log())
        if (line.function == "logLine")
            levels.push_back(line.level);
    ASSERT_GT(levels.size(), 1U);
    EXPECT_EQ(levels.front(), 6000);
    EXPECT_THAT(std::vector(levels.begin() + 1, levels.end()), testing::Each(4000));
}

TEST_F(LimitsTest, BodyBeyondTheLimitIsReadAndRefused)
{
    limits.maximumBody = 1000;
    start();
    HttpClient client = connect();
    client.send(announced("1500") + std::string(1500, ' '));
    const HttpReply reply = client.receive();
    EXPECT_EQ(reply.status, 413);
    EXPECT_EQ(reply.body, "a body holds at most 1000 bytes\n");
    client.send(post());
    EXPECT_EQ(client.receive().status, 200);
}

TEST_F(LimitsTest, BodyFarBeyondTheLimitIsRefusedUnread)
{
    limits.maximumBody = 1000;
    start();
    for (const std::string length : {"2001", "100000000000", "18446744073709551614"}) {
        HttpClient client = connect();
        client.send(announced(length));
        const HttpReply reply = client.receive();
        EXPECT_EQ(reply.status, 413) << length;
        EXPECT_EQ(reply.field("connection"), "close");
        EXPECT_TRUE(client.isClosed());
    }
    HttpClient client = connect();
    client.send(announced("99999999999999999999999999"));
    EXPECT_THAT(client.receiveSome(), StartsWith("HTTP/1.1 413 "));
}

TEST_F(LimitsTest, ChunksBeyondTheLimitAreRefused)
{
    limits.maximumBody = 1000;
    start();
    const std::string head =
        "POST /cimom HTTP/1.1\r\n" + usualFields + "Transfer-Encoding: chunked\r\n\r\n";
    const std::string chunk = "1f4\r\n" + std::string(500, ' ') + "\r\n";
    HttpClient client = connect();
    client.send(head + chunk + chunk + chunk + "0\r\n\r\n");
    EXPECT_EQ(client.receive().status, 413);
    HttpClient awaiting = connect();
    awaiting.send("POST /cimom HTTP/1.1\r\n" + usualFields +
                  "Transfer-Encoding: chunked\r\nExpect: 100-continue\r\n\r\n");
    EXPECT_THAT(awaiting.receiveSome(), StartsWith("HTTP/1.1 100 "));
    awaiting.send(chunk + chunk + chunk + "0\r\n\r\n");
    EXPECT_EQ(awaiting.receive().status, 413);
    HttpClient endless = connect();
    std::string chunks;
    for (int i = 0; i < 1000; ++i)
        chunks += chunk;
    endless.trySend(head + chunks);
    EXPECT_TRUE(endless.isClosed());
    EXPECT_EQ(operations.calls, 0);
}

TEST_F(LimitsTest, HeadBeyondTheLimitIsRefused)
{
    limits.maximumHeader = 4096;
    start();
    EXPECT_EQ(ask(post("X-Long: " + std::string(3000, 'x') + "\r\n")).status, 200);
    EXPECT_EQ(ask(post("X-Long: " + std::string(5000, 'x') + "\r\n")).status, 431);
    HttpClient client = connect();
    client.trySend(post("X-Long: " + std::string(1'000'000, 'x') + "\r\n"));
    EXPECT_THAT(client.receiveSome(), StartsWith("HTTP/1.1 431 "));
    EXPECT_EQ(operations.calls, 1);
}

TEST_F(LimitsTest, DepthOfElementsIsBounded)
{
    limits.maximumDepth = 4;
    start();
    const HttpReply reply = ask(post());
    EXPECT_EQ(reply.status, 400);
    EXPECT_EQ(reply.field("cimerror"), "request-not-valid");
}

TEST_F(LimitsTest, ConnectionsOfOneAddressAreBounded)
{
    limits.maximumConnectionsPerAddress = 3;
    const Testing::LogCapture log(6000);
    start();
    std::vector<HttpClient> clients;
    for (int i = 0; i < 3; ++i) {
        clients.push_back(connect());
        beginPost(clients.back());
    }
    EXPECT_TRUE(connect().isClosed());
    EXPECT_TRUE(connect().isClosed());
    ASSERT_EQ(log.log().size(), 1U); // not one for each
    EXPECT_EQ(log.log()[0].text, "refused a connection from 127.0.0.1: there are 3, too many of "
                                 "them from this address");
    HttpClient other(port, "127.0.0.1");
    clients.clear();
    for (bool isServed = false; !isServed;) {
        HttpClient client = connect();
        isServed = client.trySend(post()) && !client.receiveSome().empty();
    }
}

TEST_F(LimitsTest, ConnectionsInAllAreBounded)
{
    limits.maximumConnections = 2;
    start();
    std::vector<HttpClient> clients;
    for (int i = 0; i < 2; ++i) {
        clients.push_back(connect());
        beginPost(clients.back());
    }
    EXPECT_TRUE(connect().isClosed());
    EXPECT_EQ(finishPost(clients.front()), 200);
}

TEST_F(LimitsTest, ConnectionsWithoutARequestMakeRoom)
{
    limits.maximumConnections = 3;
    start();
    HttpClient begun = connect();
    beginPost(begun);
    HttpClient first = connect();
    HttpClient second = connect();
    EXPECT_EQ(ask(post()).status, 200);
    EXPECT_TRUE(first.isClosed());
    second.send(post());
    EXPECT_EQ(second.receive().status, 200);
    EXPECT_EQ(finishPost(begun), 200);
}

TEST_F(LimitsTest, RequestThatHardlyArrivesMakesRoom)
{
    limits.maximumConnections = 2;
    start();
    HttpClient first = connect();
    beginPost(first);
    HttpClient second = connect();
    beginPost(second);
    std::this_thread::sleep_for(2100ms);
    EXPECT_EQ(ask(post()).status, 200);
    EXPECT_TRUE(first.isClosed());
    EXPECT_EQ(finishPost(second), 200);
}

TEST_F(LimitsTest, AnswersThatNobodyFetchesLeaveRoomForNoMoreOfTheirKind)
{
    limits.maximumUnsentObjects = 10'000;
    const std::string piece(10'000, 'x');
    operations.answerWith(piece, 5000); // more than the sockets take
    start();
    std::vector<HttpClient> readers;
    for (int i = 0; i < 2; ++i) {
        readers.push_back(connect());
        readers.back().send(post());
        ASSERT_TRUE(readers.back().hasReplyWithin(HttpClient::timeout));
    }
    HttpClient refused = connect();
    refused.send(post());
    const HttpReply reply = refused.receive();
    EXPECT_EQ(reply.status, 503);
    EXPECT_EQ(reply.field("connection"), "close");
    EXPECT_EQ(reply.field("retry-after"), "1");
    EXPECT_THAT(reply.body, HasSubstr("clients have yet to fetch answers"));
    EXPECT_TRUE(refused.isClosed());
    EXPECT_EQ(operations.answersAlive, 2);
    operations.answerWith("<answer/>");
    EXPECT_EQ(ask(post()).status, 200);

    operations.answerWith(piece, 5000);
    readers.clear();
    int status = 0;
    EXPECT_TRUE(Testing::waitUntil([&] { return (status = ask(post()).status) != 503; }));
    EXPECT_EQ(status, 200);
    EXPECT_EQ(operations.answersAlive, 0);
}

TEST_F(LimitsTest, AnswerThatIsAloneMayBeOfAnySize)
{
    limits.maximumUnsentObjects = 1;
    operations.answerWith(std::string(10'000, 'x'), 100);
    start();
    for (int i = 0; i < 2; ++i)
        EXPECT_EQ(ask(post()).body.size(), 1'000'000U);
}

TEST_F(LimitsTest, RequestsBeyondTheQueueAreRefusedWithRetryAfter)
{
    limits.workers = 1;
    limits.maximumQueue = 1;
    Gate gate;
    operations.doFirst([&](const Message&, const Caller&) { gate.pass(); });
    start();
    HttpClient running = connect();
    running.send(post());
    gate.waitFor(1);
    std::vector<HttpClient> others;
    for (int i = 0; i < 3; ++i) {
        others.push_back(connect());
        others.back().send(post());
    }
    Testing::waitUntil([&] {
        std::erase_if(others, [](HttpClient& other) {
            if (!other.hasReplyWithin(10ms))
                return false;
            const HttpReply reply = other.receive();
            EXPECT_EQ(reply.status, 503);
            EXPECT_EQ(reply.field("retry-after"), "1");
            return true;
        });
        return others.size() <= 1;
    });
    ASSERT_EQ(others.size(), 1U);
    EXPECT_FALSE(others.front().hasReplyWithin(100ms)); // the request is blocked
    gate.open();
    EXPECT_EQ(running.receive().status, 200);
    EXPECT_EQ(others.front().receive().status, 200);
    server.reset(); // no thread passes the gate after this
}

TEST_F(LimitsTest, SilentConnectionsEnd)
{
    limits.idleTimeout = 1s;
    start();
    HttpClient fresh = connect();
    HttpClient served = connect();
    served.send(post());
    EXPECT_EQ(served.receive().status, 200);
    HttpClient halfSent = connect();
    halfSent.send("POST /cimom HT");
    HttpClient bodyless = connect();
    bodyless.send(announced("100") + "<?xml");
    EXPECT_TRUE(fresh.isClosed());
    EXPECT_TRUE(served.isClosed());
    EXPECT_TRUE(halfSent.isClosed());
    EXPECT_TRUE(bodyless.isClosed());
    EXPECT_EQ(operations.calls, 1);
}

// Sends a byte on each connection repeatedly until it is closed. Returns false after the timeout.
bool endWhileTrickling(std::vector<HttpClient> clients, std::chrono::seconds timeout)
{
    const auto hasEnded = [](HttpClient& client) {
        return !client.trySend("x") || client.hasReplyWithin(50ms);
    };
    return Testing::waitUntil(
        [&] {
            std::erase_if(clients, hasEnded);
            return clients.empty();
        },
        timeout);
}

TEST_F(LimitsTest, SlowSendersEnd)
{
    limits.requestTimeout = 1s;
    limits.idleTimeout = 2s;
    start();
    std::vector<HttpClient> clients;
    for (const std::string& begin : {announced("1000"),
             std::string("POST /cimom HTTP/1.1\r\nX-Slow: "), std::string("POST /")}) {
        clients.push_back(connect());
        clients.back().send(begin);
    }
    EXPECT_TRUE(endWhileTrickling(std::move(clients), 10s));
    EXPECT_EQ(ask(post()).status, 200);
}

TEST_F(LimitsTest, OperationsMayTakeLongerThanAnyTimeout)
{
    limits.requestTimeout = 1s;
    limits.idleTimeout = 1s;
    operations.doFirst([](const Message&, const Caller&) { std::this_thread::sleep_for(3s); });
    start();
    EXPECT_EQ(ask(post()).status, 200);
}

TEST_F(LimitsTest, ReadersThatDoNotReadEndAndLoseTheirAnswer)
{
    limits.idleTimeout = 1s;
    operations.answerWith(std::string(10'000, 'x'), 5000); // more than the sockets take
    start();
    HttpClient client = connect();
    client.send(post());
    ASSERT_TRUE(client.hasReplyWithin(5s));
    EXPECT_EQ(operations.answersAlive, 1);
    expectNoAnswerAlive();
}

TEST_F(LimitsTest, SlowReadersGetTheirAnswerUpToALimit)
{
    limits.answerTimeout = 2s;
    operations.answerWith(std::string(10'000, 'x'), 10'000);
    start();
    HttpClient client = connect();
    client.send(post());
    std::size_t total = 0;
    for (std::string some = client.receiveSome(); !some.empty(); some = client.receiveSome()) {
        total += some.size();
        std::this_thread::sleep_for(10ms);
    }
    EXPECT_GT(total, 100'000U);
    EXPECT_LT(total, 100'000'000U);
}

} // namespace

} // namespace HttpTests
