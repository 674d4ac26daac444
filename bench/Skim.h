// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tests/support/HttpClient.h"

#include <cstddef>

namespace Bench {

// Reads a CIM-XML answer to its end without keeping it: what a client does with an answer is not a
// cost of the server. Returns the number of bytes, 0 where the server has closed the connection
// instead. Throws std::runtime_error for an answer that is broken off or has an error status.
std::size_t skim(Testing::HttpClient& client);

} // namespace Bench
