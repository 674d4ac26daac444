// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Letters without regard to their case, as the C library's UTF-8 locale pairs them, whatever the
// locale of the process is. Without that locale, only ASCII letters are paired.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// Returns the small letter for a capital one, and other characters unchanged.
char32_t smallLetter(char32_t character);

// Returns the text with small letters in place of capital ones, and U+FFFD in place of invalid
// bytes.
std::string withSmallLetters(std::string_view text);

} // namespace Tools
