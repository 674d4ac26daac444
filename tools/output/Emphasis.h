// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Colors on a terminal by their meaning.

#pragma once

#include <string>

namespace Tools {

enum class Emphasis { none, heading, faint, good, warning, critical };

// Returns the text between the terminal's control sequences; the text alone unless it is colored.
std::string emphasized(const std::string& text, Emphasis emphasis, bool isColored);

} // namespace Tools
