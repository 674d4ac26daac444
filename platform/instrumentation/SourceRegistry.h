// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Which kinds of source there are. `hwmon` and `model` are built in.

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/SourceList.h"

#include <functional>
#include <memory>
#include <string>

namespace Vorn {

// Makes a source from what stands after the colon of its entry (empty when nothing does).
// Throws std::runtime_error when the argument makes no sense or the source cannot be used.
using SourceFactory = std::function<std::unique_ptr<Source>(const std::string& argument)>;

// Adds a kind of source, or replaces it. May be called from any thread; cursors built before
// keep the sources they have.
void registerSource(const std::string& scheme, SourceFactory factory);

// A new source for the entry. May be called from any thread. Throws std::runtime_error naming
// the entry when its scheme is unknown, and whatever the factory throws.
std::unique_ptr<Source> openSource(const SourceEntry& entry);

} // namespace Vorn
