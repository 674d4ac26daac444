// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Replaces the content of a file atomically.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// Writes a new file beside the old one, synchronizes it and renames it. Replaces the target of a
// symbolic link, not the link; writes to a device or pipe in place. Throws std::runtime_error with
// the file and the reason; the old content is unchanged then.
void replaceFile(const std::string& path, std::string_view content);

} // namespace Tools
