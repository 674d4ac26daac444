// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// JSON that is safe to look at.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// The same document, with a JSON escape for each character above ASCII's controls that a
// terminal might obey; a serializer escapes only those below. Outside of its texts JSON is
// ASCII, so that every such character stands where it may be escaped. REQUIRES: valid JSON.
std::string escapeUnprintable(std::string_view json);

} // namespace Tools
