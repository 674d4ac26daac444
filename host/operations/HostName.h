// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <functional>
#include <string>

namespace Host {

// Returns the current name of the system that is served, which may change between requests.
// Thread-safe.
using HostName = std::function<std::string()>;

} // namespace Host
