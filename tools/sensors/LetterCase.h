// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Letters and patterns by the C library's UTF-8 locale, whatever the locale of the process is.
// Without that locale, only ASCII letters have a case.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// Returns the lower case of an upper-case letter, and other characters unchanged.
char32_t lowerCase(char32_t character);

// Returns the text in lower case, with U+FFFD in place of invalid bytes.
std::string toLowerCase(std::string_view text);

// Returns whether the text matches the pattern of fnmatch(3), in which ? stands for a character.
bool matchesPattern(const std::string& pattern, const std::string& text);

} // namespace Tools
