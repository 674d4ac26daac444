// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the process sends to syslog. The C library's functions are replaced in this test program,
// so that what would reach the system's log can be looked at.

#pragma once

#include <string>
#include <vector>

namespace Testing {

struct SyslogLine {
    int priority;
    std::string text;
};

// The lines since the previous call.
std::vector<SyslogLine> takeSyslogLines();

// How often openlog, closelog and setlogmask were called: each changes the process's settings.
int syslogSettingsChanged();

} // namespace Testing
