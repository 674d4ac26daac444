// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// CIM status codes of operations that pull, which CMPI does not name.

#pragma once

#include <cmpidt.h>

namespace Host {

inline constexpr auto invalidEnumerationContext = static_cast<CMPIrc>(21);
inline constexpr auto invalidOperationTimeout = static_cast<CMPIrc>(22);
inline constexpr auto filteredEnumerationNotSupported = static_cast<CMPIrc>(25);
inline constexpr auto continuationOnErrorNotSupported = static_cast<CMPIrc>(26);

} // namespace Host
