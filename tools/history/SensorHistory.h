// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/history/Samples.h"

#include <chrono>
#include <map>
#include <memory>
#include <optional>
#include <shared_mutex>
#include <string>
#include <vector>

namespace Tools {

// The last hour and day of the sensors, in a memory of 21 KiB for each. Thread-safe.
//
// Where the clock is set forward, and where the machine was suspended, nothing is recorded of the
// time between. Where it is set back, what was recorded of later times is discarded.
class SensorHistory {
public:
    // The greatest number of sensors that have a history. Sensors that are gone are forgotten where
    // there are a hundred more of them than of present ones.
    static constexpr std::size_t maximumSensors = 10'000;

    static SlotNumber slotOf(std::chrono::system_clock::time_point time);

    // Records the sensors, which are in the order of a list. Forgets those that were not among them
    // for a day. Records nothing for an hour after restore() while the clock is more than five
    // minutes behind what was restored: a machine whose clock has no battery starts in the past.
    void add(const std::vector<const Sensor*>& sensors, std::chrono::system_clock::time_point now);

    // The last slot of which samples were recorded; 0 where there are none.
    SlotNumber newest() const;

    // Calls a function with the identifier and the samples of each sensor, which are empty where
    // nothing was recorded, and with newest(). Returns false where nothing was recorded of any. The
    // function must not call this object.
    template <typename Visitor>
    bool visit(const std::vector<std::string>& deviceIds, const Visitor& visitor) const
    {
        const std::shared_lock lock(mutex_);
        const Samples none;
        bool isAnyFound = false;
        for (const std::string& deviceId : deviceIds) {
            const auto found = entries_.find(deviceId);
            isAnyFound = isAnyFound || found != entries_.end();
            visitor(deviceId, found == entries_.end() ? none : found->second->samples, newest_);
        }
        return isAnyFound;
    }
    // Calls a function with the identifier and the samples of each sensor that was among the last
    // ones, in the order of a list, and with newest().
    template <typename Visitor>
    void visitPresent(const Visitor& visitor) const
    {
        const std::shared_lock lock(mutex_);
        for (const auto& each : present_)
            visitor(each->first, each->second->samples, newest_);
    }

    // What is stored of a sensor.
    struct Entry {
        SlotNumber lastSeen = 0;
        Samples samples;
    };
    std::vector<std::string> deviceIds() const;
    // Returns what add() had recorded of the sensor until that slot.
    std::optional<Entry> entryUntil(const std::string& deviceId, SlotNumber slot) const;
    using Entries = std::map<std::string, std::unique_ptr<Entry>>;
    // Replaces everything by what was stored.
    void restore(Entries entries, SlotNumber newest);

private:
    bool awaitsClock(SlotNumber slot);
    void advanceTo(SlotNumber slot);
    void makeRoom(std::size_t added, std::size_t maximum, SlotNumber slot);

    mutable std::shared_mutex mutex_;
    Entries entries_;
    std::vector<Entries::const_iterator> present_;
    SlotNumber newest_ = 0;
    std::chrono::steady_clock::time_point clockAwaited_{}; // until then
};

} // namespace Tools
