// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/EventLog.h"

#include "platform/text/Utf8.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <string_view>

namespace Host::Http {

namespace {

constexpr int levelOfDetails = 4000;

struct CodeRange {
    char32_t first;
    char32_t last;
};

// Characters that are invisible or change how others are displayed. The log itself escapes the
// control characters of ASCII.
constexpr std::array<CodeRange, 9> unseen{{
    {0x80, 0x9F},       // control characters
    {0xAD, 0xAD},       // the hyphen that is shown at the end of a line
    {0x61C, 0x61C},     // a mark of direction
    {0x200B, 0x200F},   // without width, and marks of direction
    {0x2028, 0x202E},   // ends of lines, and changes of direction
    {0x2060, 0x206F},   // without width, and changes of direction
    {0xFEFF, 0xFEFF},   // the byte order mark
    {0xFFF9, 0xFFFB},   // annotations
    {0xE0000, 0xE007F}, // tags
}};

bool isUnseen(char32_t code)
{
    return std::any_of(unseen.begin(), unseen.end(),
        [code](const CodeRange& range) { return code >= range.first && code <= range.last; });
}

void appendNumber(std::string& line, const char* format, unsigned number)
{
    std::array<char, 16> text{};
    std::snprintf(text.data(), text.size(), format, number);
    line += text.data();
}

std::string legible(std::string_view text)
{
    std::string line;
    while (!text.empty()) {
        const auto next = Text::firstCharacter(text);
        if (!next.isValid)
            appendNumber(line, "<0x%02X>", static_cast<unsigned char>(text.front()));
        else if (isUnseen(next.code))
            appendNumber(line, "<U+%04X>", static_cast<unsigned>(next.code));
        else
            line += text.substr(0, next.size);
        text.remove_prefix(next.size);
    }
    return line;
}

} // namespace

// Without memory the line is lost.
void report(const Place& place, std::string_view text, Severity severity) noexcept
try {
    RynLog::RynLogger::logMessage(
        severity, place.function, place.file, place.line, "Http", legible(text));
} catch (...) {
    return;
}

void reportDetail(const Place& place, std::string_view text) noexcept
try {
    if (areDetailsLogged())
        RynLog::RynLogger::logLevelMessage(place.function, place.file, place.line, "Http",
            levelOfDetails, nullptr, 0, 0, legible(text));
} catch (...) {
    return;
}

bool areDetailsLogged() noexcept
{
    return RynLog::RynLogger::isWanted(levelOfDetails);
}

std::string logProblem() noexcept
{
    return RynLog::RynLogger::logProblem();
}

} // namespace Host::Http
