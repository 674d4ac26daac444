// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A table of objects of any class.

#pragma once

#include "tools/output/TextStyle.h"

#include <string>
#include <vector>

namespace Host {
class Instance;
}

namespace Tools {

// Returns a table with the identifying keys (of associations, the short names of their ends),
// names and states that any of the objects has; also the class where there are several.
std::string objectTable(const std::vector<const Host::Instance*>& objects, const TextStyle& style);

} // namespace Tools
