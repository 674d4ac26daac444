// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What standard output is, and what the user wants of it.

#pragma once

#include <cstddef>

namespace Tools {

enum class ColorChoice { automatic, always, never };

// Columns of a line; `unlimited` where no terminal cuts them.
inline constexpr std::size_t unlimited = static_cast<std::size_t>(-1);

// What COLUMNS says when it is a sensible number, else the terminal's width (80 when the
// terminal does not know it), else unlimited.
std::size_t outputWidth();

// Whether the user's locale, as the environment names it, is one of UTF-8.
bool isUtf8Locale();

// Automatic: on a terminal that is not dumb, unless NO_COLOR is set.
bool isColorWanted(ColorChoice choice);

} // namespace Tools
