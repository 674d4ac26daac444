// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where the provider library lies.

#pragma once

#include <string>

namespace Tools {

// The library that belongs to this tool, found by the tool's own place: in a build folder, or
// where an installation puts it. Throws std::runtime_error naming the folders looked into.
std::string findProviderFile();

} // namespace Tools
