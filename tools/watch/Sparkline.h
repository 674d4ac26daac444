// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <deque>
#include <optional>
#include <string>

namespace Tools {

// Returns the latest readings as columns of blocks, without UTF-8 of ASCII characters, between the
// least and the greatest of them; a blank for none. It has at most that width.
std::string sparkline(
    const std::deque<std::optional<double>>& readings, std::size_t width, bool isUtf8);

} // namespace Tools
