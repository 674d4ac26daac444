// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes of the tool's object manager.

#pragma once

#include "host/repository/Repository.h"

#include <memory>

namespace Tools {

// Compiles the MOF files that are installed with the tool, in ../share/sensor-profile relative to
// its executable. Throws std::runtime_error with the file, and the place in it, when they are
// missing or cannot be compiled.
std::unique_ptr<const Host::Repository> compileClasses();

} // namespace Tools
