// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A file that a sink writes to, and a function that writes one line.

#pragma once

#include "platform/logging/LogSettings.h"
#include "platform/logging/RynLogger.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"

#include <string>
#include <vector>

namespace Testing {

class LogFile {
public:
    std::string path() const { return (folder_.path() / "lines").string(); }
    std::string sink() const { return "file:" + path(); }

    std::vector<std::string> lines() const { return linesOf(contentOf(path())); }

private:
    TemporaryFolder folder_;
};

// Sets the log during its lifetime and closes both channels at its end, so that no test reads the
// lines of another.
class ScopedLogSettings {
public:
    explicit ScopedLogSettings(const RynLog::LogSettings& settings) { RynLog::configure(settings); }
    ~ScopedLogSettings() { RynLog::configure({6000, "off", "off"}); }
    ScopedLogSettings(const ScopedLogSettings&) = delete;
    ScopedLogSettings& operator=(const ScopedLogSettings&) = delete;
};

inline void logLine(const std::string& text, int level = 6000)
{
    RynLog::RynLogger::logLevelMessage(
        "setVector", "Sensor", 740, "Nimbrel.Sensor", level, nullptr, 0, 0, text);
}

inline void traceLine(const std::string& text, int level = 6000)
{
    RynLog::RynLogger::traceLevelMessage(
        "setVector", "Sensor", 740, "Nimbrel.Sensor", level, nullptr, 0, 0, text);
}

} // namespace Testing
