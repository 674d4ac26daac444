// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the value of a sink setting means.

#pragma once

#include <optional>
#include <string>

namespace RynLog {

struct SinkSetting {
    enum class Kind { off, syslog, standardError, file };

    Kind kind = Kind::off;
    std::string path{}; // of a file, never empty then
};

// Understands syslog, stderr, file:PATH and off; nothing for anything else.
std::optional<SinkSetting> parseSinkSetting(const std::string& text);

} // namespace RynLog
