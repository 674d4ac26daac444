// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Objects of any class, a line each.

#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace Host {
class Instance;
}

namespace Tools {

// What tells the objects apart and how they are: their identifying keys (what associations
// refer to by its short name), names and states, as far as any of the objects has them; the
// class, too, where they are of several.
std::string objectTable(
    const std::vector<const Host::Instance*>& objects, std::size_t width, bool isColored);

} // namespace Tools
