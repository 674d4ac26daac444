// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/logging/LogFile.h"
#include "tests/support/Pattern.h"

#include <gtest/gtest.h>

#include <set>
#include <thread>

namespace ThreadsTests {

using Testing::LogFile;
using Testing::logLine;
using Testing::Pattern;
using Testing::ScopedLogSettings;
using Testing::traceLine;

constexpr int writers = 4;
constexpr int linesPerWriter = 500;

std::string textOf(int writer, int number)
{
    return std::to_string(writer) + "-" + std::to_string(number) + std::string(200, '.');
}

TEST(ThreadsTest, WriteWholeLinesAndLoseNone)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), file.sink()});
    {
        std::vector<std::jthread> threads;
        for (int writer = 0; writer < writers; ++writer)
            threads.emplace_back([writer] {
                for (int number = 0; number < linesPerWriter; ++number)
                    (number % 2 != 0 ? logLine : traceLine)(textOf(writer, number), 6000);
            });
    }
    const Pattern format(R"(\S{27} (log|trace) 6000 \S+ setVector\(Sensor:740\) (\d+-\d+\.{200}))");
    std::set<std::string> found;
    for (const std::string& line : file.lines()) {
        const std::vector<std::string> match = format.match(line);
        ASSERT_FALSE(match.empty()) << line;
        found.insert(match[2]);
    }
    EXPECT_EQ(found.size(), static_cast<std::size_t>(writers * linesPerWriter));
}

TEST(ThreadsTest, WriteOnWhileTheConfigurationChanges)
{
    const LogFile first, second;
    const ScopedLogSettings settings({6000, first.sink(), "off"});
    {
        std::vector<std::jthread> threads;
        for (int writer = 0; writer < writers; ++writer)
            threads.emplace_back([] {
                for (int number = 0; number < linesPerWriter; ++number)
                    logLine("line");
            });
        for (int round = 0; round < 50; ++round)
            RynLog::configure({6000, round % 2 != 0 ? first.sink() : second.sink(), "off"});
    }
    EXPECT_EQ(first.lines().size() + second.lines().size(),
        static_cast<std::size_t>(writers * linesPerWriter));
}

} // namespace ThreadsTests
