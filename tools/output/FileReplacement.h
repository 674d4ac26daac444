// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Replaces the content of a file atomically.

#pragma once

#include "platform/utilities/Descriptor.h"

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

// A file that this process replaces again and again, and which every user can read. The new file is
// PATH.new. A lock of PATH.lock, which remains, keeps other processes from renewing the same file;
// a device or pipe has none.
class RenewedFile {
public:
    // Removes the PATH.new of a process that was ended while it wrote. Throws std::runtime_error
    // with the file and the reason where another process renews it, or where it cannot be renewed.
    explicit RenewedFile(std::string path);

    // Throws std::runtime_error as replaceFile() does.
    void renew(std::string_view content) const;

private:
    std::string path_;
    Vorn::Descriptor lock_;
};

} // namespace Tools
