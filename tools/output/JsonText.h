// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// JSON (RFC 8259) that is safe to print.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// Appends the text as a JSON string. Invalid UTF-8 becomes U+FFFD, and unprintable characters are
// escaped.
void appendString(std::string& json, std::string_view text);

// Replaces each unprintable character beyond ASCII's controls, which a serializer escapes, by a
// JSON escape. Such characters occur only within strings, where escapes are valid.
// REQUIRES: valid JSON.
std::string escapeUnprintable(std::string_view json);

} // namespace Tools
