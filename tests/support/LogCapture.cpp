// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/LogCapture.h"

#include "tests/support/Pattern.h"

#include <gtest/gtest.h>

#include <fstream>

namespace Testing {

std::string withoutPointers(const LogLine& line)
{
    static const Pattern pointer("=0x[0-9a-f]+");
    return line.function + "(" + line.file + ":" + std::to_string(line.line) + ") " +
           std::to_string(line.level) + " " + pointer.replace(line.text, "=PTR");
}

std::vector<std::string> withoutPointers(const std::vector<LogLine>& lines)
{
    std::vector<std::string> texts;
    for (const LogLine& line : lines)
        texts.push_back(withoutPointers(line));
    return texts;
}

std::vector<LogLine> LogCapture::lines(const char* channel) const
{
    // time, channel, level, component, function(file:line), text
    static const Pattern format(R"(^(\S+) (log|trace) (\d+) (\S+) (\S+)\(([^:]*):(\d+)\) (.*)$)");
    std::vector<LogLine> found;
    std::ifstream in(path(channel));
    for (std::string line; std::getline(in, line);) {
        const std::vector<std::string> m = format.match(line);
        if (m.empty()) {
            ADD_FAILURE() << "not a log line: " << line;
            continue;
        }
        found.push_back({m[2], std::stoi(m[3]), m[4], m[5], m[6],
            static_cast<unsigned>(std::stoul(m[7])), m[8]});
    }
    return found;
}

std::vector<std::string> LogCapture::marksOf(const std::string& function) const
{
    std::vector<std::string> marks;
    for (const LogLine& line : log())
        if (line.function == function)
            marks.push_back(
                line.text.substr(0, line.text.find(':')) + " " + std::to_string(line.line));
    return marks;
}

} // namespace Testing
