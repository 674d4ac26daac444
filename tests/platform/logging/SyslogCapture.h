// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Captures the lines that the process sends to syslog by replacing the C library's functions in
// this test program.

#pragma once

#include <string>
#include <vector>

namespace Testing {

struct SyslogLine {
    int priority;
    std::string text;
};

// Returns the lines since the previous call.
std::vector<SyslogLine> takeSyslogLines();

// Returns the number of calls of openlog, closelog and setlogmask, each of which changes the
// settings of the process.
int syslogSettingsChanged();

} // namespace Testing
