// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Captures what is written to the log and trace channels while it lives.

#pragma once

#include "platform/logging/Configuration.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <fstream>
#include <ostream>
#include <regex>
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

private:
    std::filesystem::path path(const char* channel) const { return folder_.path() / channel; }

    std::vector<LogLine> lines(const char* channel) const
    {
        // time, channel, level, component, function(file:line), text
        static const std::regex format(
            R"(^(\S+) (log|trace) (\d+) (\S+) (\S+)\(([^:]*):(\d+)\) (.*)$)");
        std::vector<LogLine> found;
        std::ifstream in(path(channel));
        for (std::string line; std::getline(in, line);) {
            std::smatch m;
            if (!std::regex_match(line, m, format)) {
                ADD_FAILURE() << "not a log line: " << line;
                continue;
            }
            found.push_back({m[2], std::stoi(m[3]), m[4], m[5], m[6],
                static_cast<unsigned>(std::stoul(m[7])), m[8]});
        }
        return found;
    }

    TemporaryFolder folder_;
};

} // namespace Testing
