// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/text/Escape.h"

#include "platform/text/Utf8.h"

#include <algorithm>

namespace Text {

namespace {

void appendEscape(std::string& out, char character)
{
    constexpr std::string_view digits = "0123456789ABCDEF";
    if (character == '\n') {
        out += "\\n";
        return;
    }
    const auto code = static_cast<unsigned char>(character);
    out.append("\\x").append(1, digits[code >> 4U]).append(1, digits[code & 0xFU]);
}

bool isControl(char character)
{
    return static_cast<unsigned char>(character) < 0x20 || character == 0x7F;
}

} // namespace

void appendEscaped(std::string& out, std::string_view text, Backslash backslash)
{
    const auto isEscaped = [backslash](char character) {
        return isControl(character) || (character == '\\' && backslash == Backslash::doubled);
    };
    while (!text.empty()) {
        const auto* const escaped = std::find_if(text.begin(), text.end(), isEscaped);
        out.append(text.begin(), escaped);
        text.remove_prefix(static_cast<std::size_t>(escaped - text.begin()));
        if (text.empty())
            return;
        if (text.front() == '\\')
            out += "\\\\";
        else
            appendEscape(out, text.front());
        text.remove_prefix(1);
    }
}

bool isPrintableAscii(std::string_view text)
{
    return std::all_of(text.begin(), text.end(), [](char c) { return c >= ' ' && c <= '~'; });
}

std::string toOneLine(std::string_view text)
{
    if (isPrintableAscii(text))
        return std::string(text);
    std::string line;
    line.reserve(text.size());
    appendEscaped(line, toValidUtf8(text), Backslash::kept);
    return line;
}

} // namespace Text
