// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Replaces the content of a file atomically.

#pragma once

#include <sys/types.h>

#include <optional>
#include <string>
#include <string_view>

namespace Tools {

// Writes a new file beside the old one, synchronizes it and renames it. Replaces the target of a
// symbolic link, not the link; writes to a device or pipe in place. Throws std::runtime_error with
// the file and the reason; the old content is unchanged then. Without a mode, the new file has that
// of the old one, or that of new files where there is none.
void replaceFile(
    const std::string& path, std::string_view content, std::optional<::mode_t> mode = std::nullopt);

} // namespace Tools
