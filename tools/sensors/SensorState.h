// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The states of sensors in words.

#pragma once

#include <optional>
#include <span>
#include <string_view>

namespace Tools {

// In ascending order of urgency.
enum class Urgency { normal, inactive, unknown, lost, warning, critical };

struct SensorState {
    std::string_view word = "Unknown"; // such as "Warning high"
    Urgency urgency = Urgency::unknown;
};

// The state of a sensor that has not been there since its controller is being read: an empty slot,
// as a rule.
inline constexpr SensorState noContactState = {"No contact", Urgency::inactive};

// Returns the state with that CurrentState; where this is empty or "Unknown", the one with a code
// of OperationalStatus. Returns the state "Unknown" for all others.
SensorState stateOf(std::string_view currentState, std::span<const unsigned> statuses);

// The numbers by which states are stored, from 1 to this one. They never change.
inline constexpr unsigned greatestStateNumber = 17;
unsigned numberOf(const SensorState& state);
// REQUIRES: the number is that of a state.
SensorState stateNumbered(unsigned number);

// Returns the word for that CurrentState; nothing where no sensor has it.
std::optional<std::string_view> wordOfState(std::string_view currentState);

// Returns whether a person should look at the sensor.
bool isProblem(Urgency urgency);

// Returns the word for sensors of that urgency in a summary, such as "warning".
std::string_view wordOf(Urgency urgency);

} // namespace Tools
