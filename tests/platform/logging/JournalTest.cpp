// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Standard error as systemd connects it to the journal.

#include "platform/logging/PipeSignal.h"
#include "tests/platform/logging/LogFile.h"
#include "tests/support/Environment.h"

#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

namespace JournalTests {

using RynLog::RynLogger;
using RynLog::Severity;
using Testing::EnvironmentVariable;
using Testing::logLine;
using Testing::ScopedLogSettings;
using Testing::traceLine;

std::string standardErrorStream()
{
    struct stat status {};
    EXPECT_EQ(::fstat(STDERR_FILENO, &status), 0);
    return std::to_string(status.st_dev) + ":" + std::to_string(status.st_ino);
}

// Returns what the action writes to standard error, which is the journal.
template <typename Action>
std::string journalOf(const RynLog::LogSettings& settings, const Action& action)
{
    testing::internal::CaptureStderr();
    {
        const EnvironmentVariable stream("JOURNAL_STREAM", standardErrorStream());
        const ScopedLogSettings scoped(settings);
        action();
    }
    return testing::internal::GetCapturedStderr();
}

TEST(JournalTest, MessagesAreTheirSeverityAndTheirText)
{
    const auto message = [](Severity severity) {
        RynLogger::logMessage(severity, "f", "F", 1, "Http", "some text");
    };
    EXPECT_EQ(journalOf({6000, "stderr", "off"},
                  [&] {
                      logLine("some text");
                      message(Severity::error);
                      message(Severity::warning);
                      message(Severity::information);
                  }),
        "<4>some text\n<3>some text\n<4>some text\n<6>some text\n");
}

TEST(JournalTest, LinesHaveTheirOriginWhileDebugging)
{
    EXPECT_EQ(journalOf({4000, "stderr", "off"},
                  [] {
                      logLine("some text", 4000);
                      logLine("some text", 6000);
                  }),
        "<7>log 4000 Nimbrel.Sensor setVector(Sensor:740) some text\n"
        "<4>log 6000 Nimbrel.Sensor setVector(Sensor:740) some text\n");
}

TEST(JournalTest, TraceHasItsOrigin)
{
    EXPECT_EQ(journalOf({6000, "off", "stderr"}, [] { traceLine("some text"); }),
        "<4>trace 6000 Nimbrel.Sensor setVector(Sensor:740) some text\n");
}

TEST(JournalTest, TextCannotForgeALine)
{
    EXPECT_EQ(journalOf({6000, "stderr", "off"}, [] { logLine("a\n<0>b"); }), "<4>a\\n<0>b\n");
}

TEST(JournalTest, AnotherStreamIsNoJournal)
{
    testing::internal::CaptureStderr();
    {
        const EnvironmentVariable stream("JOURNAL_STREAM", standardErrorStream() + "0");
        const ScopedLogSettings settings({6000, "stderr", "off"});
        logLine("some text");
    }
    EXPECT_NE(testing::internal::GetCapturedStderr().find("Z log 6000 "), std::string::npos);
}

TEST(FailureLineTest, IsWrittenUnlessItIsSwitchedOff)
{
    for (const auto& [setting, written] :
        {std::pair("", "a failure\n"), {"on", "a failure\n"}, {"off", ""}}) {
        const EnvironmentVariable variable("RYNLOG_STDERR", setting);
        testing::internal::CaptureStderr();
        RynLog::reportToStandardError("a failure\n");
        EXPECT_EQ(testing::internal::GetCapturedStderr(), written) << setting;
    }
}

} // namespace JournalTests
