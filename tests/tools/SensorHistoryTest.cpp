// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The samples of a day.

#include "tests/tools/SensorHistoryFixture.h"

#include <gmock/gmock.h>

#include <map>

namespace SensorHistoryTests {

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
        [&](const std::string& id, const Samples&, SlotNumber) { present.push_back(id); });
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

TEST_F(SensorHistoryTest, ManyNewSensorsTakeThePlacesOfThoseGoneLongest)
{
    const auto sensorsNamed = [](const std::string& name, int count) {
        std::vector<Sensor> sensors;
        for (int i = 0; i < count; ++i)
            sensors.push_back(sensorOf(name + std::to_string(i), 1));
        return sensors;
    };
    add(sensorsNamed("first", 100), 0);
    add(sensorsNamed("second", 100), 10);
    add(sensorsNamed("third", 40), 20);
    std::map<char, int> kept;
    for (const std::string& deviceId : history.deviceIds())
        ++kept[deviceId.front()];
    EXPECT_EQ(kept, (std::map<char, int>{{'f', 40}, {'s', 100}, {'t', 40}}));
}

TEST_F(SensorHistoryTest, SensorsOfOneAnswerAreOfTheSameTime)
{
    add({sensorOf("a", 1)}, 0);
    std::vector<std::string> seen;
    EXPECT_TRUE(history.visit({"none", "a:/chip/a"},
        [&](const std::string& deviceId, const Samples& samples, SlotNumber newest) {
            seen.push_back(deviceId + std::to_string(samples.ofSlot(newest).state));
        }));
    EXPECT_THAT(seen, testing::ElementsAre("none0", "a:/chip/a2"));
    EXPECT_FALSE(history.visit({"none"}, [](auto&&...) {}));
}

TEST_F(SensorHistoryTest, NothingIsRecordedUntilAClockThatStartsInThePastIsSet)
{
    add({sensorOf("a", 1)}, 0);
    const SlotNumber newest = history.newest();
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

} // namespace SensorHistoryTests
