// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Untrusted text on a terminal. The process's locale has no influence on any function.

#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Tools {

// Returns the number of a terminal's columns that the character occupies: 0, 1 or 2.
std::size_t widthOf(char32_t character);

// Returns valid UTF-8 in which `\n`, `\t`, `\r`, `\xNN` or `\uNNNN` replace unprintable characters,
// and U+FFFD invalid bytes. Without UTF-8, escapes replace all characters beyond ASCII, except that
// the degree sign is left out.
std::string printable(std::string_view text, bool isUtf8 = true);

// Returns the width in columns of a terminal. REQUIRES: the text is printable.
std::size_t displayWidth(std::string_view text);

// Returns the text when it fits, else as much of it as fits and an ellipsis, without UTF-8 a tilde.
// Splits no character and separates no accent from its letter. REQUIRES: the text is printable, the
// width at least 1.
std::string cutToWidth(std::string_view text, std::size_t width, bool isUtf8 = true);

} // namespace Tools
