// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sign-ins of clients, over sockets.

#include "tests/host/http/Hashes.h"
#include "tests/host/http/HttpTest.h"
#include "tests/support/LogCapture.h"

namespace HttpTests {

namespace {

using Host::Http::Passwords;
using namespace std::chrono_literals;

std::vector<std::string> textsIn(const Testing::LogCapture& log)
{
    std::vector<std::string> texts;
    for (const Testing::LogLine& line : log.log())
        texts.push_back(line.text);
    return texts;
}

class SignInTest : public HttpTest {
protected:
    SignInTest()
    {
        limits.signInDelay = 100ms;
        passwords = std::make_shared<const Passwords>("ann:" + sha512, "file");
    }

    static std::string as(const std::string& credentials)
    {
        return "Authorization: Basic " + credentials + "\r\n";
    }

    void startWithLongWaits()
    {
        limits.signInDelay = 3600s;
        limits.requestTimeout = 7200s;
        start();
    }

    // Returns a client whose wrong password the server has not refused yet.
    HttpClient connectSuspended()
    {
        HttpClient guesser = connect();
        guesser.send(post(wrong));
        EXPECT_FALSE(guesser.hasReplyWithin(300ms));
        return guesser;
    }

    // Sends a wrong password from two clients at once.
    void guessTwiceAtATime()
    {
        HttpClient one = connect();
        HttpClient other = connect();
        one.send(post(wrong));
        other.send(post(wrong));
        EXPECT_EQ(one.receive().status, 401);
        EXPECT_EQ(other.receive().status, 401);
    }

