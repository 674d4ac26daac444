// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// JSON that is safe to print.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// Replaces each unprintable character beyond ASCII's controls, which a serializer escapes, by a
// JSON escape. Such characters occur only within strings, where escapes are valid (RFC 8259).
// REQUIRES: valid JSON.
std::string escapeUnprintable(std::string_view json);

} // namespace Tools
