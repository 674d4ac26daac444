// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whether a machine has no sensors, and the message for the user then.

#pragma once

#include "tools/Command.h"

#include <cstddef>
#include <optional>
#include <string>

namespace Tools {

// Returns the number of the machine's sensors, counted without a provider. Throws
// std::runtime_error with the reason when the machine cannot be read.
// REQUIRES: no provider is loaded, since it may share libraries with this function.
std::size_t countSensors();

// Throws std::runtime_error with the reason when sensors exist or cannot be read. Providers return
// an empty answer in that case as well as for a machine without sensors.
// REQUIRES: no provider is loaded.
void checkMachineIsEmpty();

// Writes to standard error that the machine, or the model file, has no sensors.
ExitCode complainOfEmptyMachine(const std::optional<std::string>& model);

} // namespace Tools
