// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <string>

namespace Vorn {

// Returns the format with a UTF-8 argument in the place of its %s, whatever locale the process runs
// in. The result is cut at a character boundary to at most `capacity - 1` characters; each byte
// that is not UTF-8 becomes U+FFFD. REQUIRES: the format holds exactly one %s.
std::wstring formatText(
    const std::wstring& format, const std::string& argument, std::size_t capacity);

} // namespace Vorn
