// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/SourceList.h"

#include <memory>

namespace Vorn {

// Returns a new source of the kind that the entry names: `hwmon`, `ipmi` or `model`. Thread-safe.
// Throws std::runtime_error naming the entry when there is no such kind or its argument is invalid,
// and naming the file, line or chip when the source cannot be used.
std::unique_ptr<Source> openSource(const SourceEntry& entry);

} // namespace Vorn
