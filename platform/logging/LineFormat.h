// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

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

// Returns the text with a newline as \n, another control character as \xNN and a backslash as \\.
std::string escaped(std::string_view text);

// Returns "<channel> <level> <component> <function>(<file>:<line>) <text>" with each text escaped.
std::string formatLine(std::string_view channel, int level, const Origin& origin,
    std::string_view component, std::string_view text);

} // namespace RynLog
