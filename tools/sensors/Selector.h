// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sensors by the names that users give.

#pragma once

#include "tools/sensors/SensorList.h"

#include <string>
#include <vector>

namespace Tools {

// Returns whether the selector is the chip, the label, the feature, the path or the DeviceID of the
// sensor, or chip and label or feature with a slash between them, in any letter case; or a pattern
// of fnmatch(3) that one of them matches. The address of a chip may be shortened.
bool selects(const std::string& selector, const Sensor& sensor);

// Returns whether the sensor is of one of the kinds, or there are none.
bool isOfKind(const std::vector<std::string>& kinds, const Sensor& sensor);

// What else a sensor must be, beside what its name is.
struct SensorFilter {
    std::vector<std::string> kinds; // all where there are none
    bool onlyProblems = false;

    bool isEmpty() const { return kinds.empty() && !onlyProblems; }
    bool accepts(const Sensor& sensor) const;
};

// Returns a sentence that no sensor matches the selector, with up to three names that are nearest;
// where none is near, with up to three chips.
std::string nothingMatches(const std::string& selector, const Sensors& sensors);

} // namespace Tools
