// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes that the tool's object manager knows.

#pragma once

#include "host/repository/Repository.h"

#include <memory>

namespace Tools {

// Compiled from the MOF files that belong to this tool, which lie in ../share/sensor-profile as
// seen from its executable. Throws std::runtime_error naming the file and the place in it when
// they are not there or cannot be compiled.
std::unique_ptr<const Host::Repository> compileClasses();

} // namespace Tools
