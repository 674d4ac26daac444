// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Inserting an argument into a localised text.

#pragma once

#include <cstddef>
#include <string>

namespace Vorn {

// Puts a UTF-8 argument in the place of the format's %s ("%%" gives one percent sign), whatever
// locale the process runs in. The result has at most `capacity - 1` characters and is cut at a
// character boundary; what is not valid UTF-8 becomes U+FFFD.
// REQUIRES: the format holds exactly one %s and no other conversion; capacity > 0.
std::wstring formatText(
    const std::wstring& format, const std::string& argument, std::size_t capacity);

} // namespace Vorn
