// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// One object in full.

#pragma once

#include <cstddef>
#include <string>

namespace Host {
class Instance;
}

namespace Tools {

// The object's name, then a line for each property in the order of the instance, with the
// meanings of codes and scaled numbers beside them. Values that are wider than the width go on
// in the next line.
std::string propertyList(const Host::Instance& instance, std::size_t width, bool isColored);

} // namespace Tools
