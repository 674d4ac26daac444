// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Escapes control characters, so that a text stays on its line and does not control a terminal.

#pragma once

#include <string>
#include <string_view>

namespace Text {

// Whether a backslash of the text is doubled, which keeps it apart from that of an escape.
enum class Backslash { kept, doubled };

// Appends the text with `\n` for a newline and `\xNN` for every other control character of ASCII.
// Other bytes, those from 0x80 up among them, stay as they are.
void appendEscaped(std::string& out, std::string_view text, Backslash backslash);

// Returns whether the text consists of printable ASCII only, as most do.
bool isPrintableAscii(std::string_view text);

// Returns the text as valid UTF-8 (see toValidUtf8) on one line: escaped in that way, with its
// backslashes kept.
std::string toOneLine(std::string_view text);

} // namespace Text
