// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A table of objects of any class.

#pragma once

#include "tools/cim/ProviderClient.h"
#include "tools/output/TextStyle.h"

#include <string>

namespace Tools {

// Returns a table of the provider's objects with the identifying keys (of associations, the short
// names of their ends), names and states that any of the objects has; also the class where there
// are several.
std::string objectTable(
    const ProviderClient& provider, const Instances& objects, const TextStyle& style);

} // namespace Tools
