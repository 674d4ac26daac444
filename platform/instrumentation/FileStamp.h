// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Identity, size and times of a file, by which changes of the file are detected.

#pragma once

#include <compare>
#include <cstdint>

#include <sys/stat.h>

namespace Vorn {

// The time since 1970 as the kernel returns it: an int64 of nanoseconds could not hold all file
// times.
struct FileTime {
    std::int64_t seconds = 0;
    std::int64_t nanoseconds = 0;

    auto operator<=>(const FileTime&) const = default;
};

struct FileStamp {
    std::uint64_t device = 0;
    std::uint64_t inode = 0;
    std::int64_t size = 0;
    FileTime modified;
    FileTime changed; // changes also when a tool sets the time of modification

    bool operator==(const FileStamp&) const = default;
};

inline FileStamp stampOf(const struct stat& status)
{
    return {status.st_dev, status.st_ino, status.st_size,
        {status.st_mtim.tv_sec, status.st_mtim.tv_nsec},
        {status.st_ctim.tv_sec, status.st_ctim.tv_nsec}};
}

} // namespace Vorn
