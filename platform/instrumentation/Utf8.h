// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Texts that come from drivers and files, made fit for printing.

#pragma once

#include <string>
#include <string_view>

namespace Vorn {

// Each byte that belongs to no character becomes U+FFFD; overlong forms, surrogates and what
// lies above U+10FFFF are no characters.
std::string toValidUtf8(std::string_view text);

// Without the ASCII blanks at both ends.
std::string_view trimBlanks(std::string_view text);

// ASCII control characters become `\xNN`.
std::string escapeControls(std::string_view text);

} // namespace Vorn
