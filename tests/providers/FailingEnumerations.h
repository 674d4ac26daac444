// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>

namespace Testing {

// What enumerations that fail put into the status.
inline constexpr CMPIrc FailedEnumeration = CMPI_RC_ERR_ACCESS_DENIED;

} // namespace Testing
