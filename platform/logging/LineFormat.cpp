// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LineFormat.h"

#include <fmt/format.h>

#include <algorithm>
#include <iterator>

namespace RynLog {

namespace {

bool needsEscape(char character)
{
    const auto byte = static_cast<unsigned char>(character);
    return byte < 0x20 || byte == 0x7F || byte == '\\';
}

void appendEscape(std::string& line, char character)
{
    if (character == '\n')
        line += "\\n";
    else if (character == '\\')
        line += "\\\\";
    else
        fmt::format_to(
            std::back_inserter(line), "\\x{:02X}", static_cast<unsigned char>(character));
}

std::string_view textOrNull(const char* text)
{
    return text != nullptr ? text : "(null)";
}

} // namespace

void appendEscaped(std::string& line, std::string_view text)
{
    for (auto next = text.begin(); next != text.end();) {
        const auto special = std::find_if(next, text.end(), needsEscape);
        line.append(next, special);
        if (special == text.end())
            return;
        appendEscape(line, *special);
        next = special + 1;
    }
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
