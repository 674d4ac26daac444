// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The file that keeps the samples of a day.

#include "tools/history/HistoryFile.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/SensorHistoryFixture.h"
#include "tools/history/HistoryKeeper.h"

#include <gmock/gmock.h>

#include <sys/stat.h>
#include <unistd.h>

#include <cstring>
#include <filesystem>
#include <fstream>

namespace SensorHistoryTests {

using testing::HasSubstr;

class HistoryFileTest : public SensorHistoryTest {
protected:
    HistoryFileTest()
    {
        for (int i = 0; i < 10; ++i)
            add({sensorOf("a", i), sensorOf("b", std::nullopt, "WarningLow")}, 10 * i);
    }

    std::string bytes() const
    {
        std::string stored;
        storeHistory(history, [&](const void* from, std::size_t count) {
            stored.append(static_cast<const char*>(from), count);
        });
        return stored;
    }

    // Returns why the bytes are refused; an empty text when they are not.
    static std::string problemOf(std::string stored)
    {
        std::string_view rest = stored;
        return Testing::errorOf([&] {
            parseHistory([&](void* to, std::size_t count) {
                if (rest.size() < count)
                    return false;
                std::memcpy(to, rest.data(), count);
                rest.remove_prefix(count);
                return true;
            });
        });
    }

    Testing::TemporaryFolder folder;
    const std::string file = (folder.path() / "history").string();
};

TEST_F(HistoryFileTest, RestoresWhatItStored)
{
    writeHistoryFile(file, history);
    struct stat status {};
    ASSERT_EQ(::stat(file.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0600U);
    SensorHistory restored;
    readHistoryFile(file, restored);
    EXPECT_EQ(restored.newest(), history.newest());
    EXPECT_EQ(restored.deviceIds(), history.deviceIds());
    EXPECT_EQ(dayIn(restored, "a"), day("a"));
    EXPECT_EQ(dayIn(restored, "b"), day("b"));
}

TEST_F(HistoryFileTest, SamplesThatAreAddedWhileItIsWrittenAreLeftOut)
{
    const json before = hour("a");
    const SlotNumber newest = history.newest();
    add({sensorOf("a", 1000), sensorOf("b", 1000)}, 3500);
    Samples samples = history.entryUntil("a:/chip/a", newest)->samples;
    std::string text;
    appendHour(text, "a", samples, newest);
    EXPECT_EQ(last(json::parse(text)["values"], 10), last(before["values"], 10));
    EXPECT_EQ(samples.ofSlot(newest + 350).state, 0);
}

TEST_F(HistoryFileTest, NoFileIsNoError)
{
    SensorHistory restored;
    EXPECT_NO_THROW(readHistoryFile(file, restored));
    EXPECT_EQ(restored.newest(), 0);
}

TEST_F(HistoryFileTest, DamagedFileIsRefusedAndChangesNothing)
{
    writeHistoryFile(file, history);
    const std::string content = Testing::contentOf(file);
    SensorHistory restored;
    const auto problem = [&](const std::string& changed) {
        folder.write("history", changed);
        return Testing::errorOf([&] { readHistoryFile(file, restored); });
    };
    std::string flipped = content;
    flipped[flipped.size() - 5] ^= 1; // in the checksum
    EXPECT_THAT(problem(flipped), HasSubstr("history: it is damaged or truncated"));
    EXPECT_THAT(
        problem(content.substr(0, content.size() / 2)), HasSubstr("it is damaged or truncated"));
    EXPECT_THAT(
        problem(content.substr(0, content.size() - 1)), HasSubstr("it is damaged or truncated"));
    EXPECT_THAT(problem(""), HasSubstr("it is damaged or truncated"));
    EXPECT_THAT(problem("no history at all, but long enough for a header"),
        HasSubstr("it is of another version"));
    EXPECT_THAT(problem(bytes()), HasSubstr("it is damaged or truncated")); // not compressed
    EXPECT_EQ(restored.newest(), 0);
}

TEST_F(HistoryFileTest, ImpossibleNumbersAreRefused)
{
    const std::string stored = bytes();
    ASSERT_EQ(problemOf(stored), "");
    const auto with = [&](std::size_t place, char value, std::size_t count) {
        return problemOf(std::string(stored).replace(place, count, count, value));
    };
    EXPECT_EQ(with(0, 'x', 1), "it is of another version");
    EXPECT_EQ(with(8, 1, 4), "it is of another version");
    EXPECT_EQ(with(12, 1, 4), "it has too many sensors");
    EXPECT_EQ(with(16, '\x7f', 8), "it has an impossible time");
    EXPECT_EQ(with(24, '\x7f', 8), "a sensor has an impossible time");
    EXPECT_EQ(with(32, '\x7f', 8), "a sensor has an impossible name");
    EXPECT_EQ(with(40 + 9 + sizeof(Samples) - 5, '\x7f', 1), "a sensor has an impossible state");
    std::string twice = stored;
    twice[40 + 9 + sizeof(Samples) + 16] = 'a';
    twice[40 + 9 + sizeof(Samples) + 16 + 8] = 'a';
    EXPECT_EQ(problemOf(twice), "it has a sensor twice");
    EXPECT_EQ(problemOf(stored.substr(0, stored.size() - 1)), "it is damaged or truncated");
}

TEST_F(HistoryFileTest, FailureToWriteNamesTheFile)
{
    EXPECT_THAT(Testing::errorOf([&] { writeHistoryFile("/proc/none/history", history); }),
        HasSubstr("/proc/none/history.new: "));
}

TEST_F(HistoryFileTest, OnlyRegularFilesAreUsed)
{
    ASSERT_EQ(::mkfifo(file.c_str(), 0600), 0);
    EXPECT_THAT(Testing::errorOf([&] { readHistoryFile(file, history); }),
        HasSubstr("it is no regular file"));
    const std::string target = folder.write("target", "kept");
    ASSERT_EQ(::symlink(target.c_str(), (file + ".new").c_str()), 0);
    EXPECT_NE(Testing::errorOf([&] { writeHistoryFile(file, history); }), "");
    EXPECT_EQ(Testing::contentOf(target), "kept");
}

TEST_F(HistoryFileTest, KeeperWritesAtIntervalsAndAtTheEnd)
{
    SensorHistory restored;
    {
        const HistoryKeeper keeper(history, folder.path().string(), std::chrono::milliseconds(10));
        EXPECT_TRUE(Testing::waitUntil([&] { return std::filesystem::exists(file); }));
        readHistoryFile(file, restored);
        EXPECT_EQ(restored.newest(), history.newest());
    }
    std::filesystem::remove(file);
    {
        const HistoryKeeper keeper(history, folder.path().string());
    }
    EXPECT_TRUE(std::filesystem::exists(file));
}

TEST_F(HistoryFileTest, KeeperKeepsAFileOfSomethingElse)
{
    folder.write("history", "a list of kings");
    {
        const HistoryKeeper keeper(history, folder.path().string());
    }
    EXPECT_EQ(Testing::contentOf(file + ".bad"), "a list of kings");
    EXPECT_THAT(Testing::contentOf(file), testing::StartsWith("\x1f\x8b"));
}

TEST_F(HistoryFileTest, FolderHasOneKeeper)
{
    const HistoryKeeper keeper(history, folder.path().string());
    SensorHistory other;
    EXPECT_THAT(
        Testing::errorOf([&] { const HistoryKeeper second(other, folder.path().string()); }),
        HasSubstr("another process keeps its history there"));
}

} // namespace SensorHistoryTests
