// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Password files, and who may go on.

#include "host/http/BasicCredentials.h"
#include "host/http/PasswordHash.h"
#include "host/http/SignIns.h"
#include "tests/host/http/HttpTest.h"
#include "tests/support/LogCapture.h"
#include "tests/support/TemporaryFolder.h"

#include <ctime>
#include <sys/stat.h>
#include <unistd.h>

namespace HttpTests {

namespace {

using Host::Http::Passwords;
using Host::Http::SignInDelays;
using Host::Http::SignInMemory;
using testing::AllOf;
using testing::HasSubstr;
using namespace std::chrono_literals;

// "secret" under each scheme, at the least cost.
const std::string yescrypt =
    "$y$j75$rXFh3jJw1MMfCN0LMfxTN/$/4dQYJpjC7h6fw/f28qONzbXJtVT0m.gAeXigje2bt4";
const std::string bcrypt = "$2b$04$abcdefghijklmnopqrstuu2r9OfJnfCsdneAXAGHnS4UpFFP8WIrW";
const std::string dearBcrypt = "$2b$10$abcdefghijklmnopqrstuuqflPDzB6gcMhKa1rZqKiun2YGL5sa2u";
const std::string sha512 =
    "$6$saltstring$AIsRs/Ee56G/"
    "tC8MEHhvReZTfx8u3rXXMl6eYrjCG9ibix19DxoMBLogdTET5Ukw9Sf7eZTITsuk0Ry5qulYz.";

std::string problemOf(const std::string& text)
{
    try {
        const Passwords passwords(text, "file");
        return "";
    } catch (const std::runtime_error& error) {
        return error.what();
    }
}

TEST(PasswordsTest, KnowThreeSchemes)
{
    const Passwords passwords(
        "# who may ask\n\nann:" + yescrypt + "\nbob:" + bcrypt + "\r\ncarl smith:" + sha512,
        "file");
    for (const std::string user : {"ann", "bob", "carl smith"}) {
        EXPECT_TRUE(passwords.matches(user, "secret")) << user;
        EXPECT_FALSE(passwords.matches(user, "Secret")) << user;
        EXPECT_FALSE(passwords.matches(user, "")) << user;
    }
    EXPECT_FALSE(passwords.matches("dora", "secret"));
    EXPECT_FALSE(passwords.matches("", "secret"));
}

std::clock_t costOfTrying(const Passwords& passwords, const std::string& user)
{
    const std::clock_t begin = std::clock();
    EXPECT_FALSE(passwords.matches(user, "wrong"));
    return std::clock() - begin;
}

TEST(PasswordsTest, UnknownUsersCostAsMuchAsTheDearestHash)
{
    const Passwords passwords(
        "ann:" + sha512 + "\nbob:" + dearBcrypt + "\ncarl:" + yescrypt, "file");
    const std::clock_t dear = costOfTrying(passwords, "bob");
    EXPECT_LT(costOfTrying(passwords, "ann"), dear / 2);
    EXPECT_GT(costOfTrying(passwords, "dora"), dear / 2);
}

TEST(PasswordHashTest, KnowsWhichHashesAreDear)
{
    using Host::Http::costOf;
    EXPECT_LT(costOf(sha512), costOf(dearBcrypt));
    EXPECT_LT(costOf(bcrypt), costOf(sha512));
    EXPECT_LT(costOf(yescrypt), costOf(dearBcrypt));
    EXPECT_LT(costOf(yescrypt), costOf("$y$j9T$"));
    EXPECT_LT(costOf("$y$j95$"), costOf("$y$j9T$"));
    EXPECT_LT(costOf("$6$rounds=1000$"), costOf(sha512));
    EXPECT_LT(costOf(sha512), costOf("$6$rounds=100000$"));
}

TEST(PasswordsTest, MistakesAreNamedWithTheirLine)
{
    const std::string good = "ann:" + sha512 + "\n";
    EXPECT_EQ(problemOf(good), "");
    EXPECT_EQ(problemOf(""), "file: it names no user");
    EXPECT_EQ(problemOf("# none\n\n"), "file: it names no user");
    EXPECT_EQ(problemOf(good + "bob"), "file:2: it is no user:hash");
    EXPECT_EQ(problemOf("\n" + good + good), "file:3: a second line for ann");
    EXPECT_THAT(problemOf(":" + sha512), HasSubstr("file:1: the user has no name"));
    EXPECT_THAT(problemOf("a\tb:" + sha512), HasSubstr("file:1: the user has no name"));
    for (const std::string& hash :
        {std::string(), std::string("secret"), std::string("*"),
            std::string("$1$salt$qJH7.N4xYta3aEG/dfqo/0"), sha512 + "x", sha512 + ":x",
            std::string("$6$salt$short"), std::string("$y$$$"), std::string("$2b$04$short"),
            " " + sha512, std::string("$5$saltstring$5B8vYYiY.CVt1RlTTf8KbXBH3hsxY/GNooZaBBGWEc8")})
        EXPECT_THAT(problemOf("ann:" + hash), HasSubstr("file:1: the password of ann is no"))
            << hash;
}

class PasswordFileTest : public testing::Test {
protected:
    std::string write(::mode_t mode) const
    {
        const std::string file = folder_.write("passwords", "ann:" + sha512 + "\n");
        ::chmod(file.c_str(), mode);
        return file;
    }
    std::string problemWith(const std::string& file) const
    {
        try {
            Passwords::read(file);
            return "";
        } catch (const std::runtime_error& error) {
            return error.what();
        }
    }

    Testing::TemporaryFolder folder_;
};

TEST_F(PasswordFileTest, OthersMustNotReachIt)
{
    for (const ::mode_t mode : {0600U, 0640U, 0400U})
        EXPECT_EQ(problemWith(write(mode)), "") << std::oct << mode;
    for (const ::mode_t mode : {0644U, 0660U, 0602U, 0606U})
        EXPECT_THAT(problemWith(write(mode)), AllOf(HasSubstr("passwords: "), HasSubstr("chmod")))
            << std::oct << mode;
}

TEST_F(PasswordFileTest, OthersMustNotOwnIt)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "only root can give files away";
    const std::string file = write(0600);
    constexpr ::uid_t somebody = 65534;
    ASSERT_EQ(::chown(file.c_str(), somebody, 0), 0);
    EXPECT_THAT(problemWith(file), AllOf(HasSubstr("passwords: "), HasSubstr("chown")));
    ::chmod(folder_.path().c_str(), 0711);
    ASSERT_EQ(::seteuid(somebody), 0);
    const std::string hisOwn = problemWith(file);
    ASSERT_EQ(::seteuid(0), 0);
    EXPECT_EQ(hisOwn, "");
}

TEST_F(PasswordFileTest, WhatIsNoFileIsRefused)
{
    EXPECT_THAT(problemWith(folder_.path() / "none"), HasSubstr("none: No such file"));
    EXPECT_THAT(problemWith(folder_.path()), HasSubstr("it is no regular file"));
    EXPECT_THAT(problemWith("/dev/zero"), HasSubstr("it is no regular file"));
    const std::string large = folder_.write("large", std::string(2'000'000, '#'));
    ::chmod(large.c_str(), 0600);
    EXPECT_THAT(problemWith(large), HasSubstr("larger than a megabyte"));
}

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
    const std::string body = bodyFor("EnumerateClasses");
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
    const std::string body = bodyFor("EnumerateClasses");
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