    const std::string right = as("YW5uOnNlY3JldA==");
    const std::string wrong = as("YW5uOndyb25n");
};

TEST_F(SignInTest, NobodyGetsInWithoutTheRightPassword)
{
    start();
    const HttpReply anonymous = ask(post());
    EXPECT_EQ(anonymous.status, 401);
    EXPECT_EQ(
        anonymous.field("www-authenticate"), R"(Basic realm="sensor-profile", charset="UTF-8")");
    EXPECT_EQ(ask(post(wrong)).status, 401);
    EXPECT_EQ(ask(post(as("Ym9iOnNlY3JldA=="))).status, 401); // bob:secret
    EXPECT_EQ(ask(post("Authorization: Digest username=ann\r\n")).status, 401);
    EXPECT_EQ(operations.calls, 0);
}

TEST_F(SignInTest, WhoSignsInGoesOnOnTheSameConnection)
{
    start();
    std::string principal;
    operations.doFirst([&](const Message&, const Caller& caller) { principal = caller.principal; });
    HttpClient client = connect();
    client.send(post());
    EXPECT_EQ(client.receive().status, 401);
    client.send(post(right));
    EXPECT_EQ(client.receive().status, 200);
    EXPECT_EQ(operations.finished, 1);
    EXPECT_EQ(principal, "ann");
    client.send(post());
    EXPECT_EQ(client.receive().status, 401);
    client.send(post(right));
    EXPECT_EQ(client.receive().status, 200);
}

TEST_F(SignInTest, BodiesThatComeInChunksOrNotAtAllSignInToo)
{
    start();
    const std::string body = cimCall("EnumerateClasses");
    HttpClient client = connect();
    std::ostringstream size;
    size << std::hex << body.size();
    const std::string chunked =
        "POST /cimom HTTP/1.1\r\n" + usualFields + "Transfer-Encoding: chunked\r\n";
    const std::string chunks = size.str() + "\r\n" + body + "\r\n0\r\n\r\n";
    client.send(chunked + wrong + "\r\n" + chunks);
    EXPECT_EQ(client.receive().status, 401);
    client.send(chunked + right + "\r\n" + chunks);
    EXPECT_EQ(client.receive().status, 200);
    client.send(post(wrong, ""));
    EXPECT_EQ(client.receive().status, 401);
    client.send(post(right, ""));
    EXPECT_EQ(client.receive().field("cimerror"), "request-not-well-formed");
}

TEST_F(SignInTest, ClientThatAwaitsASignSignsInFirst)
{
    start();
    const std::string body = cimCall("EnumerateClasses");
    const std::string head =
        "POST /cimom HTTP/1.1\r\n" + usualFields + lengthField(body) + "Expect: 100-continue\r\n";
    HttpClient refused = connect();
    refused.send(head + wrong + "\r\n");
    EXPECT_EQ(refused.receive().status, 401);
    HttpClient client = connect();
    client.send(head + right + "\r\n");
    EXPECT_THAT(client.receiveSome(), testing::StartsWith("HTTP/1.1 100 "));
    client.send(body);
    EXPECT_EQ(client.receive().status, 200);
}

TEST_F(SignInTest, FailuresAreAnsweredLaterAndLater)
{
    start();
    const Testing::LogCapture log(6000);
    HttpClient client = connect();
    for (const auto least : {100ms, 200ms, 400ms}) {
        const auto begin = std::chrono::steady_clock::now();
        client.send(post(wrong));
        EXPECT_EQ(client.receive().status, 401);
        EXPECT_GE(std::chrono::steady_clock::now() - begin, least);
    }
    EXPECT_EQ(
        textsIn(log), std::vector<std::string>(3, "wrong password for \"ann\" from 127.0.0.1"));
}

TEST_F(SignInTest, WhoSignsInIsLoggedOnce)
{
    start();
    const Testing::LogCapture log(6000);
    EXPECT_EQ(ask(post(right)).status, 200);
    EXPECT_EQ(ask(post(right)).status, 200);
    EXPECT_EQ(textsIn(log), std::vector<std::string>{"\"ann\" signed in from 127.0.0.1"});
    server->replacePasswords(passwords);
    EXPECT_EQ(ask(post(right)).status, 200);
    EXPECT_EQ(log.log().size(), 2U);
}

TEST_F(SignInTest, WhoAskedForWhatIsLoggedAsADetail)
{
    start();
    EXPECT_EQ(ask(post(right)).status, 200);
    const Testing::LogCapture log(4000);
    EXPECT_EQ(ask(post(right)).status, 200);
    EXPECT_EQ(ask(post(right, "")).status, 400);
    EXPECT_EQ(ask(post()).status, 401);
    EXPECT_THAT(textsIn(log),
        testing::ElementsAre(R"(200 to 127.0.0.1, "ann", EnumerateClasses in root/cimv2)",
            testing::StartsWith(R"(400 to 127.0.0.1, "ann", EnumerateClasses in root/cimv2: )"),
            "401 to 127.0.0.1, EnumerateClasses in root/cimv2: "
            "sign in with a name and a password"));
}

TEST_F(SignInTest, NamesCannotDisguiseALineOfTheLog)
{
    start();
    const Testing::LogCapture log(6000);
    // U+202E, U+0085, a byte that is no UTF-8, and an umlaut behind it
    EXPECT_EQ(ask(post(as("YeKArmLChWP/w6Q6eA=="))).status, 401);
    EXPECT_EQ(textsIn(log), std::vector<std::string>{"wrong password for "
                                                     "\"a<U+202E>b<U+0085>c<0xFF>\u00e4\" "
                                                     "from 127.0.0.1"});
}

TEST_F(SignInTest, SeveralConnectionsGuessNoFaster)
{
    limits.signInDelay = 200ms;
    limits.workers = 1;
    start();
    const auto begin = std::chrono::steady_clock::now();
    guessTwiceAtATime();
    EXPECT_GE(std::chrono::steady_clock::now() - begin, 600ms); // 200 and then 400
}

TEST_F(SignInTest, AfterAFailureConnectionsTakeTurns)
{
    start();
    EXPECT_EQ(ask(post(wrong)).status, 401);
    const auto begin = std::chrono::steady_clock::now();
    guessTwiceAtATime();
    EXPECT_GE(std::chrono::steady_clock::now() - begin, 600ms); // 200 and then 400
}

TEST_F(SignInTest, WaitingForARefusalIsNotSlow)
{
    limits.signInDelay = 2000ms;
    limits.requestTimeout = 1s;
    start();
    EXPECT_EQ(ask(post(wrong)).status, 401);
}

TEST_F(SignInTest, WhoIsSignedInNeedNotWaitForThoseWhoGuess)
{
    limits.signInDelay = 60s;
    start();
    HttpClient client = connect();
    client.send(post(right));
    EXPECT_EQ(client.receive().status, 200);
    HttpClient guesser = connectSuspended();
    const auto begin = std::chrono::steady_clock::now();
    client.send(post(right));
    EXPECT_EQ(client.receive().status, 200);
    EXPECT_LT(std::chrono::steady_clock::now() - begin, 10s);
}

TEST_F(SignInTest, NewPasswordsCountAtOnce)
{
    start();
    EXPECT_EQ(ask(post(right)).status, 200);
    server->replacePasswords(std::make_shared<const Passwords>("bob:" + sha512, "file"));
    EXPECT_EQ(ask(post(right)).status, 401);
    EXPECT_EQ(ask(post(as("Ym9iOnNlY3JldA=="))).status, 200);
}

TEST_F(SignInTest, WhoWaitsTooLongIsRefusedWithRetryAfter)
{
    limits.signInDelay = 60s;
    start();
    HttpClient guesser = connectSuspended();
    const HttpReply reply = ask(post(right));
    EXPECT_EQ(reply.status, 503);
    EXPECT_EQ(reply.body, "too many sign-ins have failed\n");
    EXPECT_GT(std::stoi(reply.field("retry-after")), 30);
    EXPECT_LE(std::stoi(reply.field("retry-after")), 60);
}

TEST_F(SignInTest, ClientsThatLeaveAreNotWaitedFor)
{
    startWithLongWaits();
    {
        HttpClient guesser = connectSuspended();
        HttpClient resetting = connect();
        resetting.send(post(wrong));
        HttpClient leaving = connect();
        leaving.send(post(wrong) + std::string(100'000, 'x')); // more than the server reads
        EXPECT_FALSE(leaving.hasReplyWithin(300ms));
        EXPECT_FALSE(server->waitUntilIdle(0ms));
        resetting.closeHard();
    }
    EXPECT_TRUE(server->waitUntilIdle(8s));
}

TEST_F(SignInTest, ServerThatStopsDoesNotWaitForThoseWhoGuess)
{
    startWithLongWaits();
    HttpClient guesser = connectSuspended();
    HttpClient behind = connect();
    behind.send(post(right));
    EXPECT_FALSE(behind.hasReplyWithin(100ms));
    server->beginShutdown();
    EXPECT_TRUE(server->waitUntilIdle(8s));
    EXPECT_EQ(guesser.receive().status, 401);
    EXPECT_EQ(behind.receive().body, "the server is ending\n");
    EXPECT_TRUE(guesser.isClosed());
    EXPECT_TRUE(behind.isClosed());
}

TEST_F(SignInTest, ServerEndsWhileSomebodyWaitsForARefusal)
{
    startWithLongWaits();
    HttpClient client = connect();
    client.send(post(wrong));
    HttpClient next = connect();
    EXPECT_FALSE(client.hasReplyWithin(300ms));
    next.send(post(wrong));
    EXPECT_FALSE(next.hasReplyWithin(100ms));
    server.reset();
}

} // namespace

} // namespace HttpTests
