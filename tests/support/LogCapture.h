// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Captures the lines that are written to the log and trace channels during its lifetime.

#pragma once

#include "platform/logging/LogSettings.h"
#include "tests/support/TemporaryFolder.h"

#include <ostream>
#include <string>
#include <vector>

namespace Testing {

struct LogLine {
    std::string channel;
    int level = 0;
    std::string component;
    std::string function;
    std::string file;
    unsigned line = 0;
    std::string text;

    bool operator==(const LogLine&) const = default;
};

inline std::ostream& operator<<(std::ostream& out, const LogLine& line)
{
    return out << line.channel << ' ' << line.level << ' ' << line.component << ' ' << line.function
               << '(' << line.file << ':' << line.line << ") " << line.text;
}

// Returns a line without its pointers, such as `setVector(Sensor:740) 3000 ENTERING: ... =PTR`.
std::string withoutPointers(const LogLine& line);
std::vector<std::string> withoutPointers(const std::vector<LogLine>& lines);

class LogCapture {
public:
    explicit LogCapture(int level = 0)
    {
        RynLog::configure(
            {level, "file:" + path("log").string(), "file:" + path("trace").string()});
    }
    ~LogCapture() { RynLog::configure({6000, "off", "off"}); }
    LogCapture(const LogCapture&) = delete;
    LogCapture& operator=(const LogCapture&) = delete;

    std::vector<LogLine> log() const { return lines("log"); }
    std::vector<LogLine> trace() const { return lines("trace"); }

    // Returns the kinds and line numbers of a function's log lines, such as `EXITING 737`.
    std::vector<std::string> marksOf(const std::string& function) const;

private:
    std::filesystem::path path(const char* channel) const { return folder_.path() / channel; }

    std::vector<LogLine> lines(const char* channel) const;

    TemporaryFolder folder_;
};

} // namespace Testing
