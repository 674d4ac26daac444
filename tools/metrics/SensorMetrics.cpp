// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/SensorMetrics.h"

#include <algorithm>
#include <string_view>
#include <tuple>
#include <utility>

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

constexpr MetricFamily stateFamily{"sensor_profile_state",
    "State of the sensor: 1 for the present one, 0 for the others that it can have."};
constexpr MetricFamily healthFamily{"sensor_profile_health",
    "HealthState of the sensor (CIM_ManagedSystemElement): 0 unknown, 5 OK, 10 degraded, 15 minor "
    "failure, 20 major failure, 25 critical failure, 30 non-recoverable error."};

constexpr std::string_view lost = "Lost"; // a state that any sensor can have

// In the order of limitKinds.
constexpr std::array<std::string_view, limitKinds.size()> limitNames = {"lower_warning",
    "lower_critical", "lower_fatal", "upper_warning", "upper_critical", "upper_fatal"};

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

// Returns null for a sensor in another unit.
const Measure* measureOf(const Sensor& sensor)
{
    const auto* const found = std::find_if(measures.begin(), measures.end(),
        [&](const Measure& measure) { return isOf(measure, sensor); });
    return found == measures.end() ? nullptr : found;
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

// Returns the line of the reading up to its number.
std::string readingOf(const Sensor& sensor, const Measure& measure)
{
    std::string line = linesOf(measure.reading, {{labelsOf(sensor), 0}});
    line.erase(line.rfind(' '));
    return line;
}

std::string limitsOf(const Sensor& sensor, const Measure& measure)
{
    const Labels labels = labelsOf(sensor);
    std::vector<Series> series;
    for (std::size_t i = 0; i < limitNames.size(); ++i)
        if (const auto& limit = sensor.limits.at(i))
            series.push_back({Labels(labels).add("limit", limitNames.at(i)), limit->number()});
    return linesOf(measure.limit, series);
}

std::string statesOf(const Sensor& sensor)
{
    std::vector<std::string_view> words = sensor.possibleStates;
    words.insert(words.end(), {lost, sensor.state.word});
    const Labels labels = labelsOf(sensor);
    std::vector<Series> series;
    for (auto word = words.begin(); word != words.end(); ++word)
        if (std::find(words.begin(), word, *word) == word)
            series.push_back({Labels(labels).add("state", valueOf(*word)),
                *word == sensor.state.word ? 1.0 : 0.0});
    return linesOf(stateFamily, series);
}

std::string healthOf(const Sensor& sensor)
{
    return linesOf(healthFamily, {{labelsOf(sensor), static_cast<double>(sensor.health)}});
}

// Returns the lines of the measure's readings, in the order of the sensors, without labels.
std::string numbersOf(const Sensors& sensors, const Measure& measure)
{
    std::vector<Series> numbers;
    for (const Sensor& sensor : sensors)
        if (sensor.reading && isOf(measure, sensor))
            numbers.push_back({{}, sensor.reading->number()});
    return linesOf(measure.reading, numbers);
}

// Returns what the lines of a sensor are made of.
auto fieldsOf(const Sensor& sensor)
{
    return std::tie(sensor.deviceId, sensor.chip, sensor.device, sensor.label, sensor.kind,
        sensor.unit, sensor.limits, sensor.state.word, sensor.possibleStates, sensor.health);
}

} // namespace

SensorMetrics::Lines::Lines(const Sensor& from) : sensor(from)
{
    for (const Part part : {reading, limits, states, health})
        parts.at(part) = linesOf(from, part);
}

std::string SensorMetrics::linesOf(const Sensor& sensor, Part part)
{
    const Measure* const measure = measureOf(sensor);
    switch (part) {
    case reading:
        return measure == nullptr ? "" : readingOf(sensor, *measure);
    case limits:
        return measure == nullptr ? "" : limitsOf(sensor, *measure);
    case states:
        return statesOf(sensor);
    default:
        return healthOf(sensor);
    }
}

void SensorMetrics::addTo(Exposition& exposition, const Sensors& sensors)
{
    std::unique_lock lock(mutex_);
    if (sensors.size() <= maximumKept_) {
        renew(sensors);
        write(exposition, sensors, kept_);
        return;
    }
    kept_ = {};
    lock.unlock();
    write(exposition, sensors, {});
}

void SensorMetrics::renew(const Sensors& sensors)
{
    kept_.erase(kept_.begin() + std::min(sensors.size(), kept_.size()), kept_.end());
    for (std::size_t i = 0; i < sensors.size(); ++i)
        if (i == kept_.size())
            kept_.emplace_back(sensors[i]);
        else if (fieldsOf(kept_[i].sensor) != fieldsOf(sensors[i]))
            kept_[i] = Lines(sensors[i]);
}

void SensorMetrics::write(
    Exposition& exposition, const Sensors& sensors, std::span<const Lines> kept)
{
    std::string made;
    const auto append = [&](std::size_t i, Part part) {
        exposition.append(kept.empty() ? made = linesOf(sensors[i], part) : kept[i].parts.at(part));
    };
    for (const Measure& measure : measures) {
        exposition.begin(measure.reading);
        const std::string numbers = numbersOf(sensors, measure);
        std::string_view rest = numbers;
        for (std::size_t i = 0; i < sensors.size(); ++i)
            if (sensors[i].reading && isOf(measure, sensors[i])) {
                append(i, reading);
                rest.remove_prefix(measure.reading.name.size());
                exposition.append(rest.substr(0, rest.find('\n') + 1));
                rest.remove_prefix(rest.find('\n') + 1);
            }
        exposition.begin(measure.limit);
        for (std::size_t i = 0; i < sensors.size(); ++i)
            if (isOf(measure, sensors[i]))
                append(i, limits);
    }
    exposition.begin(stateFamily);
    for (std::size_t i = 0; i < sensors.size(); ++i)
        append(i, states);
    exposition.begin(healthFamily);
    for (std::size_t i = 0; i < sensors.size(); ++i)
        append(i, health);
}

} // namespace Tools
