// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LineFormat.h"

#include "platform/text/Escape.h"

#include <fmt/format.h>

#include <iterator>

namespace RynLog {

namespace {

std::string_view textOrNull(const char* text)
{
    return text != nullptr ? text : "(null)";
}

// Backslashes are doubled to distinguish those of the text from those of escapes.
void appendEscaped(std::string& line, std::string_view text)
{
    Text::appendEscaped(line, text, Text::Backslash::doubled);
}

} // namespace

std::string escaped(std::string_view text)
{
    std::string line;
    appendEscaped(line, text);
    return line;
}

std::string formatLine(std::string_view channel, int level, const Origin& origin,
    std::string_view component, std::string_view text)
{
    std::string line;
    fmt::format_to(std::back_inserter(line), "{} {} ", channel, level);
    appendEscaped(line, component);
    line += ' ';
    appendEscaped(line, textOrNull(origin.function));
    line += '(';
    appendEscaped(line, textOrNull(origin.file));
    fmt::format_to(std::back_inserter(line), ":{}) ", origin.line);
    appendEscaped(line, text);
    return line;
}

} // namespace RynLog
