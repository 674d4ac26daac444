// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The order in which people sort names.

#pragma once

#include <string_view>

namespace Tools {

// Returns whether the first text comes before the second: "temp2" before "temp10", without regard
// to the case of ASCII letters.
bool isBefore(std::string_view first, std::string_view second);

} // namespace Tools
