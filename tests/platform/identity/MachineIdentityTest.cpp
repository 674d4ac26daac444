// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/identity/MachineIdentity.h"

#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <numeric>

namespace {

class MachineIdentityTest : public testing::Test {
protected:
    MachineIdentityTest() { std::iota(application_.begin(), application_.end(), 0); }

    // What becomes of a machine identifier file with that content.
    std::optional<std::string> idFrom(const std::string& content) const
    {
        return Vorn::machineIdFor(application_, folder_.write("machine-id", content).c_str());
    }

    Testing::TemporaryFolder folder_;
    Vorn::ApplicationId application_{};
};

// Reckoned with another implementation of HMAC-SHA256.
constexpr const char* expected = "69555512-96e8-465a-b2c0-6bb623000ec2";

TEST_F(MachineIdentityTest, IsTheKeyedHashAsARandomUuid)
{
    EXPECT_EQ(idFrom("0123456789abcdef0123456789abcdef\n"), expected);
}

TEST_F(MachineIdentityTest, LineFeedAndLetterCaseOfTheFileMakeNoDifference)
{
    EXPECT_EQ(idFrom("0123456789ABCDEF0123456789abcdef"), expected);
}

TEST_F(MachineIdentityTest, DiffersByMachineAndByApplication)
{
    const auto id = idFrom("0123456789abcdef0123456789abcdef\n");
    EXPECT_NE(idFrom("0123456789abcdef0123456789abcdee\n"), id);
    application_[15] = 0;
    EXPECT_NE(idFrom("0123456789abcdef0123456789abcdef\n"), id);
}

TEST_F(MachineIdentityTest, ThereIsNoneWithoutAFile)
{
    EXPECT_EQ(Vorn::machineIdFor(application_, "/no/such/file"), std::nullopt);
    EXPECT_EQ(Vorn::machineIdFor(application_, folder_.path().c_str()), std::nullopt);
}

TEST_F(MachineIdentityTest, ThereIsNoneInAFileThatHoldsNoIdentifier)
{
    for (const char* const content :
        {"", "\n", "uninitialized\n", "0123456789abcdef0123456789abcde\n",
            "0123456789abcdef0123456789abcdef0\n", "0123456789abcdef 0123456789abcdef\n",
            "0123456789abcdef0123456789abcdeg\n", "01-23456789abcdef0123456789abcde\n"})
        EXPECT_EQ(idFrom(content), std::nullopt) << content;
}

} // namespace
