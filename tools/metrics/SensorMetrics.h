// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/metrics/Exposition.h"
#include "tools/sensors/SensorList.h"

#include <array>
#include <cstddef>
#include <mutex>
#include <span>
#include <string>
#include <vector>

namespace Tools {

// Writes the readings, limits, states and health of sensors. From one exposition to the next, as a
// rule only the numbers of readings change: the other lines of a sensor are kept until something
// else of it does. Thread-safe.
class SensorMetrics {
public:
    // Keeps the lines of a machine of at most so many sensors, and none of a larger one.
    explicit SensorMetrics(std::size_t maximumKept) : maximumKept_(maximumKept) {}

    void addTo(Exposition& exposition, const Sensors& sensors);

private:
    // The lines of a sensor; of its reading, the line up to the number.
    enum Part : std::size_t { reading, limits, states, health };
    struct Lines {
        explicit Lines(const Sensor& from);

        Sensor sensor; // of which they are made
        std::array<std::string, 4> parts;
    };

    static std::string linesOf(const Sensor& sensor, Part part);
    static void write(Exposition& exposition, const Sensors& sensors, std::span<const Lines> kept);
    void renew(const Sensors& sensors);

    const std::size_t maximumKept_;
    std::mutex mutex_;
    std::vector<Lines> kept_; // in the order of the latest sensors
};

} // namespace Tools
