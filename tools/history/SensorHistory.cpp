// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/history/SensorHistory.h"

#include <algorithm>
#include <mutex>
#include <utility>

namespace Tools {

namespace {

constexpr SlotNumber slotsUntilForgotten = Samples::minutesKept * slotsOfMinute;
constexpr SlotNumber slotsOfDelay = SlotNumber{5} * slotsOfMinute;
constexpr std::chrono::hours clockTimeout{1};

// Clears the slots after the first one until the last one, and their minutes.
void clearBetween(Samples& samples, SlotNumber first, SlotNumber last)
{
    for (SlotNumber slot = std::max(first, last - Samples::slotsKept) + 1; slot <= last; ++slot)
        samples.clearSlot(slot);
    const SlotNumber lastMinute = minuteOf(last);
    SlotNumber minute = std::max(minuteOf(first), lastMinute - Samples::minutesKept) + 1;
    for (; minute <= lastMinute; ++minute)
        samples.clearMinute(minute);
}

} // namespace

SlotNumber SensorHistory::slotOf(std::chrono::system_clock::time_point time)
{
    return std::chrono::floor<std::chrono::seconds>(time.time_since_epoch()).count() /
           secondsOfSlot;
}

void SensorHistory::add(
    const std::vector<const Sensor*>& sensors, std::chrono::system_clock::time_point now)
{
    const SlotNumber slot = slotOf(now);
    const std::unique_lock lock(mutex_);
    if (awaitsClock(slot))
        return;
    advanceTo(slot);
    present_.clear();
    std::size_t added = 0;
    for (const Sensor* const sensor : sensors)
        if (const auto known = entries_.find(sensor->deviceId); known != entries_.end())
            known->second->lastSeen = slot;
        else
            ++added;
    const std::size_t maximum = std::min(maximumSensors, 2 * sensors.size() + 100);
    makeRoom(added, maximum, slot);
    for (const Sensor* const sensor : sensors) {
        auto found = entries_.find(sensor->deviceId);
        if (found == entries_.end()) {
            if (entries_.size() >= maximum)
                continue;
            found = entries_.emplace(sensor->deviceId, std::make_unique<Entry>()).first;
        }
        found->second->samples.add(slot, *sensor);
        found->second->lastSeen = slot;
        present_.emplace_back(found);
    }
}

bool SensorHistory::awaitsClock(SlotNumber slot)
{
    const bool isBehind = slot < newest_ - slotsOfDelay;
    if (!isBehind)
        clockAwaited_ = {};
    return isBehind && std::chrono::steady_clock::now() < clockAwaited_;
}

// Forgets sensors last seen before the slot, longest ago first, as far as there would be more than
// the maximum with the added ones.
void SensorHistory::makeRoom(std::size_t added, std::size_t maximum, SlotNumber slot)
{
    if (entries_.size() + added <= maximum)
        return;
    std::vector<Entries::iterator> gone;
    for (auto entry = entries_.begin(); entry != entries_.end(); ++entry)
        if (entry->second->lastSeen < slot)
            gone.push_back(entry);
    std::ranges::sort(gone, {}, [](const auto& entry) { return entry->second->lastSeen; });
    gone.resize(std::min(gone.size(), entries_.size() + added - maximum));
    for (const auto& entry : gone)
        entries_.erase(entry);
}

// Clears what is between the newest slot and this one; where the clock was set back, also the
// minute of this one, whose readings are no longer counted.
void SensorHistory::advanceTo(SlotNumber slot)
{
    for (auto& [deviceId, entry] : entries_) {
        clearBetween(entry->samples, std::min(slot, newest_), std::max(slot, newest_));
        if (slot < newest_)
            entry->samples.clearMinute(minuteOf(slot));
        entry->lastSeen = std::min(entry->lastSeen, slot);
    }
    newest_ = slot;
    std::erase_if(entries_,
        [slot](const auto& each) { return slot - each.second->lastSeen > slotsUntilForgotten; });
}

SlotNumber SensorHistory::newest() const
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
    const std::string& deviceId, SlotNumber slot) const
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

void SensorHistory::restore(Entries entries, SlotNumber newest)
{
    const std::unique_lock lock(mutex_);
    entries_ = std::move(entries);
    present_.clear();
    newest_ = newest;
    clockAwaited_ = std::chrono::steady_clock::now() + clockTimeout;
}

} // namespace Tools
