// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/History.h"

#include "tools/output/SensorCells.h"

#include <algorithm>
#include <set>
#include <string_view>

namespace Tools {

namespace {

constexpr SensorState missingState = {"Missing", Urgency::lost};

Change changeOf(const Sensor& sensor, const SensorState& before, std::time_t now)
{
    std::string text = sensor.chip + "/" + sensor.label + ": ";
    text.append(before.word).append(" -> ").append(sensor.state.word);
    if (sensor.reading)
        text += " (" + textWithUnit(sensor.reading, sensor) + ")";
    return {now, text, sensor.state.urgency, before.urgency};
}

} // namespace

std::vector<Change> History::update(const Sensors& present, std::time_t now, bool areOthersUnknown)
{
    std::vector<Change> changes;
    std::map<std::string, const Sensor*> byId;
    for (const Sensor& sensor : present) {
        byId.emplace(sensor.deviceId, &sensor);
        const auto [place, isNew] = watched_.try_emplace(sensor.deviceId);
        const SensorState before = isNew ? missingState : place->second.sensor.state;
        if (!isFirst_ && before.word != sensor.state.word)
            changes.push_back(changeOf(sensor, before, now));
        take(place->second, sensor);
    }
    for (auto& [id, watched] : watched_) {
        if (areOthersUnknown || byId.contains(id))
            continue;
        Sensor gone = watched.sensor;
        gone.state = missingState;
        gone.reading.reset();
        if (watched.sensor.state.word != missingState.word)
            changes.push_back(changeOf(gone, watched.sensor.state, now));
        take(watched, gone);
    }
    isFirst_ = isFirst_ && areOthersUnknown;
    return changes;
}

bool History::isSomeAbsent(const Sensors& present) const
{
    std::set<std::string_view> ids;
    for (const Sensor& sensor : present)
        ids.insert(sensor.deviceId);
    return std::any_of(watched_.begin(), watched_.end(), [&](const auto& each) {
        return each.second.sensor.state.word != missingState.word && !ids.contains(each.first);
    });
}

void History::take(WatchedSensor& watched, const Sensor& present)
{
    watched.sensor = present;
    watched.sensor.instance = nullptr;
    watched.readings.push_back(
        present.reading ? std::optional(present.reading->value) : std::nullopt);
    if (watched.readings.size() > WatchedSensor::keptReadings) {
        watched.readings.pop_front();
        ++watched.droppedReadings;
    }
    if (!present.reading)
        return;
    if (!watched.minimum || present.reading->number() < watched.minimum->number())
        watched.minimum = present.reading;
    if (!watched.maximum || present.reading->number() > watched.maximum->number())
        watched.maximum = present.reading;
}

std::vector<const WatchedSensor*> History::sensors() const
{
    std::vector<const WatchedSensor*> all;
    for (const auto& [id, watched] : watched_)
        all.push_back(&watched);
    std::sort(all.begin(), all.end(), [](const WatchedSensor* first, const WatchedSensor* second) {
        return isListedBefore(first->sensor, second->sensor);
    });
    return all;
}

} // namespace Tools
