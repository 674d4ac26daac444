// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The resources of this process, read from /proc.

#pragma once

#include <unistd.h>

#include <cstddef>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

namespace Testing {

// Returns whether the process has mapped the library.
inline bool isMapped(const std::string& library)
{
    const std::string path = std::filesystem::canonical(library).string();
    std::ifstream maps("/proc/self/maps");
    for (std::string line; std::getline(maps, line);)
        if (line.ends_with(path))
            return true;
    return false;
}

inline std::size_t openDescriptors()
{
    const std::filesystem::directory_iterator descriptors("/proc/self/fd");
    return static_cast<std::size_t>(std::distance(begin(descriptors), end(descriptors)));
}

inline std::size_t residentBytes()
{
    std::size_t whole = 0;
    std::size_t resident = 0;
    std::ifstream("/proc/self/statm") >> whole >> resident;
    return resident * static_cast<std::size_t>(::sysconf(_SC_PAGESIZE));
}

} // namespace Testing
