// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The states of sensors in words.

#pragma once

#include <span>
#include <string_view>

namespace Tools {

// In ascending order of urgency.
enum class Severity { normal, inactive, unknown, lost, warning, critical };

struct SensorState {
    std::string_view word = "Unknown"; // such as "Warning high"
    Severity severity = Severity::unknown;
};

// Returns the state with that CurrentState; where this is empty or "Unknown", the one with a code
// of OperationalStatus. Returns the state "Unknown" for all others.
SensorState stateOf(std::string_view currentState, std::span<const unsigned> statuses);

// Returns whether a person should look at the sensor.
bool isProblem(Severity severity);

// Returns the word for sensors of that severity in a summary, such as "warning".
std::string_view wordOf(Severity severity);

} // namespace Tools
