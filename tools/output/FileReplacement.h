// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Writing a file so that it holds the old content or the new one, never half of either.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// Writes a new file beside the old one and puts it in its place once it is on the disk; the file
// that a symbolic link leads to is replaced, not the link. A device or pipe is written to as it is.
// Throws std::runtime_error naming the file and the reason; the old content is then untouched.
void replaceFile(const std::string& path, std::string_view content);

} // namespace Tools
