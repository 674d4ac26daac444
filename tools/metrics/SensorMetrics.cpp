// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/SensorMetrics.h"

#include <algorithm>
#include <array>
#include <optional>
#include <unordered_map>
#include <utility>

namespace Tools {

namespace {

enum class Part { reading, limits, states, health };

// A family of series, of the sensors in one unit or of all.
struct SensorFamily {
    MetricFamily family;
    Part part;
    std::string_view kind = {}; // of sensors; empty for all
    std::string_view symbol = {};
};

constexpr auto gauge = MetricFamily::Type::gauge;
constexpr std::array families = {
    SensorFamily{
        {"sensor_profile_reading_celsius", "Temperature that the sensor reads.", gauge, "celsius"},
        Part::reading, "temperature", "°C"},
    SensorFamily{{"sensor_profile_limit_celsius", "Limit of a temperature.", gauge, "celsius"},
        Part::limits, "temperature", "°C"},
    SensorFamily{{"sensor_profile_reading_volts", "Voltage that the sensor reads.", gauge, "volts"},
        Part::reading, "voltage", "V"},
    SensorFamily{{"sensor_profile_limit_volts", "Limit of a voltage.", gauge, "volts"},
        Part::limits, "voltage", "V"},
    SensorFamily{{"sensor_profile_reading_rpm", "Revolutions per minute of a fan.", gauge, "rpm"},
        Part::reading, "fan", "RPM"},
    SensorFamily{
        {"sensor_profile_limit_rpm", "Limit of the revolutions per minute of a fan.", gauge, "rpm"},
        Part::limits, "fan", "RPM"},
    SensorFamily{{"sensor_profile_state",
                     "State of the sensor: 1 for the present one, 0 for the others that it can "
                     "have."},
        Part::states},
    SensorFamily{{"sensor_profile_health",
                     "HealthState of the sensor (CIM_ManagedSystemElement): 0 unknown, 5 OK, 10 "
                     "degraded, 15 minor failure, 20 major failure, 25 critical failure, 30 "
                     "non-recoverable error."},
        Part::health}};

constexpr std::string_view lost = "Lost"; // a state that any sensor can have

// In the order of limitKinds.
constexpr std::array<std::string_view, limitKinds.size()> limitNames = {"lower_warning",
    "lower_critical", "lower_fatal", "upper_warning", "upper_critical", "upper_fatal"};

// A sensor without a unit has that of its kind.
bool isOf(const SensorFamily& family, const Sensor& sensor)
{
    return family.kind.empty() ||
           (sensor.unit.empty() ? sensor.kind == family.kind : sensor.unit == family.symbol);
}

bool hasReadingIn(const SensorFamily& family, const Sensor& sensor)
{
    return sensor.reading && isOf(family, sensor);
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

// Returns the series of the sensor; of a reading, with the number 0.
std::vector<Series> seriesOf(const Sensor& sensor, Part part)
{
    Labels labels;
    labels.add("device_id", sensor.deviceId).add("chip", sensor.chip);
    labels.add("device", sensor.device).add("label", sensor.label);
    if (part == Part::reading)
        return {{labels, 0}};
    if (part == Part::health)
        return {{labels, static_cast<double>(sensor.health)}};
    std::vector<Series> series;
    const auto add = [&](std::string_view name, std::string_view value, double number) {
        series.push_back({labels, number});
        series.back().labels.add(name, value);
    };
    if (part == Part::limits) {
        for (std::size_t i = 0; i < limitNames.size(); ++i)
            if (const auto& limit = sensor.limits.at(i))
                add("limit", limitNames.at(i), limit->number());
        return series;
    }
    std::vector<std::string_view> words = sensor.possibleStates;
    words.insert(words.end(), {lost, sensor.state.word});
    for (auto word = words.begin(); word != words.end(); ++word)
        if (std::find(words.begin(), word, *word) == word)
            add("state", valueOf(*word), *word == sensor.state.word ? 1 : 0);
    return series;
}

// Returns the lines of the sensor; of a reading, the line up to the number.
std::string linesOf(const SensorFamily& family, const Sensor& sensor)
{
    if (!isOf(family, sensor))
        return "";
    std::string lines = linesOf(family.family, seriesOf(sensor, family.part));
    if (family.part == Part::reading)
        lines.erase(lines.rfind(' '));
    return lines;
}

// Returns the readings of the family as lines without labels, in the order of the sensors.
std::string numbersIn(const SensorFamily& family, const Sensors& sensors)
{
    std::vector<Series> numbers;
    for (const Sensor& sensor : sensors)
        if (hasReadingIn(family, sensor))
            numbers.push_back({{}, sensor.reading->number()});
    return linesOf(family.family, numbers);
}

void writeReadings(Exposition& exposition, const Sensors& sensors, const SensorFamily& family,
    const SensorTexts* lines)
{
    const std::string numbers = numbersIn(family, sensors);
    std::string_view rest = numbers;
    for (std::size_t i = 0; i < sensors.size(); ++i) {
        if (!hasReadingIn(family, sensors[i]))
            continue;
        exposition.append(lines == nullptr ? linesOf(family, sensors[i]) : lines->at(i));
        rest.remove_prefix(family.family.name.size());
        const std::size_t end = rest.find('\n') + 1;
        exposition.append(rest.substr(0, end));
        rest.remove_prefix(end);
    }
}

// Writes the families. The lines of each are taken from what is kept, or made where that is null.
void write(Exposition& exposition, const Sensors& sensors, const std::vector<SensorTexts>* kept)
{
    for (std::size_t i = 0; i < families.size(); ++i) {
        const SensorFamily& family = families.at(i);
        const SensorTexts* const lines = kept == nullptr ? nullptr : &kept->at(i);
        exposition.begin(family.family);
        if (family.part == Part::reading)
            writeReadings(exposition, sensors, family, lines);
        else if (lines != nullptr)
            exposition.append(lines->all);
        else
            for (const Sensor& sensor : sensors)
                exposition.append(linesOf(family, sensor));
    }
}

template <typename Number>
void appendBytes(std::string& record, Number number)
{
    record.append(reinterpret_cast<const char*>(&number), sizeof number);
}

// Appends what the lines of a sensor are made of. Two sensors with equal records have equal lines.
void appendRecord(std::string& record, const Sensor& sensor)
{
    const auto append = [&](std::string_view text) {
        appendBytes(record, text.size());
        record += text;
    };
    for (const std::string_view text : {std::string_view(sensor.deviceId),
             std::string_view(sensor.chip), std::string_view(sensor.device),
             std::string_view(sensor.label), sensor.kind, sensor.unit, sensor.state.word})
        append(text);
    appendBytes(record, sensor.possibleStates.size());
    for (const std::string_view word : sensor.possibleStates)
        append(word);
    for (const std::optional<Quantity>& limit : sensor.limits) {
        appendBytes(record, limit.has_value());
        appendBytes(record, limit ? limit->value : 0);
        appendBytes(record, limit ? limit->modifier : 0);
    }
    appendBytes(record, sensor.health);
}

} // namespace

void SensorTexts::add(std::string_view text)
{
    all += text;
    ends.push_back(all.size());
}

std::string_view SensorTexts::at(std::size_t sensor) const
{
    const std::size_t begin = sensor == 0 ? 0 : ends[sensor - 1];
    return std::string_view(all).substr(begin, ends[sensor] - begin);
}

void SensorMetrics::addTo(Exposition& exposition, const Sensors& sensors)
{
    std::unique_lock lock(mutex_);
    if (sensors.size() <= maximumKept_) {
        renew(sensors);
        write(exposition, sensors, &lines_);
        return;
    }
    records_ = {};
    lines_ = {};
    lock.unlock();
    write(exposition, sensors, nullptr);
}

void SensorMetrics::renew(const Sensors& sensors)
{
    SensorTexts records;
    records.all.reserve(records_.all.size());
    records.ends.reserve(sensors.size());
    for (const Sensor& sensor : sensors) {
        appendRecord(records.all, sensor);
        records.ends.push_back(records.all.size());
    }
    if (!lines_.empty() && records == records_)
        return;
    std::unordered_map<std::string_view, std::size_t> places; // in what is kept
    for (std::size_t i = 0; i < records_.ends.size(); ++i)
        places.emplace(records_.at(i), i);
    std::vector<SensorTexts> renewed(families.size());
    for (std::size_t i = 0; i < sensors.size(); ++i) {
        const auto place = places.find(records.at(i));
        for (std::size_t family = 0; family < families.size(); ++family)
            renewed[family].add(place == places.end() ? linesOf(families.at(family), sensors[i])
                                                      : lines_[family].at(place->second));
    }
    for (SensorTexts& texts : renewed)
        texts.all.shrink_to_fit();
    records_ = std::move(records);
    lines_ = std::move(renewed);
}

} // namespace Tools
