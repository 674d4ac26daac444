// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/sensors/Sensor.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>

namespace Tools {

// Times in units of ten seconds and of minutes since 1970. A sample belongs to the unit of the wall
// clock in which it was taken.
using SlotNumber = std::int64_t;
inline constexpr int secondsOfSlot = 10;
inline constexpr int slotsOfMinute = 6;
constexpr SlotNumber minuteOf(SlotNumber slot)
{
    return slot / slotsOfMinute;
}

// Returns the more urgent of two states by their numbers, the later one of equally urgent ones. The
// number 0 is that of nothing recorded, which is the least urgent.
unsigned moreUrgent(unsigned earlier, unsigned later);

// The readings and states of one sensor. An object has a fixed size and is written to files as it
// is.
class Samples {
public:
    static constexpr SlotNumber slotsKept = 360;
    static constexpr SlotNumber minutesKept = 1440;
    static constexpr float absent = std::numeric_limits<float>::quiet_NaN();

    // A reading is NaN where the sensor had none; a state is its number, 0 where nothing was
    // recorded.
    struct OfSlot {
        float value = absent;
        std::uint8_t state = 0;
    };
    struct OfMinute {
        float minimum = absent;
        float mean = absent;
        float maximum = absent;
        std::uint8_t state = 0; // the most urgent one
    };

    Samples();

    // Adds a sample to the slot and to its minute, the newest ones.
    void add(SlotNumber slot, const Sensor& sensor);
    // Remove the sample of the slot or of the minute.
    void clearSlot(SlotNumber slot);
    void clearMinute(SlotNumber minute);

    // REQUIRES: the slot or minute is among the last ones that are kept.
    OfSlot ofSlot(SlotNumber slot) const;
    OfMinute ofMinute(SlotNumber minute) const;

    // Returns whether all states are known: those that were read from a file may be others.
    bool isValid() const;

private:
    // Arrays apart, since a structure would have three unused bytes for each sample.
    std::array<float, slotsKept> values_;
    std::array<float, minutesKept> minima_;
    std::array<float, minutesKept> means_;
    std::array<float, minutesKept> maxima_;
    std::array<std::uint8_t, slotsKept> states_;
    std::array<std::uint8_t, minutesKept> statesOfMinutes_;
    std::uint32_t readingsOfMinute_ = 0; // in the newest one
};

} // namespace Tools
