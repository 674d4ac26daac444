// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The text of one line, without its time.

#pragma once

#include <string>
#include <string_view>

namespace RynLog {

// Where a line comes from. The texts may be null.
struct Origin {
    const char* function;
    const char* file;
    unsigned line;
};

// "<channel> <level> <component> <function>(<file>:<line>) <text>", escaped.
std::string formatLine(std::string_view channel, int level, const Origin& origin,
    std::string_view component, std::string_view text);

// Appends the text with newlines as \n, other control characters as \xNN and backslashes as \\.
// Bytes from 0x80 up are taken as UTF-8 text and stay.
void appendEscaped(std::string& line, std::string_view text);

} // namespace RynLog
