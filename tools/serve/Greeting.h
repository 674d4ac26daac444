// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/ListeningSocket.h"

#include <string>
#include <vector>

namespace Tools {

// Returns what the server prints when it is ready: its addresses, and a command to try.
std::string greeting(const std::vector<Host::Http::ListeningSocket>& sockets, bool isSignInNeeded);

} // namespace Tools
