// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Texts of unknown origin on a terminal: what they may contain and how wide they are. All of
// it is the same in every locale.

#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Tools {

// Whether a terminal might obey the character instead of showing it, or show its neighbours in
// another order: controls, line and paragraph separators, bidirectional controls.
bool isUnprintable(char32_t character);

// How many columns of a terminal it takes: 0, 1 or 2.
std::size_t widthOf(char32_t character);

// Valid UTF-8 without unprintable characters: `\n`, `\t`, `\r`, `\xNN` or `\uNNNN` stand for
// those, U+FFFD for bytes that are no characters.
std::string printable(std::string_view text);

// In columns of a terminal. REQUIRES, as for what follows: the text is printable.
std::size_t displayWidth(std::string_view text);

// The text itself when it fits, else as much of it as fits with an ellipsis after it. Never
// parts a character, nor an accent from its letter. REQUIRES: width is at least 1.
std::string cutToWidth(std::string_view text, std::size_t width);

} // namespace Tools
