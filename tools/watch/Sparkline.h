// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/watch/History.h"

#include <cstddef>
#include <string>

namespace Tools {

// Returns the latest readings as bars of blocks, without UTF-8 of ASCII characters, between the
// least and the greatest bar. Each bar is the mean of so many readings that all kept ones fit
// into the width, and keeps them while further ones are added; a blank is a bar without any.
// REQUIRES: the width is not 0.
std::string sparkline(const WatchedSensor& watched, std::size_t width, bool isUtf8);

} // namespace Tools
