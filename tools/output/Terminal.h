// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What standard output can show.

#pragma once

#include <cstddef>

namespace Tools {

// Columns of a line; `unlimited` where no terminal cuts them.
inline constexpr std::size_t unlimited = static_cast<std::size_t>(-1);

// Returns the number in COLUMNS if it is one, else the terminal's width (80 when the terminal does
// not know it), else unlimited.
std::size_t outputWidth();

// Whether the user's locale, as the environment names it, is one of UTF-8.
bool isUtf8Locale();

// Whether standard output is a terminal that is not dumb, and NO_COLOR is not set.
bool isColorTerminal();

} // namespace Tools
