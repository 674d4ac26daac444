// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <functional>
#include <string>

namespace Host {

// Tells the name of the system that is served, at each request: it may change meanwhile. Called
// from any thread.
using HostName = std::function<std::string()>;

} // namespace Host
