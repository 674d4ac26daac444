// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/History.h"

#include <gtest/gtest.h>

namespace {

using namespace Tools;

Sensor sensorWith(const char* path, std::optional<std::int64_t> reading, SensorState state)
{
    Sensor sensor;
    sensor.setNames("S", path);
    sensor.state = state;
    if (reading)
        sensor.reading = Quantity{*reading, 0};
    return sensor;
}

constexpr SensorState normal = {"Normal", Urgency::normal};
constexpr SensorState lost = {"Lost", Urgency::lost};

TEST(HistoryTest, FirstUpdateChangesNothing)
{
    EXPECT_TRUE(History().update({sensorWith("/a/1", 5, lost)}, 0).empty());
}

TEST(HistoryTest, ChangesOfStateAreReturnedOnce)
{
    History history;
    history.update({sensorWith("/a/1", 5, normal)}, 0);
    EXPECT_TRUE(history.update({sensorWith("/a/1", 6, normal)}, 1).empty());
    const auto changes = history.update({sensorWith("/a/1", std::nullopt, lost)}, 2);
    ASSERT_EQ(changes.size(), 1U);
    EXPECT_EQ(changes[0].text, "a/S: Normal -> Lost");
    EXPECT_EQ(changes[0].time, 2);
    EXPECT_EQ(changes[0].urgency, Urgency::lost);
}

TEST(HistoryTest, SensorsThatGoAndComeAreChanges)
{
    History history;
    history.update({sensorWith("/a/1", 5, normal)}, 0);
    EXPECT_EQ(history.update({}, 1).at(0).text, "a/S: Normal -> Missing");
    EXPECT_TRUE(history.update({}, 2).empty());
    EXPECT_FALSE(history.sensors().at(0)->sensor.reading);
    EXPECT_EQ(history.update({sensorWith("/a/1", 7, normal)}, 3).at(0).text,
        "a/S: Missing -> Normal (7)");
    EXPECT_EQ(history.update({sensorWith("/a/1", 7, normal), sensorWith("/b/1", 1, normal)}, 4)
                  .at(0)
                  .text,
        "b/S: Missing -> Normal (1)");
}

TEST(HistoryTest, UnknownSensorsStayAsTheyWere)
{
    History history;
    EXPECT_TRUE(history.update({}, 0, true).empty());
    history.update({sensorWith("/a/1", 5, normal), sensorWith("/b/1", 6, normal)}, 1);
    const Sensors others = {sensorWith("/b/1", std::nullopt, lost)};
    EXPECT_TRUE(history.isSomeAbsent(others));
    const auto changes = history.update(others, 2, true);
    ASSERT_EQ(changes.size(), 1U);
    EXPECT_EQ(changes[0].text, "b/S: Normal -> Lost");
    EXPECT_EQ(changes[0].urgencyBefore, Urgency::normal);
    EXPECT_EQ(history.sensors().at(0)->sensor.reading->value, 5);
    EXPECT_EQ(history.update(others, 3).at(0).text, "a/S: Normal -> Missing");
    EXPECT_FALSE(history.isSomeAbsent(others));
}

TEST(HistoryTest, RangeIsThatOfAllReadings)
{
    History history;
    for (const std::int64_t reading : {5, 9, 3, 4})
        history.update({sensorWith("/a/1", reading, normal)}, 0);
    history.update({sensorWith("/a/1", std::nullopt, lost)}, 0);
    const WatchedSensor& watched = *history.sensors().at(0);
    EXPECT_EQ(watched.minimum->value, 3);
    EXPECT_EQ(watched.maximum->value, 9);
    EXPECT_EQ(
        watched.readings, (std::deque<std::optional<std::int64_t>>{5, 9, 3, 4, std::nullopt}));
}

TEST(HistoryTest, ReadingsAreBounded)
{
    History history;
    for (int i = 0; i < 1000; ++i)
        history.update({sensorWith("/a/1", i, normal)}, 0);
    const WatchedSensor& watched = *history.sensors().at(0);
    EXPECT_EQ(watched.readings.size(), WatchedSensor::keptReadings);
    EXPECT_EQ(watched.droppedReadings, 1000 - WatchedSensor::keptReadings);
    EXPECT_EQ(watched.readings.back(), 999);
}

} // namespace
