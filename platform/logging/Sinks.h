// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where lines end up.

#pragma once

#include "platform/logging/SinkSetting.h"

#include <memory>

namespace spdlog::sinks {
class sink;
}

namespace RynLog {

// The sink of a setting; null when it is off or its file cannot be opened, which is reported
// to syslog.
std::shared_ptr<spdlog::sinks::sink> makeSink(const SinkSetting& setting);

} // namespace RynLog
