// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where this code was loaded from.

#pragma once

#include <string>

namespace Vorn {

// The absolute folder of the program or library that holds this code, links resolved; empty
// when it cannot be found out.
std::string ownFolder();

} // namespace Vorn
