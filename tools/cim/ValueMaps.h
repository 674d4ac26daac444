// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The DMTF value maps of CIM_NumericSensor and the classes it is derived from.

#pragma once

#include <cstdint>
#include <string_view>

namespace Tools {

// Returns the text of the property's value map for the code; empty when the property has no map or
// the code no text.
std::string_view meaningOf(std::string_view property, std::uint64_t code);

} // namespace Tools
