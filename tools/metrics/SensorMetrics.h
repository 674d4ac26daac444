// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/metrics/Exposition.h"
#include "tools/sensors/SensorList.h"

#include <cstddef>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

namespace Tools {

// A text for each sensor, one after the other, since they are read in this order.
struct SensorTexts {
    std::string all;
    std::vector<std::size_t> ends; // in `all`

    bool operator==(const SensorTexts&) const = default;

    void add(std::string_view text);
    std::string_view at(std::size_t sensor) const;
};

// Writes the readings, limits, states and health of sensors. From one exposition to the next, as a
// rule only the numbers of readings change: the other lines of a sensor are kept until another
// value of it changes. Thread-safe.
class SensorMetrics {
public:
    // Keeps the lines of a machine of at most so many sensors, and none of a larger one.
    explicit SensorMetrics(std::size_t maximumKept) : maximumKept_(maximumKept) {}

    void addTo(Exposition& exposition, const Sensors& sensors);

private:
    void renew(const Sensors& sensors);

    const std::size_t maximumKept_;
    std::mutex mutex_;
    SensorTexts records_;            // of what the lines are made
    std::vector<SensorTexts> lines_; // for each family; of a reading, the line up to the number
};

} // namespace Tools
