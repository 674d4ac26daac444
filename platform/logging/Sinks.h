// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where lines end up.

#pragma once

#include "platform/logging/SinkSetting.h"

#include <memory>

namespace spdlog::sinks {
class sink;
}

namespace RynLog {

// The sink of a setting; null when it is off. Throws std::runtime_error naming the file and the
// reason when it cannot be opened. The sink throws one like it for a line that cannot be written.
std::shared_ptr<spdlog::sinks::sink> makeSink(const SinkSetting& setting);

} // namespace RynLog
