// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>

namespace Testing {

// The code that failing enumerations set in the status.
inline constexpr CMPIrc failedEnumeration = CMPI_RC_ERR_ACCESS_DENIED;

// The result of the enumeration of the paths of capabilities, which adds no path when it is not 0.
inline int capabilitiesPathsResult = 0;

} // namespace Testing
