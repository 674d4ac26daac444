// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The order in which people sort names.

#pragma once

#include <compare>
#include <string_view>

namespace Tools {

// Compares texts so that "temp2" comes before "temp10", without regard to letter case.
std::weak_ordering compareNaturally(std::string_view first, std::string_view second);

} // namespace Tools
