// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <string_view>

namespace Host {

// Returns the name without slashes at its ends, such as root/cimv2; empty unless it consists of
// CIM names with single slashes between them (DSP0004, 5.2.3).
std::string plainNamespaceName(std::string_view name);

} // namespace Host
