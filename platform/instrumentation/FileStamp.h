// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What tells one state of a file from another without reading it.

#pragma once

#include <cstdint>

#include <sys/stat.h>

namespace Vorn {

struct FileStamp {
    std::uint64_t device = 0;
    std::uint64_t inode = 0;
    std::int64_t size = 0;
    std::int64_t modified = 0; // nanoseconds since 1970
    std::int64_t changed = 0;  // the same; moves also when a tool sets the time of modification

    bool operator==(const FileStamp&) const = default;
};

inline FileStamp stampOf(const struct stat& status)
{
    constexpr std::int64_t nanosecondsPerSecond = 1'000'000'000;
    return {status.st_dev, status.st_ino, status.st_size,
        status.st_mtim.tv_sec * nanosecondsPerSecond + status.st_mtim.tv_nsec,
        status.st_ctim.tv_sec * nanosecondsPerSecond + status.st_ctim.tv_nsec};
}

} // namespace Vorn
