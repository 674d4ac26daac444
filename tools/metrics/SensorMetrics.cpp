// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/SensorMetrics.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace Tools {

namespace {

// A quantity that has families of its own, in one unit.
struct Measure {
    std::string_view kind; // of sensors
    std::string_view symbol;
    MetricFamily reading;
    MetricFamily limit;
};

constexpr auto gauge = MetricFamily::Type::gauge;
constexpr std::array measures = {
    Measure{"temperature", "°C",
        {"sensor_profile_reading_celsius", "Temperature that the sensor reads.", gauge, "celsius"},
        {"sensor_profile_limit_celsius", "Limit of a temperature.", gauge, "celsius"}},
    Measure{"voltage", "V",
        {"sensor_profile_reading_volts", "Voltage that the sensor reads.", gauge, "volts"},
        {"sensor_profile_limit_volts", "Limit of a voltage.", gauge, "volts"}},
    Measure{"fan", "RPM",
        {"sensor_profile_reading_rpm", "Revolutions per minute of a fan.", gauge, "rpm"},
        {"sensor_profile_limit_rpm", "Limit of the revolutions per minute of a fan.", gauge,
            "rpm"}}};

constexpr MetricFamily states{"sensor_profile_state",
    "State of the sensor: 1 for the present one, 0 for the others that it can have."};
constexpr MetricFamily health{"sensor_profile_health",
    "HealthState of the sensor (CIM_ManagedSystemElement): 0 unknown, 5 OK, 10 degraded, 15 minor "
    "failure, 20 major failure, 25 critical failure, 30 non-recoverable error."};

constexpr std::string_view lost = "Lost"; // a state that any sensor can have

// In the order of limitKinds.
constexpr std::array<std::string_view, limitKinds.size()> limitNames = {"lower_warning",
    "lower_critical", "lower_fatal", "upper_warning", "upper_critical", "upper_fatal"};

struct LabeledSensor {
    const Sensor& sensor;
    Labels labels;
};

Labels labelsOf(const Sensor& sensor)
{
    Labels labels;
    labels.add("device_id", sensor.deviceId).add("chip", sensor.chip);
    labels.add("device", sensor.device).add("label", sensor.label);
    return labels;
}

// A sensor without a unit has that of its kind.
bool isOf(const Measure& measure, const Sensor& sensor)
{
    return sensor.unit.empty() ? sensor.kind == measure.kind : sensor.unit == measure.symbol;
}

// Returns a word such as "Warning high" as the value of a label, "warning_high".
std::string valueOf(std::string_view word)
{
    std::string value(word);
    std::transform(value.begin(), value.end(), value.begin(), [](char c) {
        return c == ' ' ? '_' : c >= 'A' && c <= 'Z' ? char(c - 'A' + 'a') : c;
    });
    return value;
}

void addStates(Exposition& exposition, const Sensor& sensor, const Labels& labels)
{
    std::vector<std::string_view> words = sensor.possibleStates;
    words.insert(words.end(), {lost, sensor.state.word});
    for (auto word = words.begin(); word != words.end(); ++word)
        if (std::find(words.begin(), word, *word) == word)
            exposition.add(labels, "state", valueOf(*word), *word == sensor.state.word ? 1 : 0);
}

} // namespace

void addSensors(Exposition& exposition, const Sensors& sensors)
{
    std::vector<LabeledSensor> labeled;
    labeled.reserve(sensors.size());
    for (const Sensor& sensor : sensors)
        labeled.push_back({sensor, labelsOf(sensor)});
    for (const Measure& measure : measures) {
        exposition.begin(measure.reading);
        for (const auto& [sensor, labels] : labeled)
            if (sensor.reading && isOf(measure, sensor))
                exposition.add(labels, sensor.reading->number());
        exposition.begin(measure.limit);
        for (const auto& [sensor, labels] : labeled)
            for (std::size_t i = 0; i < limitNames.size(); ++i)
                if (const auto& limit = sensor.limits.at(i); limit && isOf(measure, sensor))
                    exposition.add(labels, "limit", limitNames.at(i), limit->number());
    }
    exposition.begin(states);
    for (const auto& [sensor, labels] : labeled)
        addStates(exposition, sensor, labels);
    exposition.begin(health);
    for (const auto& [sensor, labels] : labeled)
        exposition.add(labels, sensor.health);
}

} // namespace Tools
