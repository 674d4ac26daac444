// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <optional>
#include <string>

namespace RynLog {

// The parsed value of RYNLOG_LOG or RYNLOG_TRACE.
struct SinkSetting {
    enum class Kind { off, syslog, standardError, file };

    Kind kind = Kind::off;
    std::string path{}; // of a file; never empty for one
};

// Parses syslog, stderr, file:PATH and off; returns nothing for any other text.
std::optional<SinkSetting> parseSinkSetting(const std::string& text);

} // namespace RynLog
