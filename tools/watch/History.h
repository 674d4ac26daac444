// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What happened to sensors while they were watched.

#pragma once

#include "tools/sensors/SensorList.h"

#include <cstddef>
#include <cstdint>
#include <ctime>
#include <deque>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace Tools {

// A sensor with its latest readings. One that is gone has no reading and the state "Missing".
struct WatchedSensor {
    static constexpr std::size_t keptReadings = 120;

    Sensor sensor;
    std::optional<Quantity> minimum; // since the first update; nothing before the first reading
    std::optional<Quantity> maximum;
    std::deque<std::optional<std::int64_t>> readings; // values of quantities, the latest last
    std::size_t droppedReadings = 0;                  // before these
};

// A sensor that changed its state, came or went.
struct Change {
    std::time_t time;
    std::string text; // such as "chip/label: Normal -> Warning high (91 °C)"
    Urgency urgency;  // of the new state
    Urgency urgencyBefore = Urgency::normal;
};

class History {
public:
    // Takes the present sensors, and the others as missing unless they are unknown. Returns what
    // has changed since the last update; nothing in the first one that knows all sensors.
    std::vector<Change> update(
        const Sensors& present, std::time_t now, bool areOthersUnknown = false);

    // Returns whether a sensor that was there at the last update is not among the present ones.
    bool isSomeAbsent(const Sensors& present) const;

    // Returns the sensors in natural order by chip, label and path.
    std::vector<const WatchedSensor*> sensors() const;

private:
    static void take(WatchedSensor& watched, const Sensor& present);

    std::map<std::string, WatchedSensor> watched_; // by DeviceID
    bool isFirst_ = true;
};

} // namespace Tools
