// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LogSettings.h"
#include "tests/platform/logging/LogFile.h"
#include "tests/support/Environment.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace LogSettingsTests {

using RynLog::settingsFromEnvironment;
using testing::AllOf;
using Testing::EnvironmentVariable;
using testing::HasSubstr;
using testing::SizeIs;

// Returns the settings for the values of the three variables in the order level, log, trace.
RynLog::LogSettings configured(
    const std::string& level, const std::string& log, const std::string& trace)
{
    const EnvironmentVariable levelVariable("RYNLOG_LEVEL", level);
    const EnvironmentVariable logVariable("RYNLOG_LOG", log);
    const EnvironmentVariable traceVariable("RYNLOG_TRACE", trace);
    return settingsFromEnvironment();
}

TEST(LogSettingsTest, TakesTheDefaultsWhenNothingIsSet)
{
    const auto configuration = configured("", "", "");
    EXPECT_EQ(configuration.level, 6000);
    EXPECT_EQ(configuration.log, "syslog");
    EXPECT_EQ(configuration.trace, "off");
    EXPECT_EQ(configuration.problem, "");
}

TEST(LogSettingsTest, TakesTheValuesOfTheEnvironment)
{
    const auto configuration = configured("3000", "stderr", "file:/some/where");
    EXPECT_EQ(configuration.level, 3000);
    EXPECT_EQ(configuration.log, "stderr");
    EXPECT_EQ(configuration.trace, "file:/some/where");
    EXPECT_EQ(configuration.problem, "");
}

TEST(LogSettingsTest, AcceptsEverySink)
{
    for (const std::string sink : {"syslog", "stderr", "off", "file:x"})
        EXPECT_EQ(configured("", sink, sink).problem, "") << sink;
}

TEST(LogSettingsTest, ABadLevelIsNamedAndTheDefaultTaken)
{
    for (const std::string level :
        {"high", "60OO", " 6000", "6000 ", "0x10", "1e3", "99999999999999999999", "-", "3000\n"}) {
        const auto configuration = configured(level, "", "");
        EXPECT_EQ(configuration.level, 6000) << level;
        EXPECT_THAT(configuration.problem,
            AllOf(HasSubstr("RYNLOG_LEVEL"), HasSubstr(level), HasSubstr("6000")));
    }
}

TEST(LogSettingsTest, ABadSinkIsNamedAndItsDefaultTaken)
{
    for (const std::string sink : {"file:", "file", "Syslog", "stdout", " off", "/tmp/x"}) {
        const auto configuration = configured("", sink, sink);
        EXPECT_EQ(configuration.log, "syslog") << sink;
        EXPECT_EQ(configuration.trace, "off") << sink;
        EXPECT_THAT(configuration.problem,
            AllOf(HasSubstr("RYNLOG_LOG=" + sink), HasSubstr("RYNLOG_TRACE=" + sink)));
    }
}

TEST(LogSettingsTest, AProblemIsTheFirstLineOfTheLogChannel)
{
    const Testing::LogFile file;
    const Testing::ScopedLogSettings settings(
        {6000, file.sink(), file.sink(), "RYNLOG_LEVEL=high makes no sense"});
    Testing::logLine("second");
    ASSERT_THAT(file.lines(), SizeIs(2));
    EXPECT_THAT(file.lines()[0],
        AllOf(HasSubstr(" log 6000 RynLog "), HasSubstr("RYNLOG_LEVEL=high makes no sense")));
    EXPECT_THAT(file.lines()[1], HasSubstr("second"));
}

TEST(LogSettingsTest, ASinkThatMakesNoSenseChangesNothing)
{
    const Testing::LogFile file;
    const Testing::ScopedLogSettings settings({6000, file.sink(), "off"});
    EXPECT_THROW(RynLog::configure({6000, "nowhere", "off"}), std::invalid_argument);
    EXPECT_THROW(RynLog::configure({6000, "off", "nowhere"}), std::invalid_argument);
    Testing::logLine("still here");
    EXPECT_THAT(file.lines(), SizeIs(1));
}

} // namespace LogSettingsTests
