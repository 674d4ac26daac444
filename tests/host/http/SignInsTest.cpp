// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The delays and the memory of sign-ins, without sockets.

#include "host/http/SignIns.h"
#include "tests/host/http/Hashes.h"

#include <gtest/gtest.h>

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
    EXPECT_TRUE(memory.remember({"ann", "secret"}, "a", start));
    EXPECT_FALSE(memory.remember({"ann", "secret"}, "a", start));
    EXPECT_FALSE(memory.contains({"ann", "secret"}, "b", start));
    EXPECT_TRUE(memory.contains({"ann", "secret"}, "a", start));
    EXPECT_FALSE(memory.contains({"ann", "secre"}, "a", start));
    EXPECT_FALSE(memory.contains({"ann", "secrett"}, "a", start));
    EXPECT_FALSE(memory.contains({"anns", "ecret"}, "a", start));
    EXPECT_TRUE(memory.contains({"ann", "secret"}, "a", start + SignInMemory::lifetime - 1s));
    EXPECT_FALSE(memory.contains({"ann", "secret"}, "a", start + SignInMemory::lifetime));
    for (std::size_t i = 0; i < SignInMemory::capacity; ++i)
        memory.remember({"user" + std::to_string(i), "p"}, "a", start + 1s);
    EXPECT_FALSE(memory.contains({"ann", "secret"}, "a", start + 1s));
    EXPECT_TRUE(memory.contains({"user0", "p"}, "a", start + 1s));
    memory.forgetAll();
    EXPECT_FALSE(memory.contains({"user0", "p"}, "a", start + 1s));
}

TEST(SignInDelaysTest, GrowWithEachFailureOfAnAddress)
{
    SignInDelays delays(1s);
    const SignInDelays::Time start{};
    EXPECT_EQ(delays.admit("a", start), start);
    EXPECT_EQ(delays.fail("a", start), start + 1s);
    EXPECT_EQ(delays.admit("a", start), start + 1s);
    EXPECT_EQ(delays.admit("b", start), start);
    EXPECT_EQ(delays.fail("a", start + 1s), start + 3s);
    EXPECT_EQ(delays.fail("a", start + 3s), start + 7s);
    for (int i = 0; i < 10; ++i)
        delays.fail("a", start + 10s);
    EXPECT_EQ(delays.admit("a", start + 10s), start + 42s);
    const auto later = start + 10s + SignInDelays::memory + 1s;
    EXPECT_EQ(delays.fail("a", later), later + 1s);
}

TEST(SignInDelaysTest, AfterAFailureOneIsTriedAtATime)
{
    SignInDelays delays(1s);
    const SignInDelays::Time start{};
    EXPECT_EQ(delays.admit("a", start), start);
    EXPECT_EQ(delays.admit("a", start), start);
    EXPECT_EQ(delays.fail("a", start), start + 1s);
    EXPECT_EQ(delays.admit("a", start), start + 1s);
    EXPECT_EQ(delays.admit("a", start + 1s), start + 1s);
    EXPECT_EQ(delays.admit("a", start + 1s), start + 3s);
    EXPECT_EQ(delays.fail("a", start + 1s), start + 3s);
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
        delays.fail(std::to_string(i), start + std::chrono::milliseconds(i));
    EXPECT_EQ(delays.admit("9", start), start);
    EXPECT_GT(delays.admit("10", start), start);
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

TEST(SignInsTest, NobodyIsRefusedOnceNoPasswordIsDemanded)
{
    Host::Http::SignIns signIns(nullptr, 1s);
    EXPECT_FALSE(signIns.areDemanded());
    EXPECT_EQ(signIns.tryPassword({"ann", "wrong"}, "a", "a", {}), std::nullopt);
}

} // namespace

} // namespace HttpTests
