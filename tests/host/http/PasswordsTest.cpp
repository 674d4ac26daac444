// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Password files and their hashes.

#include "host/http/Passwords.h"
#include "tests/host/http/Hashes.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/Requirement.h"
#include "tests/support/TemporaryFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <ctime>
#include <sys/stat.h>
#include <unistd.h>

namespace HttpTests {

namespace {

using Host::Http::Passwords;
using testing::AllOf;
using testing::HasSubstr;

std::string problemOf(const std::string& text)
{
    return Testing::errorOf([&] { const Passwords passwords(text, "file"); });
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
        return Testing::errorOf([&] { Passwords::read(file); });
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
        return Testing::cannotRun("only root can give files away");
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

} // namespace

} // namespace HttpTests
