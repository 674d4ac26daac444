// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/logging/LogFile.h"
#include "tests/platform/logging/SyslogCapture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace SyslogTests {

using testing::AllOf;
using testing::HasSubstr;
using Testing::logLine;
using Testing::ScopedLogSettings;
using Testing::takeSyslogLines;

// RFC 5424: facility 3 (daemon) times 8, and the severity.
constexpr int daemonError = 3 * 8 + 3;
constexpr int daemonInformation = 3 * 8 + 6;
constexpr int daemonWarning = 3 * 8 + 4;
constexpr int daemonDebug = 3 * 8 + 7;

class SyslogSinkTest : public testing::Test {
protected:
    SyslogSinkTest() { takeSyslogLines(); }
};

TEST_F(SyslogSinkTest, WritesTheLineWithoutATime)
{
    const ScopedLogSettings settings({3000, "syslog", "off"});
    logLine("some text", 6000);
    const auto lines = takeSyslogLines();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(lines[0].text, "log 6000 Nimbrel.Sensor setVector(Sensor:740) some text");
}

TEST_F(SyslogSinkTest, MessagesAreWarningsAndMarksAreDebug)
{
    const ScopedLogSettings settings({3000, "syslog", "off"});
    for (const int level : {3000, 5999, 6000, 7000})
        logLine("text", level);
    const auto lines = takeSyslogLines();
    ASSERT_EQ(lines.size(), 4U);
    EXPECT_EQ(lines[0].priority, daemonDebug);
    EXPECT_EQ(lines[1].priority, daemonDebug);
    EXPECT_EQ(lines[2].priority, daemonWarning);
    EXPECT_EQ(lines[3].priority, daemonWarning);
}

TEST_F(SyslogSinkTest, MessagesHaveTheirSeverity)
{
    const ScopedLogSettings settings({6000, "syslog", "off"});
    for (const auto severity : {RynLog::Severity::error, RynLog::Severity::information})
        RynLog::RynLogger::logMessage(severity, "f", "F", 1, "Http", "text");
    const auto lines = takeSyslogLines();
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_EQ(lines[0].priority, daemonError);
    EXPECT_EQ(lines[1].priority, daemonInformation);
}

TEST_F(SyslogSinkTest, TextIsNotTakenAsAFormatAndIsEscaped)
{
    const ScopedLogSettings settings({6000, "syslog", "off"});
    logLine("%s%n\nforged");
    const auto lines = takeSyslogLines();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_THAT(lines[0].text, testing::EndsWith(" %s%n\\nforged"));
}

TEST_F(SyslogSinkTest, TheProcessKeepsItsOwnSyslogSettings)
{
    const int before = Testing::syslogSettingsChanged();
    {
        const ScopedLogSettings settings({6000, "syslog", "syslog"});
        logLine("text");
    }
    EXPECT_EQ(Testing::syslogSettingsChanged(), before);
}

TEST_F(SyslogSinkTest, AFileThatCannotBeOpenedIsReportedOnceAndItsLinesAreLost)
{
    testing::internal::CaptureStderr();
    const ScopedLogSettings settings({6000, "file:/nowhere\n/at all", "off"});
    logLine("lost");
    logLine("lost");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    EXPECT_FALSE(RynLog::RynLogger::isWanted(6000));
    EXPECT_EQ(RynLog::RynLogger::logProblem(),
        "cannot open the log file /nowhere\\n/at all: No such file or directory");
    const auto lines = takeSyslogLines();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(lines[0].priority, daemonWarning);
    EXPECT_THAT(lines[0].text,
        AllOf(HasSubstr("/nowhere\\n/at all"), HasSubstr("No such file or directory")));
}

TEST_F(SyslogSinkTest, AFileThatTakesNoLinesIsReportedOnce)
{
    testing::internal::CaptureStderr();
    const ScopedLogSettings settings({6000, "file:/dev/full", "off"});
    EXPECT_EQ(RynLog::RynLogger::logProblem(), "");
    logLine("lost");
    logLine("lost");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    const std::string problem = "cannot write the log file /dev/full: No space left on device";
    EXPECT_EQ(RynLog::RynLogger::logProblem(), problem);
    const auto lines = takeSyslogLines();
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(lines[0].priority, daemonWarning);
    EXPECT_EQ(lines[0].text, problem + "; its lines are lost");
}

TEST_F(SyslogSinkTest, AProblemWithTheSettingsDoesNotFailOnAFullDisk)
{
    EXPECT_NO_THROW(const ScopedLogSettings settings({6000, "file:/dev/full", "off", "a problem"}));
    EXPECT_EQ(takeSyslogLines().size(), 1U);
}

TEST_F(SyslogSinkTest, TheOtherChannelGoesOnWhenAFileCannotBeOpened)
{
    const Testing::LogFile file;
    const ScopedLogSettings settings({6000, "file:/nowhere/at/all", file.sink()});
    logLine("lost");
    Testing::traceLine("kept");
    EXPECT_EQ(file.lines().size(), 1U);
}

} // namespace SyslogTests
