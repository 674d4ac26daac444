// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests and their answers, over sockets.

#include "tests/host/http/HttpTest.h"

namespace HttpTests {

namespace {

using testing::HasSubstr;
using testing::StartsWith;

class RequestTest : public HttpTest {
protected:
    RequestTest() { start(); }
};

TEST_F(RequestTest, PassesThePrincipalToTheOperation)
{
    Caller seen;
    std::string method;
    operations.doFirst([&](const Message& message, const Caller& caller) {
        seen = caller;
        method = message.methodName();
    });
    ask(post());
    EXPECT_EQ(operations.finished, 1);
    EXPECT_EQ(method, "EnumerateClasses");
    EXPECT_EQ(seen.principal, "");
    EXPECT_EQ(seen.address, "127.0.0.1");
}

TEST_F(RequestTest, ConnectionTakesRequestAfterRequest)
{
    HttpClient client = connect();
    for (int i = 0; i < 20; ++i) {
        client.send(post());
        EXPECT_EQ(client.receive().body, "<answer/>");
    }
    EXPECT_EQ(operations.calls, 20);
}

TEST_F(RequestTest, PipelinedRequestsAreAnsweredInTheirOrder)
{
    std::vector<std::string> names;
    operations.doFirst([&](const Message& message, const Caller&) {
        names.push_back(message.methodName());
        operations.answerWith(message.methodName());
    });
    HttpClient client = connect();
    client.send(cimRequest("First") + cimRequest("Second") + cimRequest("Third"));
    EXPECT_EQ(client.receive().body, "<answer/>");
    EXPECT_EQ(client.receive().body, "First"); // the answer to the first request
    EXPECT_EQ(client.receive().body, "Second");
    EXPECT_EQ(operations.finished, 3);
    EXPECT_EQ(names, (std::vector<std::string>{"First", "Second", "Third"}));
}

TEST_F(RequestTest, RequestMayComeByteByByte)
{
    HttpClient client = connect();
    for (const char c : post())
        client.send(std::string(1, c));
    EXPECT_EQ(client.receive().body, "<answer/>");
}

TEST_F(RequestTest, ClientThatAwaitsASignGetsIt)
{
    HttpClient client = connect();
    beginPost(client);
    EXPECT_EQ(finishPost(client), 200);
}

TEST_F(RequestTest, ClientThatAwaitsASignHearsOfAnErrorInstead)
{
    HttpClient client = connect();
    client.send("POST /cimom HTTP/1.1\r\nHost: localhost\r\nContent-Type: text/plain\r\n"
                "Content-Length: 100\r\nExpect: 100-continue\r\n\r\n");
    const HttpReply reply = client.receive();
    EXPECT_EQ(reply.status, 415);
    EXPECT_EQ(reply.field("connection"), "close");
    EXPECT_TRUE(client.isClosed());
}

TEST_F(RequestTest, LargeAnswersComeInChunks)
{
    operations.answerWith(std::string(1000, 'x'), 5000);
    HttpClient client = connect();
    for (int i = 0; i < 3; ++i) {
        client.send(post());
        const HttpReply reply = client.receive();
        EXPECT_EQ(reply.field("transfer-encoding"), "chunked");
        EXPECT_EQ(reply.body, std::string(5'000'000, 'x'));
    }
}

TEST_F(RequestTest, OldClientsGetTheAnswerUntilTheEndOfTheConnection)
{
    operations.answerWith(std::string(1000, 'x'), 500);
    const std::string body = cimCall("EnumerateClasses");
    HttpClient client = connect();
    client.send("POST /cimom HTTP/1.0\r\n" + usualFields + lengthField(body) + "\r\n" + body);
    std::string all;
    for (std::string piece = client.receiveSome(); !piece.empty(); piece = client.receiveSome())
        all += piece;
    EXPECT_THAT(all, HasSubstr("Connection: close"));
    EXPECT_TRUE(all.ends_with("\r\n\r\n" + std::string(500'000, 'x')));
}

TEST_F(RequestTest, OperationThatThrowsIsAnInternalError)
{
    operations.doFirst([](const Message&, const Caller&) { throw std::runtime_error("oh"); });
    const HttpReply reply = ask(post());
    EXPECT_EQ(reply.status, 500);
    EXPECT_EQ(reply.body, "the request failed; the log has the reason\n");
}

TEST_F(RequestTest, OperationWithoutMemoryEndsItsConnectionOnly)
{
    operations.doFirst([](const Message&, const Caller&) { throw std::bad_alloc(); });
    HttpClient client = connect();
    client.send(post());
    EXPECT_TRUE(client.isClosed());
    operations.doFirst(nullptr);
    EXPECT_EQ(ask(post()).status, 200);
}

} // namespace

} // namespace HttpTests
