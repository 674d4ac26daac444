// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <dirent.h>

#include <memory>
#include <string>
#include <vector>

namespace Tools {

// Returns the names in a folder that are not hidden, in the kernel's order; none when it cannot be
// read.
inline std::vector<std::string> entriesOf(const std::string& folder)
{
    std::vector<std::string> names;
    const std::unique_ptr<DIR, int (*)(DIR*)> directory(::opendir(folder.c_str()), ::closedir);
    if (!directory)
        return names;
    while (const dirent* const entry = ::readdir(directory.get()))
        if (entry->d_name[0] != '.')
            names.emplace_back(entry->d_name);
    return names;
}

} // namespace Tools
