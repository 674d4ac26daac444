// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>

namespace Testing {

// What enumerations that fail put into the status.
inline constexpr CMPIrc FailedEnumeration = CMPI_RC_ERR_ACCESS_DENIED;

// What the enumeration of the paths of capabilities returns; other than 0 without any path.
inline int capabilitiesPathsResult = 0;

} // namespace Testing
