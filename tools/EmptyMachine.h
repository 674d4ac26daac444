// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What to tell a user who got nothing.

#pragma once

#include "tools/Command.h"

#include <cstddef>
#include <optional>
#include <string>

namespace Tools {

// How many sensors the machine has, seen without a provider. REQUIRES: no provider is loaded any
// more, since it may share libraries with this look. Throws std::runtime_error with the reason
// when the machine cannot be read.
std::size_t countSensors();

// A provider answers with nothing both when a machine has no sensors and when they cannot be
// read. Returns in the first case, throws std::runtime_error with the reason in the second.
// REQUIRES: as above.
void checkMachineIsEmpty();

// Says on standard error that the machine, or the model file, has no sensors.
ExitCode complainOfEmptyMachine(const std::optional<std::string>& model);

// Says there that no object is the one the user means, or that there are none to choose from.
// REQUIRES and throws as checkMachineIsEmpty does when the machine is empty.
ExitCode complainOfNoObject(
    const std::string& wanted, bool isMachineEmpty, const std::optional<std::string>& model);

} // namespace Tools
