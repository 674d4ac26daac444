// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/SensorMetrics.h"
#include "tests/tools/Scrape.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <functional>
#include <limits>
#include <map>
#include <string>
#include <utility>

namespace SensorMetricsTests {

using Tools::ExpositionForm;
using Tools::Quantity;
using Tools::Sensor;
using Tools::SensorMetrics;
using Tools::Sensors;

Sensor sensorOf(int number, std::int64_t reading)
{
    Sensor sensor;
    const std::string name = std::to_string(number);
    sensor.setNames("Sensor " + name, "/chip/" + name);
    sensor.kind = Tools::sensorKinds.at(static_cast<std::size_t>(number) % 3);
    sensor.reading = Quantity{reading, -2};
    sensor.limits.at(4) = Quantity{9000, -2};
    sensor.possibleStates = {"Normal", "Critical"};
    sensor.state = {"Normal", Tools::Urgency::normal};
    sensor.health = 5;
    return sensor;
}

Sensors machineOf(int sensors)
{
    Sensors all;
    for (int i = 0; i < sensors; ++i)
        all.push_back(sensorOf(i, 4150 + i));
    return all;
}

std::string textOf(SensorMetrics& metrics, const Sensors& sensors, ExpositionForm form)
{
    Tools::Exposition exposition(form);
    metrics.addTo(exposition, sensors);
    return std::move(exposition).finish();
}

std::string freshTextOf(const Sensors& sensors, ExpositionForm form)
{
    SensorMetrics fresh(0);
    return textOf(fresh, sensors, form);
}

constexpr std::size_t maximumKept = 10;

class SensorMetricsTest : public testing::Test {
protected:
    void expectFreshText()
    {
        for (const ExpositionForm form : {ExpositionForm::text, ExpositionForm::openMetrics})
            EXPECT_EQ(textOf(metrics_, sensors_, form), freshTextOf(sensors_, form));
    }

    SensorMetrics metrics_{maximumKept};
    Sensors sensors_ = machineOf(6);
};

TEST_F(SensorMetricsTest, WhateverChangesOfASensorIsInTheNextText)
{
    const std::map<std::string, std::function<void(Sensor&)>> changes = {
        {"reading",
            [](Sensor& sensor) {
                sensor.reading = Quantity{-995, -2};
            }},
        {"no reading", [](Sensor& sensor) { sensor.reading.reset(); }},
        {"limit", [](Sensor& sensor) { sensor.limits.at(4)->value = 9001; }},
        {"modifier", [](Sensor& sensor) { sensor.limits.at(4)->modifier = -1; }},
        {"no limit", [](Sensor& sensor) { sensor.limits.at(4).reset(); }},
        {"further limit",
            [](Sensor& sensor) {
                sensor.limits.at(0) = Quantity{1, 0};
            }},
        {"state",
            [](Sensor& sensor) {
                sensor.state = {"Critical", Tools::Urgency::critical};
            }},
        {"state that is not possible",
            [](Sensor& sensor) {
                sensor.state = {"Stressed", Tools::Urgency::warning};
            }},
        {"possible states", [](Sensor& sensor) { sensor.possibleStates.emplace_back("Fatal"); }},
        {"health", [](Sensor& sensor) { sensor.health = 25; }},
        {"kind", [](Sensor& sensor) { sensor.kind = Tools::sensorKinds.at(0); }},
        {"unit", [](Sensor& sensor) { sensor.unit = "V"; }},
        {"unit without a family", [](Sensor& sensor) { sensor.unit = "°F"; }},
        {"label", [](Sensor& sensor) { sensor.label = "Ä \"B\""; }},
        {"device", [](Sensor& sensor) { sensor.device = "disk"; }},
        {"chip", [](Sensor& sensor) { sensor.chip = "other"; }},
        {"identifier", [](Sensor& sensor) { sensor.deviceId += "'"; }}};
    for (const auto& [what, change] : changes) {
        SCOPED_TRACE(what);
        sensors_ = machineOf(6);
        expectFreshText();
        const std::string before = freshTextOf(sensors_, ExpositionForm::text);
        change(sensors_.at(2));
        EXPECT_NE(freshTextOf(sensors_, ExpositionForm::text), before);
        expectFreshText();
    }
}

TEST_F(SensorMetricsTest, SensorsMayComeAndGoAnywhere)
{
    expectFreshText();
    sensors_.insert(sensors_.begin() + 3, sensorOf(8, 1));
    expectFreshText();
    sensors_.erase(sensors_.begin() + 1);
    expectFreshText();
    std::swap(sensors_.front(), sensors_.back());
    expectFreshText();
    sensors_.clear();
    expectFreshText();
    sensors_ = machineOf(3);
    expectFreshText();
}

TEST_F(SensorMetricsTest, TextIsTheSameWhereTheMachineIsTooLargeToKeepLines)
{
    for (const int sensors : {10, 11, 10, 12}) {
        sensors_ = machineOf(sensors);
        expectFreshText();
    }
}

TEST_F(SensorMetricsTest, NumbersAreThoseOfTheReadings)
{
    constexpr std::int64_t least = std::numeric_limits<std::int32_t>::min() + 1;
    constexpr std::int64_t greatest = std::numeric_limits<std::int32_t>::max();
    for (const std::int64_t value : {least, std::int64_t{-995}, std::int64_t{0}, std::int64_t{995},
             std::int64_t{100'299}, greatest})
        for (const std::int32_t modifier : {-9, -3, -2, 0, 3}) {
            sensors_ = {sensorOf(0, 0)};
            sensors_.front().reading = Quantity{value, modifier};
            const std::string text = textOf(metrics_, sensors_, ExpositionForm::text);
            EXPECT_EQ(Testing::seriesIn(text).front().name, "sensor_profile_reading_celsius");
            EXPECT_EQ(Testing::seriesIn(text).front().value, sensors_.front().reading->number());
        }
}

} // namespace SensorMetricsTests
