// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/logging/LogFile.h"
#include "tests/support/Pattern.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <ctime>
#include <filesystem>
#include <limits>

namespace SinksTests {

using RynLog::RynLogger;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using Testing::LogFile;
using Testing::logLine;
using Testing::Pattern;
using Testing::ScopedLogSettings;
using testing::SizeIs;
using Testing::traceLine;

std::string utcSecond()
{
    const std::time_t now = std::time(nullptr);
    std::tm parts{};
    ::gmtime_r(&now, &parts);
    std::array<char, 32> text{};
    std::strftime(text.data(), text.size(), "%Y-%m-%dT%H:%M:%S", &parts);
    return text.data();
}

TEST(FileSinkTest, WritesTheDocumentedLine)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    logLine("some text");
    ASSERT_THAT(file.lines(), SizeIs(1));
    const Pattern format(R"(\d{4}-\d\d-\d\dT\d\d:\d\d:\d\d\.\d{6}Z )"
                         R"(log 6000 Nimbrel\.Sensor setVector\(Sensor:740\) some text)");
    EXPECT_TRUE(format.matches(file.lines()[0])) << file.lines()[0];
}

TEST(FileSinkTest, TimeIsUtcWhateverTheZone)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    const std::string before = utcSecond();
    logLine("now");
    const std::string after = utcSecond();
    const std::string written = file.lines().at(0).substr(0, before.size());
    EXPECT_LE(before, written);
    EXPECT_GE(after, written);
}

TEST(FileSinkTest, TheTwoChannelsLeadToTheirSettings)
{
    const LogFile log, trace;
    const ScopedLogSettings settings({6000, log.sink(), trace.sink()});
    logLine("to the log");
    traceLine("to the trace");
    EXPECT_THAT(log.lines(), ElementsAre(HasSubstr("Z log 6000 ")));
    EXPECT_THAT(trace.lines(), ElementsAre(HasSubstr("Z trace 6000 ")));
}

TEST(FileSinkTest, BothChannelsMayShareAFile)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), file.sink()});
    logLine("first");
    traceLine("second");
    logLine("third");
    EXPECT_THAT(
        file.lines(), ElementsAre(EndsWith("first"), EndsWith("second"), EndsWith("third")));
}

TEST(FileSinkTest, AppendsToWhatIsThere)
{
    const LogFile file;
    std::ofstream(file.path()) << "old line\n";
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    logLine("new line");
    EXPECT_THAT(file.lines(), ElementsAre("old line", EndsWith("new line")));
}

TEST(FileSinkTest, ALineIsOnDiskWhenTheCallReturns)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    logLine("one");
    EXPECT_THAT(file.lines(), SizeIs(1));
    logLine("two");
    EXPECT_THAT(file.lines(), SizeIs(2));
}

TEST(FileSinkTest, ATextCannotForgeALine)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    EXPECT_EQ(RynLogger::logProblem(), "");
    logLine("name\n2026-11-21T01:02:03.000004Z log 6000 forged f(F:1) text");
    ASSERT_THAT(file.lines(), SizeIs(1));
    EXPECT_THAT(file.lines()[0], HasSubstr("name\\n2026-11-21T"));
}

TEST(FileSinkTest, TextIsNotTakenAsAFormat)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    logLine("{} {0} %s %n %v");
    EXPECT_THAT(file.lines(), ElementsAre(EndsWith(" {} {0} %s %n %v")));
}

TEST(FileSinkTest, LongLinesStayWhole)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    const std::string text(1'000'000, 'x');
    logLine(text);
    EXPECT_THAT(file.lines(), ElementsAre(EndsWith(" " + text)));
}

TEST(FileSinkTest, NullTextsAreWrittenAsNull)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    RynLogger::logLevelMessage(nullptr, nullptr, 1, "", 6000, nullptr, 0, 0, "");
    EXPECT_THAT(file.lines(), ElementsAre(EndsWith(" log 6000  (null)((null):1) ")));
}

TEST(FileSinkTest, AFileThatIsRotatedAwayIsOpenedAnew)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    logLine("first");
    std::filesystem::rename(file.path(), file.path() + ".1");
    logLine("second");
    EXPECT_THAT(file.lines(), ElementsAre(EndsWith("second")));
    std::filesystem::remove(file.path());
    logLine("third");
    EXPECT_THAT(file.lines(), ElementsAre(EndsWith("third")));
    EXPECT_THAT(
        Testing::linesOf(Testing::contentOf(file.path() + ".1")), ElementsAre(EndsWith("first")));
}

TEST(FileSinkTest, ARelativePathStaysThatOfTheFirstFolder)
{
    const Testing::TemporaryFolder first, second;
    const auto before = std::filesystem::current_path();
    std::filesystem::current_path(first.path());
    const ScopedLogSettings settings({6000, "file:lines", "off"});
    std::filesystem::current_path(second.path());
    logLine("text");
    std::filesystem::current_path(before);
    EXPECT_THAT(Testing::linesOf(Testing::contentOf((first.path() / "lines").string())), SizeIs(1));
    EXPECT_TRUE(std::filesystem::is_empty(second.path()));
}

