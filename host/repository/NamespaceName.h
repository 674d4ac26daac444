// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <string_view>

namespace Host {

// The name without slashes at its ends, such as root/cimv2; empty unless it is made of CIM names
// with single slashes between them.
std::string plainNamespaceName(std::string_view name);

} // namespace Host
