// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The paths of the provider libraries.

#pragma once

#include <optional>
#include <string>

namespace Tools {

// Both functions search relative to the tool's executable: in a build folder, and where an
// installation puts the libraries.

// Throws std::runtime_error with the searched folders when the library of the sensors is missing.
std::string findProviderFile();
// Returns nothing when the library of the computer system is not installed: another provider may
// serve that class.
std::optional<std::string> findComputerSystemProviderFile();

} // namespace Tools