TEST(FileSinkTest, AFileThatCannotBeOpenedAnewIsKept)
{
    const LogFile file;
    const ScopedLogSettings settings({6000, file.sink(), "off"});
    std::filesystem::rename(file.path(), file.path() + ".1");
    std::filesystem::create_directory(file.path());
    logLine("text");
    EXPECT_THAT(Testing::linesOf(Testing::contentOf(file.path() + ".1")), SizeIs(1));
}

TEST(FileSinkTest, APipeThatNobodyReadsIsNotWaitedFor)
{
    const Testing::TemporaryFolder folder;
    const std::string pipe = (folder.path() / "pipe").string();
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    const ScopedLogSettings settings({6000, "file:" + pipe, "off"});
    logLine("lost");
    EXPECT_FALSE(RynLogger::isWanted(6000));
}

TEST(StandardErrorSinkTest, WritesTheDocumentedLine)
{
    testing::internal::CaptureStderr();
    {
        const ScopedLogSettings settings({6000, "stderr", "stderr"});
        logLine("one");
        traceLine("two");
    }
    const std::string written = testing::internal::GetCapturedStderr();
    const Pattern format(R"(\S+Z log 6000 Nimbrel\.Sensor setVector\(Sensor:740\) one\n)"
                         R"(\S+Z trace 6000 Nimbrel\.Sensor setVector\(Sensor:740\) two\n)");
    EXPECT_TRUE(format.matches(written)) << written;
}

TEST(StandardErrorSinkTest, ABrokenPipeDoesNotEndTheProcess)
{
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe(ends.data()), 0);
    ASSERT_EQ(::close(ends[0]), 0);
    const int standardError = ::dup(STDERR_FILENO);
    ASSERT_GE(::dup2(ends[1], STDERR_FILENO), 0);
    {
        const ScopedLogSettings settings({6000, "stderr", "off"});
        logLine("lost"); // SIGPIPE would terminate this process
    }
    ::dup2(standardError, STDERR_FILENO);
    ::close(standardError);
    ::close(ends[1]);
    sigset_t pending{};
    ASSERT_EQ(::sigpending(&pending), 0);
    EXPECT_EQ(::sigismember(&pending, SIGPIPE), 0);
}

TEST(StandardErrorSinkTest, APipeThatNobodyReadsIsNotWaitedFor)
{
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe(ends.data()), 0);
    const int standardError = ::dup(STDERR_FILENO);
    ASSERT_GE(::dup2(ends[1], STDERR_FILENO), 0);
    std::string problem;
    {
        const ScopedLogSettings settings({6000, "stderr", "off"});
        for (int i = 0; i < 20; ++i) // the pipe holds 64 KiB
            logLine(std::string(10'000, 'x'));
        problem = RynLogger::logProblem();
    }
    ::dup2(standardError, STDERR_FILENO);
    for (const int descriptor : {standardError, ends[0], ends[1]})
        ::close(descriptor);
    EXPECT_EQ(problem, "cannot write the log to standard error: Resource temporarily unavailable");
}

TEST(OffSinkTest, NothingIsWantedAndNothingPrinted)
{
    testing::internal::CaptureStderr();
    testing::internal::CaptureStdout();
    const ScopedLogSettings settings({0, "off", "off"});
    logLine("lost");
    traceLine("lost");
    EXPECT_FALSE(RynLogger::isWanted(6000));
    EXPECT_FALSE(RynLogger::isWanted(std::numeric_limits<int>::max()));
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "");
}

TEST(OffSinkTest, OneOpenChannelIsEnoughToWantALine)
{
    const LogFile file;
    const ScopedLogSettings settings({3000, "off", file.sink()});
    EXPECT_TRUE(RynLogger::isWanted(3000));
    logLine("lost");
    traceLine("kept");
    EXPECT_THAT(file.lines(), ElementsAre(EndsWith("kept")));
}

TEST(LevelTest, LinesFromTheLevelUpAreWritten)
{
    const LogFile file;
    const ScopedLogSettings settings({4000, file.sink(), file.sink()});
    EXPECT_FALSE(RynLogger::isWanted(3999));
    EXPECT_TRUE(RynLogger::isWanted(4000));
    EXPECT_TRUE(RynLogger::isWanted(4001));
    for (const int level : {3999, 4000, 4001}) {
        logLine("line", level);
        traceLine("line", level);
    }
    EXPECT_THAT(file.lines(), ElementsAre(HasSubstr("log 4000"), HasSubstr("trace 4000"),
                                  HasSubstr("log 4001"), HasSubstr("trace 4001")));
}

TEST(LevelTest, AnyLevelIsPossible)
{
    const LogFile file;
    const ScopedLogSettings settings({std::numeric_limits<int>::min(), file.sink(), "off"});
    logLine("lowest", std::numeric_limits<int>::min());
    EXPECT_THAT(file.lines(), SizeIs(1));
}

} // namespace SinksTests
