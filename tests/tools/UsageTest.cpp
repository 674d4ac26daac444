// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::MatchesRegex;
using testing::StartsWith;
using namespace Testing;

TEST(UsageTest, HelpGoesToStandardOutput)
{
    const Ended ended = run({"--help"});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_THAT(ended.out, AllOf(HasSubstr("list"), HasSubstr("get"), HasSubstr("walk"),
                               HasSubstr("record"), HasSubstr("Exit codes")));
}

TEST(UsageTest, EveryCommandHasItsHelp)
{
    for (const char* const command :
        {"list", "get", "walk", "watch", "check", "record", "collect", "serve"}) {
        const Ended ended = run({command, "--help"});
        EXPECT_EQ(ended.code, 0);
        EXPECT_THAT(ended.out, HasSubstr(std::string("sensorctl ") + command));
    }
}

TEST(UsageTest, HelpFitsIntoEightyColumns)
{
    for (const std::vector<std::string>& arguments :
        std::vector<std::vector<std::string>>{{"--help"}, {"list", "--help"}, {"get", "--help"},
            {"walk", "--help"}, {"watch", "--help"}, {"check", "--help"}, {"record", "--help"},
            {"collect", "--help"}, {"serve", "--help"}})
        for (const std::string& line : linesOf(run(arguments).out))
            EXPECT_LE(line.size(), 80U) << line;
}

TEST(UsageTest, HelpOfCollectFitsIntoTwentyFourLines)
{
    EXPECT_LE(linesOf(run({"collect", "--help"}).out).size(), 24U);
}

TEST(UsageTest, VersionNamesTheToolAndTheInterface)
{
    const Ended ended = run({"--version"});
    EXPECT_EQ(ended.code, 0);
    EXPECT_THAT(ended.out, MatchesRegex("sensorctl [0-9]+\\.[0-9]+\\.[0-9]+ \\(CMPI 2\\.0\\)\n"));
}

TEST(UsageTest, WrongUsageIsSaidAndEndsWithTwo)
{
    for (const std::vector<std::string>& arguments :
        std::vector<std::vector<std::string>>{{}, {"frobnicate"}, {"list", "--kind", "humidity"},
            {"watch", "--interval", "0"}, {"list", "--csv", "--json"}, {"list", "--cim", "--flat"},
            {"list", "--frobnicate"}, {"list", "--model"}, {"list", "--color", "blue"}, {"get"},
            {"walk", "one", "two"}, {"walk", "--json"}, {"record", "extra"},
            {"collect", "--interval", "0"}, {"collect", "--workaround", "none"}}) {
        const Ended ended = run(arguments);
        EXPECT_EQ(ended.code, 2) << testing::PrintToString(arguments);
        EXPECT_EQ(ended.out, "");
        EXPECT_THAT(ended.err, StartsWith("sensorctl: "));
        EXPECT_EQ(linesOf(ended.err).size(), 1U) << ended.err;
    }
}

TEST(UsageTest, SecondFormOfOutputIsWrong)
{
    for (const char* const command : {"list", "get"})
        EXPECT_THAT(run({command, "a", "--json", "--cim"}).err,
            StartsWith("sensorctl: only one form of output can be given"));
}

TEST(UsageTest, WhatWasTypedIsNotObeyedByTheTerminal)
{
    EXPECT_THAT(run({"\x1B[31m"}).err, HasSubstr("\\x1B[31m"));
}

} // namespace
