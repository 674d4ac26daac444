// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The verdict of `check` in the form that monitoring systems read.

#pragma once

#include "tools/check/Range.h"
#include "tools/sensors/SensorList.h"

#include <optional>
#include <string>
#include <vector>

namespace Tools {

// The exit codes of monitoring plugins.
enum class CheckStatus { ok = 0, warning = 1, critical = 2, unknown = 3 };

// A range that replaces the limits of the sensors that the selector matches.
struct Override {
    std::string selector;
    Range range;
};

// Later overrides have precedence.
struct Overrides {
    std::vector<Override> warning;
    std::vector<Override> critical;
};

// Returns the status of a sensor by its state and the ranges.
CheckStatus statusOf(const Sensor& sensor, const Overrides& overrides);

class Report {
public:
    // Adds a problem: a sentence without a full stop.
    void add(CheckStatus status, std::string problem);
    // Adds the problem of the sensor, if it has one, and its performance data.
    void add(const Sensor& sensor, const std::string& name, const Overrides& overrides);

    // Returns the most important status: critical, then warning, then unknown.
    CheckStatus status() const;

    // Returns a line: the status, the problems, the summary and, after a bar, the performance data.
    std::string toText(const std::string& summary, bool isUtf8) const;

private:
    struct Problem {
        CheckStatus status;
        std::string text;
    };

    std::vector<Problem> problems_;
    std::string performance_;
};

// Adds the sensors by names that are unique on the machine, which has all of them: chip and label,
// with the channel where several share these. So a name does not depend on what is selected.
void addSensors(
    Report& report, const Sensors& sensors, const Sensors& machine, const Overrides& overrides);

// Adds the chips and sensors that are expected but missing or without contact, as critical
// problems.
void addMissing(Report& report, const Sensors& expected, const Sensors& present);

} // namespace Tools
