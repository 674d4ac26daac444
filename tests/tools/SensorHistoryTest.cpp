// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The samples of a day, and the file that keeps them.

#include "tests/support/ErrorOf.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"
#include "tests/support/WaitUntil.h"
#include "tools/history/HistoryFile.h"
#include "tools/history/HistoryJson.h"
#include "tools/history/HistoryKeeper.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <sys/stat.h>
#include <unistd.h>

#include <cstring>
#include <filesystem>
#include <fstream>

namespace SensorHistoryTests {

using namespace Tools;
using nlohmann::json;
using testing::HasSubstr;

// The beginning of a minute.
constexpr std::time_t start = 1'800'000'000;

Sensor sensorOf(const std::string& label, std::optional<std::int64_t> reading,
    const std::string& state = "Normal")
{
    Sensor sensor;
    sensor.setNames(label, "/chip/" + label);
    if (reading)
        sensor.reading = Quantity{*reading, 0};
    sensor.state = stateOf(state, {});
    return sensor;
}

class SensorHistoryTest : public testing::Test {
protected:
    // Adds samples at that many seconds after the start.
    void add(const std::vector<Sensor>& sensors, std::time_t seconds)
    {
        std::vector<const Sensor*> pointers;
        for (const Sensor& each : sensors)
            pointers.push_back(&each);
        history.add(pointers, std::chrono::system_clock::from_time_t(start + seconds));
    }

    template <typename Append>
    static json jsonOf(const SensorHistory& from, const std::string& label, Append append)
    {
        std::string text;
        const bool isKnown = from.visit({label + ":/chip/" + label},
            [&](const std::string&, const Samples& samples, Slot newest) {
                append(text, label, samples, newest);
            });
        return isKnown ? json::parse(text) : json();
    }
    json hour(const std::string& label) const
    {
        return jsonOf(history, label, [](auto&&... all) { appendHour(all...); });
    }
    json thinnedHour(const std::string& label) const
    {
        return jsonOf(history, label, [](auto&&... all) { appendThinnedHour(all...); });
    }
    static json dayIn(const SensorHistory& from, const std::string& label)
    {
        return jsonOf(from, label, [](auto&&... all) { appendDay(all...); });
    }
    json day(const std::string& label) const { return dayIn(history, label); }

    static json last(const json& values, std::size_t count)
    {
        return json(
            std::vector<json>(values.end() - static_cast<std::ptrdiff_t>(count), values.end()));
    }

