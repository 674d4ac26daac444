// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Who may go on.

#include "host/http/BasicCredentials.h"
#include "host/http/SignIns.h"
#include "tests/host/http/Hashes.h"
#include "tests/host/http/HttpTest.h"
#include "tests/support/LogCapture.h"

namespace HttpTests {

namespace {

using Host::Http::Passwords;
using Host::Http::SignInDelays;
using Host::Http::SignInMemory;
using namespace std::chrono_literals;

TEST(BasicCredentialsTest, AreReadFromTheirEncoding)
{
    const auto user = [](const std::string& field) {
        const auto found = Host::Http::basicCredentials(field);
        return found ? found->user + "|" + found->password : "none";
    };
    EXPECT_EQ(user("Basic YW5uOnNlY3JldA=="), "ann|secret");
    EXPECT_EQ(user("bAsIc   YW5uOnNlY3JldA=="), "ann|secret");
    EXPECT_EQ(user("Basic YW5uOg=="), "ann|");
    EXPECT_EQ(user("Basic YW5uOmE6Yg=="), "ann|a:b");
    EXPECT_EQ(user("Basic w6TDtjrDvA=="), "äö|ü");
    for (const std::string field : {"", "Basic", "Basic ",
             "YW5uOnNlY3JldA==", "Digest YW5uOnNlY3JldA==", "Basic YW5uOnNlY3JldA",
             "Basic YW5uOnNlY3JldA=", "Basic YW5u",
             "Basic OnNlY3JldA==", "Basic YW5uAHg6eA==", "Basic ====", "Basic YW5uOnNl*3JldA=="})
        EXPECT_EQ(user(field), "none") << field;
}

TEST(SignInMemoryTest, ForgetsInTimeAndWhenThereAreTooMany)
{
    SignInMemory memory;
    const SignInMemory::Time start{};
    memory.remember({"ann", "secret"}, start);
    EXPECT_TRUE(memory.knows({"ann", "secret"}, start));
    EXPECT_FALSE(memory.knows({"ann", "secre"}, start));
    EXPECT_FALSE(memory.knows({"ann", "secrett"}, start));
    EXPECT_FALSE(memory.knows({"anns", "ecret"}, start));
    EXPECT_TRUE(memory.knows({"ann", "secret"}, start + SignInMemory::lifetime - 1s));
    EXPECT_FALSE(memory.knows({"ann", "secret"}, start + SignInMemory::lifetime));
    for (std::size_t i = 0; i < SignInMemory::capacity; ++i)
        memory.remember({"user" + std::to_string(i), "p"}, start + 1s);
    EXPECT_FALSE(memory.knows({"ann", "secret"}, start + 1s));
    EXPECT_TRUE(memory.knows({"user0", "p"}, start + 1s));
    memory.forgetAll();
    EXPECT_FALSE(memory.knows({"user0", "p"}, start + 1s));
}

TEST(SignInDelaysTest, GrowWithEachFailureOfAnAddress)
{
    SignInDelays delays(1s);
    const SignInDelays::Time start{};
    EXPECT_EQ(delays.admission("a", start), start);
    EXPECT_EQ(delays.failed("a", start), start + 1s);
    EXPECT_EQ(delays.admission("a", start), start + 1s);
    EXPECT_EQ(delays.admission("b", start), start);
    EXPECT_EQ(delays.failed("a", start + 1s), start + 3s);
    EXPECT_EQ(delays.failed("a", start + 3s), start + 7s);
    for (int i = 0; i < 10; ++i)
        delays.failed("a", start + 10s);
    EXPECT_EQ(delays.admission("a", start + 10s), start + 42s);
    const auto later = start + 10s + SignInDelays::memory + 1s;
    EXPECT_EQ(delays.failed("a", later), later + 1s);
}

TEST(SignInDelaysTest, AfterAFailureOneIsTriedAtATime)
{
    SignInDelays delays(1s);
    const SignInDelays::Time start{};
    EXPECT_EQ(delays.admit("a", start), start);
    EXPECT_EQ(delays.admit("a", start), start);
    EXPECT_EQ(delays.failed("a", start), start + 1s);
    EXPECT_EQ(delays.admit("a", start), start + 1s);
    EXPECT_EQ(delays.admit("a", start + 1s), start + 1s);
    EXPECT_EQ(delays.admit("a", start + 1s), start + 3s);
    EXPECT_EQ(delays.failed("a", start + 1s), start + 3s);
    EXPECT_EQ(delays.admit("b", start), start);
    const auto later = start + SignInDelays::memory + 2s;
    EXPECT_EQ(delays.admit("a", later), later);
    EXPECT_EQ(delays.admit("a", later), later);
}

TEST(SignInDelaysTest, AreKeptForSoManyAddressesOnly)
{
    SignInDelays delays(1s);
    const SignInDelays::Time start{};
    for (std::size_t i = 0; i < SignInDelays::capacity + 10; ++i)
        delays.failed(std::to_string(i), start + std::chrono::milliseconds(i));
    EXPECT_EQ(delays.size(), SignInDelays::capacity);
    EXPECT_EQ(delays.admission("0", start), start);
    EXPECT_GT(delays.admission("20", start), start);
}

TEST(SignInsTest, RefusalsAreTimedFromTheBeginning)
{
    Host::Http::SignIns signIns(
        std::make_shared<const Passwords>("ann:" + sha512 + "\nbob:" + dearBcrypt, "file"), 1s);
    const Host::Http::SignIns::Time start{};
    for (const std::string user : {"ann", "bob", "carl"})
        EXPECT_EQ(signIns.tryPassword({user, "wrong"}, "address", user, start), start + 1s) << user;
    EXPECT_EQ(signIns.tryPassword({"ann", "secret"}, "address", "ann", start), std::nullopt);
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

TEST_F(SignInTest, FailuresAreToldLaterAndLater)
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
    ASSERT_EQ(log.log().size(), 3U);
    EXPECT_EQ(log.log()[0].text, "wrong password for \"ann\" from 127.0.0.1");
}

TEST_F(SignInTest, SeveralConnectionsGuessNoFaster)
{
    limits.signInDelay = 200ms;
    limits.workers = 1;
    start();
    const auto begin = std::chrono::steady_clock::now();
    HttpClient one = connect();
    HttpClient other = connect();
    one.send(post(wrong));
    other.send(post(wrong));
    EXPECT_EQ(one.receive().status, 401);
    EXPECT_EQ(other.receive().status, 401);
    EXPECT_GE(std::chrono::steady_clock::now() - begin, 600ms); // 200 and then 400
}

TEST_F(SignInTest, AfterAFailureConnectionsTakeTurns)
{
    start();
    EXPECT_EQ(ask(post(wrong)).status, 401);
    const auto begin = std::chrono::steady_clock::now();
    HttpClient one = connect();
    HttpClient other = connect();
    one.send(post(wrong));
    other.send(post(wrong));
    EXPECT_EQ(one.receive().status, 401);
    EXPECT_EQ(other.receive().status, 401);
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
    HttpClient guesser = connect();
    guesser.send(post(wrong));
    EXPECT_FALSE(guesser.hasReplyWithin(200ms));
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

TEST_F(SignInTest, ServerThatStopsDoesNotWaitForThoseWhoGuess)
{
    limits.signInDelay = 3600s;
    start();
    HttpClient guesser = connect();
    guesser.send(post(wrong));
    EXPECT_FALSE(guesser.hasReplyWithin(300ms));
    HttpClient behind = connect();
    behind.send(post(right));
    EXPECT_FALSE(behind.hasReplyWithin(100ms));
    server->stopAccepting();
    EXPECT_TRUE(server->waitUntilQuiet(8s));
    EXPECT_EQ(guesser.receive().status, 401);
    EXPECT_EQ(behind.receive().status, 503);
    EXPECT_TRUE(guesser.isClosed());
    EXPECT_TRUE(behind.isClosed());
}

TEST_F(SignInTest, ServerEndsWhileSomebodyWaitsForARefusal)
{
    limits.signInDelay = 3600s;
    start();
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
