// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes of the tool's object manager.

#pragma once

#include "host/repository/Repository.h"

#include <filesystem>
#include <memory>

namespace Tools {

// Returns the folder of the files that are installed with the tool, ../share/sensor-profile
// relative to its executable.
std::filesystem::path installedFolder();

// Compiles the MOF files in that folder. Throws std::runtime_error with the file, and the place in
// it, when they are missing or cannot be compiled.
std::unique_ptr<const Host::Repository> compileClasses();

} // namespace Tools