    SensorHistory history;
};

TEST_F(SensorHistoryTest, HourHasASampleOfTenSeconds)
{
    for (int i = 0; i < 400; ++i)
        add({sensorOf("a", i)}, 10 * i);
    const json shown = hour("a");
    EXPECT_EQ(shown["values"].size(), 360U);
    EXPECT_EQ(shown["values"].front(), 40);
    EXPECT_EQ(shown["values"].back(), 399);
    EXPECT_EQ(shown["states"], json::parse(R"([["Normal", 360]])"));
    EXPECT_EQ(history.newest(), start / 10 + 399);
}

TEST_F(SensorHistoryTest, DayHasTheExtremesAndTheMostUrgentStateOfEachMinute)
{
    for (int i = 0; i < 6; ++i)
        add({sensorOf("a", 10 * i, i == 2 ? "WarningHigh" : "Normal")}, 10 * i);
    add({sensorOf("a", 7)}, 60);
    const json shown = day("a");
    EXPECT_EQ(shown["mean"].size(), 1440U);
    EXPECT_EQ(last(shown["minimum"], 3), json::parse("[null, 0, 7]"));
    EXPECT_EQ(last(shown["mean"], 3), json::parse("[null, 25, 7]"));
    EXPECT_EQ(last(shown["maximum"], 3), json::parse("[null, 50, 7]"));
    EXPECT_EQ(
        shown["states"], json::parse(R"([[null, 1438], ["Warning high", 1], ["Normal", 1]])"));
}

TEST_F(SensorHistoryTest, ThinnedHourHasMeans)
{
    for (int i = 0; i < 6; ++i)
        add({sensorOf("a", 10 * i, i == 2 ? "CriticalLow" : "Normal")}, 10 * i);
    EXPECT_EQ(thinnedHour("a")["values"].size(), 60U);
    EXPECT_EQ(thinnedHour("a")["values"].back(), 25);
    EXPECT_EQ(thinnedHour("a")["states"], json::parse(R"([[null, 59], ["Critical low", 1]])"));
}

TEST_F(SensorHistoryTest, WithoutAReadingOnlyTheStateIsRecorded)
{
    add({sensorOf("a", 1)}, 0);
    add({sensorOf("a", std::nullopt, "Offline")}, 10);
    EXPECT_EQ(last(hour("a")["values"], 2), json::parse("[1, null]"));
    EXPECT_EQ(last(hour("a")["states"], 2), json::parse(R"([["Normal", 1], ["Offline", 1]])"));
    EXPECT_EQ(day("a")["mean"].back(), 1);
}

TEST_F(SensorHistoryTest, TimeWithoutSamplesIsAGap)
{
    add({sensorOf("a", 1)}, 0);
    add({sensorOf("a", 2)}, 40);
    EXPECT_EQ(last(hour("a")["values"], 5), json::parse("[1, null, null, null, 2]"));
    add({sensorOf("a", 3)}, 40 + 3600);
    EXPECT_EQ(hour("a")["states"], json::parse(R"([[null, 359], ["Normal", 1]])"));
    EXPECT_EQ(last(day("a")["mean"], 61)[0], 1.5);
}

TEST_F(SensorHistoryTest, WhereTheClockIsSetBackLaterSamplesAreDiscarded)
{
    for (int i = 0; i < 60; ++i)
        add({sensorOf("a", i)}, 10 * i);
    add({sensorOf("a", 100)}, 300);
    EXPECT_EQ(last(hour("a")["values"], 2), json::parse("[29, 100]"));
    EXPECT_EQ(last(day("a")["maximum"], 2), json::parse("[29, 100]"));
    add({sensorOf("a", 101)}, 310);
    EXPECT_EQ(last(hour("a")["values"], 3), json::parse("[29, 100, 101]"));
    EXPECT_EQ(hour("a")["states"].back(), json::parse(R"(["Normal", 32])"));
    add({sensorOf("a", 5)}, -start); // a machine without a battery for its clock
    EXPECT_EQ(hour("a")["states"], json::parse(R"([[null, 359], ["Normal", 1]])"));
}

TEST_F(SensorHistoryTest, SensorThatIsGoneIsForgottenAfterADay)
{
    add({sensorOf("a", 1), sensorOf("b", 1)}, 0);
    add({sensorOf("b", 1)}, 10);
    EXPECT_EQ(last(hour("a")["values"], 2), json::parse("[1, null]"));
    add({sensorOf("b", 1)}, 86'400);
    EXPECT_FALSE(hour("a").is_null());
    add({sensorOf("b", 1)}, 86'420);
    EXPECT_TRUE(hour("a").is_null());
    EXPECT_FALSE(hour("b").is_null());
}

TEST_F(SensorHistoryTest, PresentSensorsAreThoseOfTheLastSampleInItsOrder)
{
    add({sensorOf("b", 1), sensorOf("a", 1), sensorOf("c", 1)}, 0);
    add({sensorOf("c", 1), sensorOf("a", 1)}, 10);
    std::vector<std::string> present;
    history.visitPresent(
        [&](const std::string& id, const Samples&, Slot) { present.push_back(id); });
    EXPECT_THAT(present, testing::ElementsAre("c:/chip/c", "a:/chip/a"));
}

TEST_F(SensorHistoryTest, OfManySensorsTheNumberIsBounded)
{
    std::vector<Sensor> sensors;
    for (std::size_t i = 0; i < SensorHistory::maximumSensors + 1; ++i)
        sensors.push_back(sensorOf(std::to_string(i), 1));
    add(sensors, 0);
    EXPECT_EQ(history.deviceIds().size(), SensorHistory::maximumSensors);
}

TEST_F(SensorHistoryTest, SensorsThatAreGoneLongestMakeRoomForNewOnes)
{
    for (int i = 0; i < 1000; ++i)
        add({sensorOf("a", 1), sensorOf(std::to_string(i), 1)}, 10 * i);
    EXPECT_EQ(history.deviceIds().size(), 104U);
    EXPECT_TRUE(hour("896").is_null());
    EXPECT_FALSE(hour("897").is_null());
    EXPECT_EQ(hour("a")["states"], json::parse(R"([["Normal", 360]])"));
}

TEST_F(SensorHistoryTest, SensorsOfOneAnswerAreOfTheSameTime)
{
    add({sensorOf("a", 1)}, 0);
    std::vector<std::string> seen;
    EXPECT_TRUE(history.visit({"none", "a:/chip/a"},
        [&](const std::string& deviceId, const Samples& samples, Slot newest) {
            seen.push_back(deviceId + std::to_string(samples.ofSlot(newest).state));
        }));
    EXPECT_THAT(seen, testing::ElementsAre("none0", "a:/chip/a2"));
    EXPECT_FALSE(history.visit({"none"}, [](auto&&...) {}));
}

TEST_F(SensorHistoryTest, NothingIsRecordedUntilAClockThatStartsInThePastIsSet)
{
    add({sensorOf("a", 1)}, 0);
    const Slot newest = history.newest();
    SensorHistory::Entries stored;
    stored["a:/chip/a"] =
        std::make_unique<SensorHistory::Entry>(*history.entryUntil("a:/chip/a", newest));
    history.restore(std::move(stored), newest);
    add({sensorOf("a", 2)}, -start);
    EXPECT_EQ(history.newest(), newest);
    add({sensorOf("a", 3)}, 20);
    EXPECT_EQ(last(hour("a")["values"], 3), json::parse("[1, null, 3]"));
    add({sensorOf("a", 4)}, -start);
    EXPECT_EQ(hour("a")["states"], json::parse(R"([[null, 359], ["Normal", 1]])"));
}

TEST_F(SensorHistoryTest, MeanIsThatOfTheReadingsAfterTheClockWasSetBack)
{
    for (int i = 0; i < 9; ++i)
        add({sensorOf("a", 100)}, 10 * i);
    add({sensorOf("a", 10)}, 30);
    EXPECT_EQ(day("a")["mean"].back(), 10);
}

TEST_F(SensorHistoryTest, GreatReadingsAreKeptAsTheGreatestNumber)
{
    Sensor sensor = sensorOf("a", 1);
    sensor.reading->modifier = 300;
    add({sensor}, 0);
    EXPECT_GT(hour("a")["values"].back(), 3e38);
}

TEST_F(SensorHistoryTest, StatesHaveNumbersOfTheirOwn)
{
    for (unsigned number = 1; number <= greatestStateNumber; ++number)
        EXPECT_EQ(numberOf(stateNumbered(number)), number);
    EXPECT_EQ(numberOf(SensorState{}), 1U);
}

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
    const Slot newest = history.newest();
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
