// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The capabilities of standard output.

#pragma once

#include <cstddef>

namespace Tools {

// Columns of a line; `unlimited` where no terminal cuts them.
inline constexpr std::size_t unlimited = static_cast<std::size_t>(-1);

// Returns the number in COLUMNS if it is one, else the terminal's width (80 when the terminal
// reports none), else unlimited.
std::size_t outputWidth();

// Returns whether the encoding of the user's locale, which the environment names, is UTF-8.
bool isUtf8Locale();

// Returns whether standard output is a terminal that is not dumb, and NO_COLOR is not set.
bool isColorTerminal();

} // namespace Tools
