// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/ListeningSocket.h"

#include <string>
#include <vector>

namespace Tools {

// Where clients find the server, and a command to try. The port of a socket is the actual one.
std::string greeting(const std::vector<Host::Http::ListeningSocket>& sockets, bool isSignInNeeded);

} // namespace Tools
