// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <vector>

namespace Testing {

// The name of the setter that returns false; none when empty.
extern std::string refusedSetter;

// The setters called so far, in order.
extern std::vector<std::string> setterCalls;

} // namespace Testing
