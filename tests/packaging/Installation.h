// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What `cmake --install` makes of this build.

#pragma once

#include "tests/support/TemporaryFolder.h"

#include <filesystem>
#include <map>
#include <string>
#include <vector>

namespace Testing {

// Runs `cmake --install` with these further arguments and variables. Throws std::runtime_error with
// what it said when it fails.
void install(const std::vector<std::string>& arguments,
    const std::map<std::string, std::string>& environment = {});

// The files below a folder, sorted and relative to it.
std::vector<std::string> filesBelow(const std::filesystem::path& folder);

// A whole installation that was moved from the prefix it was made for to another one. Made once
// for the process, since it only reads the build.
const std::filesystem::path& movedInstallation();

// Returns the path of one of its files.
inline std::string installedFile(const std::string& name)
{
    return (movedInstallation() / name).string();
}

} // namespace Testing
