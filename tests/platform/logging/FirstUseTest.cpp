// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The log of a process that never calls configure(). Each statement runs in a new process, since
// the configuration takes effect only once.

#include "tests/platform/logging/LogFile.h"
#include "tests/platform/logging/SyslogCapture.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>

namespace FirstUseTests {

using Testing::logLine;
using Testing::traceLine;

class FirstUseTest : public testing::Test {
protected:
    FirstUseTest() { GTEST_FLAG_SET(death_test_style, "threadsafe"); }
};

void set(const char* level, const char* log, const char* trace)
{
    ::setenv("RYNLOG_LEVEL", level, 1);
    ::setenv("RYNLOG_LOG", log, 1);
    ::setenv("RYNLOG_TRACE", trace, 1);
}

void printSyslog()
{
    for (const auto& line : Testing::takeSyslogLines())
        std::fprintf(stderr, "syslog: %s\n", line.text.c_str());
}

TEST_F(FirstUseTest, ALineFindsTheChannelsOfTheEnvironment)
{
    EXPECT_EXIT(
        {
            set("4000", "stderr", "stderr");
            logLine("mark", 4000);
            traceLine("parameters", 3000);
            std::exit(0); // destructors of static objects run, too
        },
        testing::ExitedWithCode(0), "^[^ ]+Z log 4000 Nimbrel.Sensor [^ ]+ mark\n$");
}

TEST_F(FirstUseTest, AskingWhatIsWantedReadsTheEnvironmentToo)
{
    EXPECT_EXIT(
        {
            set("4000", "stderr", "off");
            const bool right =
                RynLog::RynLogger::isWanted(4000) && !RynLog::RynLogger::isWanted(3999);
            std::exit(right ? 0 : 1);
        },
        testing::ExitedWithCode(0), "^$");
}

TEST_F(FirstUseTest, BadValuesAreReportedInTheFirstLineAndTheDefaultsTaken)
{
    EXPECT_EXIT(
        {
            set("high", "nowhere", "nowhere");
            logLine("second", 6000);
            logLine("too low", 5999);
            printSyslog();
            std::exit(0);
        },
        testing::ExitedWithCode(0),
        "^syslog: log 6000 RynLog .*RYNLOG_LEVEL=high .*RYNLOG_LOG=nowhere "
        ".*RYNLOG_TRACE=nowhere [^\n]*\nsyslog: log 6000 Nimbrel.Sensor [^\n]*second\n$");
}

// Constructed before every other static object, so destroyed after them.
struct LastToGo {
    bool logs = false;
    ~LastToGo()
    {
        if (logs)
            logLine("after the end");
    }
};
__attribute__((init_priority(101))) LastToGo lastToGo;

TEST_F(FirstUseTest, ALineAfterTheEndOfTheChannelsIsLostQuietly)
{
    EXPECT_EXIT(
        {
            set("6000", "stderr", "stderr");
            lastToGo.logs = true;
            logLine("before the end");
            std::exit(0);
        },
        testing::ExitedWithCode(0), "^[^\n]+ before the end\n$");
}

} // namespace FirstUseTests
