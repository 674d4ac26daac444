// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Colours on a terminal, by what they say.

#pragma once

#include <string>

namespace Tools {

enum class Emphasis { none, heading, faint, good, warning, critical };

// The text with the terminal's codes around it; the text alone when it is not colored.
std::string emphasized(const std::string& text, Emphasis emphasis, bool isColored);

} // namespace Tools
