// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// UTF-8 as RFC 3629 defines it: no overlong forms, no surrogates, nothing above U+10FFFF.

#include "platform/utilities/ProviderUtilities.h"

#include <cstddef>
#include <cstdint>

namespace Vorn {

namespace {

static_assert(sizeof(wchar_t) == sizeof(char32_t), "a wide character holds a code point");

constexpr char32_t replacement = 0xFFFD;

bool isCodePoint(char32_t code)
{
    return code <= 0x10FFFF && (code < 0xD800 || code > 0xDFFF);
}

// What may follow a leading byte: how many bytes, and the bounds of the first of them, which
// keep overlong forms, surrogates and codes above the last one out.
struct Sequence {
    int following;
    std::uint8_t lowest;
    std::uint8_t highest;
    char32_t leadingBits;
};

constexpr Sequence invalidSequence{-1, 0, 0, 0};

Sequence sequenceOf(std::uint8_t lead)
{
    if (lead < 0x80)
        return {0, 0, 0, lead};
    if (lead < 0xC2 || lead > 0xF4)
        return invalidSequence;
    if (lead < 0xE0)
        return {1, 0x80, 0xBF, lead & 0x1FU};
    if (lead < 0xF0)
        return {2, static_cast<std::uint8_t>(lead == 0xE0 ? 0xA0 : 0x80),
            static_cast<std::uint8_t>(lead == 0xED ? 0x9F : 0xBF), lead & 0x0FU};
    return {3, static_cast<std::uint8_t>(lead == 0xF0 ? 0x90 : 0x80),
        static_cast<std::uint8_t>(lead == 0xF4 ? 0x8F : 0xBF), lead & 0x07U};
}

// Decodes the code point at `position` and moves past it, or past the longest prefix of one.
char32_t decodeNext(const std::string& text, std::size_t& position)
{
    Sequence sequence = sequenceOf(static_cast<std::uint8_t>(text[position++]));
    if (sequence.following < 0)
        return replacement;
    char32_t code = sequence.leadingBits;
    for (; sequence.following > 0; --sequence.following) {
        if (position == text.size())
            return replacement;
        const auto byte = static_cast<std::uint8_t>(text[position]);
        if (byte < sequence.lowest || byte > sequence.highest)
            return replacement;
        code = (code << 6U) | (byte & 0x3FU);
        sequence.lowest = 0x80;
        sequence.highest = 0xBF;
        ++position;
    }
    return code;
}

void appendByte(std::string& text, char32_t byte)
{
    text += static_cast<char>(static_cast<std::uint8_t>(byte));
}

// REQUIRES: a code point that needs more than one byte.
void encode(std::string& text, char32_t code)
{
    const auto appendFollowing = [&](unsigned shift) {
        appendByte(text, 0x80U | ((code >> shift) & 0x3FU));
    };
    if (code < 0x800) {
        appendByte(text, 0xC0U | (code >> 6U));
        appendFollowing(0);
    } else if (code < 0x10000) {
        appendByte(text, 0xE0U | (code >> 12U));
        appendFollowing(6);
        appendFollowing(0);
    } else {
        appendByte(text, 0xF0U | (code >> 18U));
        appendFollowing(12);
        appendFollowing(6);
        appendFollowing(0);
    }
}

} // namespace

std::string make_string(const std::wstring& text)
{
    std::string narrow;
    narrow.reserve(text.size());
    for (const wchar_t character : text) {
        const auto code = static_cast<char32_t>(character);
        if (code < 0x80) // nearly always
            narrow += static_cast<char>(character);
        else
            encode(narrow, isCodePoint(code) ? code : replacement);
    }
    return narrow;
}

std::wstring make_wstring(const std::string& text)
{
    std::wstring wide;
    wide.reserve(text.size());
    for (std::size_t position = 0; position < text.size();)
        wide += static_cast<wchar_t>(decodeNext(text, position));
    return wide;
}

} // namespace Vorn
