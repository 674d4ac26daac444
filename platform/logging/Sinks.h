// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/logging/LogSettings.h"

#include <memory>

namespace spdlog::sinks {
class sink;
}

namespace RynLog {

// Returns the sink of a setting, null when it is off. Throws std::runtime_error naming the file and
// the reason when it cannot be opened; so does the sink for a line that cannot be written.
std::shared_ptr<spdlog::sinks::sink> makeSink(const SinkSetting& setting);

} // namespace RynLog
