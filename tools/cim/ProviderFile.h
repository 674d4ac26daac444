// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where the provider libraries lie.

#pragma once

#include <optional>
#include <string>

namespace Tools {

// The libraries that belong to this tool, found by the tool's own place: in a build folder, or
// where an installation puts them.

// Of the sensors. Throws std::runtime_error naming the folders looked into.
std::string findProviderFile();
// Of the computer system; nothing when it is not installed, since others may serve that class.
std::optional<std::string> findComputerSystemProviderFile();

} // namespace Tools
