// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sources of sensors that are configured for this process. Functions may be called from any
// thread as long as none changes the environment.

#pragma once

#include "platform/instrumentation/SourceList.h"

#include <string>
#include <vector>

namespace Tools {

// Returns the sources of sensors. Throws std::runtime_error for a malformed list of them.
std::vector<Vorn::SourceEntry> configuredSources();

// Returns whether the sensors of the kernel are among them.
bool readsHwmon();

// Returns when the sensors of a management controller were read, such as "read 4 s ago": the oldest
// of several collections, without those that cannot be read. Returns an empty text where there is
// none.
std::string ageOfCollection();

// Returns the reasons why sources cannot be used, of which the provider publishes no sensors. Skips
// the chips where they are listed, since that is expensive. Opens the others again, which may have
// changed since the provider read them.
std::vector<std::string> failuresOfSources(bool areChipsListed);

} // namespace Tools
