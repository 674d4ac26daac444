// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Installations of this build by `cmake --install`.

#pragma once

#include "tests/support/TemporaryFolder.h"

#include <filesystem>
#include <map>
#include <string>
#include <vector>

namespace Testing {

// Runs `cmake --install` with these further arguments and variables. Throws std::runtime_error with
// its output when it fails.
void install(const std::vector<std::string>& arguments,
    const std::map<std::string, std::string>& environment = {});

// The files below a folder, sorted and relative to it.
std::vector<std::string> filesBelow(const std::filesystem::path& folder);

// Returns the folder of a complete installation that was moved from its prefix to another one. The
// tests of a process share it.
const std::filesystem::path& movedInstallation();

// Returns the path of a file of movedInstallation().
inline std::string installedFile(const std::string& name)
{
    return (movedInstallation() / name).string();
}

} // namespace Testing
