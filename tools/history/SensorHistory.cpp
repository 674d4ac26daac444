// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/history/SensorHistory.h"

#include <algorithm>
#include <mutex>
#include <utility>

namespace Tools {

namespace {

constexpr Slot slotsUntilForgotten = Samples::minutesKept * slotsOfMinute;

// Clears the slots after the first one until the last one, and their minutes.
void clearBetween(Samples& samples, Slot first, Slot last)
{
    for (Slot slot = std::max(first, last - Samples::slotsKept) + 1; slot <= last; ++slot)
        samples.clearSlot(slot);
    const Slot lastMinute = minuteOf(last);
    Slot minute = std::max(minuteOf(first), lastMinute - Samples::minutesKept) + 1;
    for (; minute <= lastMinute; ++minute)
        samples.clearMinute(minute);
}

} // namespace

Slot SensorHistory::slotOf(std::chrono::system_clock::time_point time)
{
    return std::chrono::floor<std::chrono::seconds>(time.time_since_epoch()).count() /
           secondsOfSlot;
}

void SensorHistory::add(
    const std::vector<const Sensor*>& sensors, std::chrono::system_clock::time_point now)
{
    const Slot slot = slotOf(now);
    const std::unique_lock lock(mutex_);
    advanceTo(slot);
    present_.clear();
    for (const Sensor* const sensor : sensors) {
        auto found = entries_.find(sensor->deviceId);
        if (found == entries_.end()) {
            if (entries_.size() >= maximumSensors)
                continue;
            found = entries_.emplace(sensor->deviceId, std::make_unique<Entry>()).first;
        }
        found->second->samples.add(slot, *sensor);
        found->second->lastSeen = slot;
        present_.emplace_back(found);
    }
}

// Makes room for samples of the slot.
void SensorHistory::advanceTo(Slot slot)
{
    for (auto& [deviceId, entry] : entries_) {
        clearBetween(entry->samples, std::min(slot, newest_), std::max(slot, newest_));
        entry->lastSeen = std::min(entry->lastSeen, slot);
    }
    newest_ = slot;
    std::erase_if(entries_,
        [slot](const auto& each) { return slot - each.second->lastSeen > slotsUntilForgotten; });
}

Slot SensorHistory::newest() const
{
    const std::shared_lock lock(mutex_);
    return newest_;
}

std::vector<std::string> SensorHistory::deviceIds() const
{
    const std::shared_lock lock(mutex_);
    std::vector<std::string> deviceIds;
    for (const auto& [deviceId, entry] : entries_)
        deviceIds.push_back(deviceId);
    return deviceIds;
}

std::optional<SensorHistory::Entry> SensorHistory::entryUntil(
    const std::string& deviceId, Slot slot) const
{
    const std::shared_lock lock(mutex_);
    const auto found = entries_.find(deviceId);
    if (found == entries_.end())
        return std::nullopt;
    Entry entry = *found->second;
    clearBetween(entry.samples, slot, std::max(slot, newest_));
    entry.lastSeen = std::min(entry.lastSeen, slot);
    return entry;
}

void SensorHistory::restore(Entries entries, Slot newest)
{
    const std::unique_lock lock(mutex_);
    entries_ = std::move(entries);
    present_.clear();
    newest_ = newest;
}

} // namespace Tools
