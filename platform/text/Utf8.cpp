// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/text/Utf8.h"

#include <utf8.h>

namespace Text {

namespace {

constexpr std::size_t longestCharacter = 4;

bool isContinuation(char byte)
{
    return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
}

bool isCodePoint(char32_t code)
{
    return code <= 0x10FFFF && (code < 0xD800 || code > 0xDFFF);
}

} // namespace

Character firstCharacter(std::string_view text)
{
    const auto lead = static_cast<unsigned char>(text.front());
    if (lead < 0x80)
        return {lead, 1, true};
    // The library's decoder reports invalid bytes by an exception, which texts full of them would
    // make expensive.
    if (utf8::find_invalid(text.substr(0, longestCharacter)) == 0)
        return {};
    const char* next = text.data();
    const char32_t code = utf8::unchecked::next(next);
    return {code, static_cast<std::size_t>(next - text.data()), true};
}

void appendUtf8(std::string& out, char32_t code)
{
    utf8::append(isCodePoint(code) ? code : replacementCharacter, out);
}

bool isUnprintable(char32_t character)
{
    const auto isWithin = [&](char32_t first, char32_t last) {
        return character >= first && character <= last;
    };
    const bool isControl = character < 0x20 || isWithin(0x7F, 0x9F);
    const bool isSeparator = character == 0x2028 || character == 0x2029;
    const bool isBidirectional = character == 0x061C || isWithin(0x200E, 0x200F) ||
                                 isWithin(0x202A, 0x202E) || isWithin(0x2066, 0x2069);
    return isControl || isSeparator || isBidirectional;
}

std::string toValidUtf8(std::string_view text)
{
    std::string valid;
    valid.reserve(text.size());
    for (;;) {
        const std::size_t length = utf8::find_invalid(text);
        valid += text.substr(0, length);
        if (length == std::string_view::npos)
            return valid;
        appendUtf8(valid, replacementCharacter);
        text.remove_prefix(length + 1);
    }
}

std::string_view cutAtCharacter(std::string_view text, std::size_t maximumBytes)
{
    if (text.size() <= maximumBytes)
        return text;
    while (maximumBytes > 0 && isContinuation(text[maximumBytes]))
        --maximumBytes;
    return text.substr(0, maximumBytes);
}

} // namespace Text
