// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The C library returns widths only in a UTF-8 locale, which a server may not have. These ranges
// are those of Unicode's East_Asian_Width (W and F) and of marks without a width.

#include "tools/output/PrintableText.h"

#include <algorithm>
#include <array>
#include <iterator>

namespace Tools {

namespace {

struct CodePoints {
    char32_t first;
    char32_t last;
};

// The ranges of both tables are ascending and disjoint.
constexpr std::array zeroWidth = {CodePoints{0x0300, 0x036F}, // combining diacritical marks
    CodePoints{0x0483, 0x0489}, CodePoints{0x0591, 0x05BD}, CodePoints{0x0610, 0x061A},
    CodePoints{0x064B, 0x065F}, CodePoints{0x06D6, 0x06DC}, CodePoints{0x0900, 0x0902},
    CodePoints{0x0941, 0x0948}, CodePoints{0x0E31, 0x0E31}, CodePoints{0x0E34, 0x0E3A},
    CodePoints{0x0E47, 0x0E4E},
    CodePoints{0x1160, 0x11FF}, // Hangul vowels and finals, which join the syllable before
    CodePoints{0x1AB0, 0x1AFF}, CodePoints{0x1DC0, 0x1DFF},
    CodePoints{0x200B, 0x200D}, // zero width space and joiners
    CodePoints{0x2060, 0x2064}, CodePoints{0x20D0, 0x20F0}, CodePoints{0x302A, 0x302D},
    CodePoints{0x3099, 0x309A}, CodePoints{0xFE00, 0xFE0F}, // variation selectors
    CodePoints{0xFE20, 0xFE2F}, CodePoints{0xFEFF, 0xFEFF}, CodePoints{0xE0100, 0xE01EF}};

constexpr std::array doubleWidth = {CodePoints{0x1100, 0x115F}, // Hangul initials
    CodePoints{0x231A, 0x231B}, CodePoints{0x2329, 0x232A}, CodePoints{0x23E9, 0x23EC},
    CodePoints{0x23F0, 0x23F0}, CodePoints{0x23F3, 0x23F3}, CodePoints{0x25FD, 0x25FE},
    CodePoints{0x2614, 0x2615}, CodePoints{0x2648, 0x2653}, CodePoints{0x267F, 0x267F},
    CodePoints{0x2693, 0x2693}, CodePoints{0x26A1, 0x26A1}, CodePoints{0x26AA, 0x26AB},
    CodePoints{0x26BD, 0x26BE}, CodePoints{0x26C4, 0x26C5}, CodePoints{0x26CE, 0x26CE},
    CodePoints{0x26D4, 0x26D4}, CodePoints{0x26EA, 0x26EA}, CodePoints{0x26F2, 0x26F3},
    CodePoints{0x26F5, 0x26F5}, CodePoints{0x26FA, 0x26FA}, CodePoints{0x26FD, 0x26FD},
    CodePoints{0x2705, 0x2705}, CodePoints{0x270A, 0x270B}, CodePoints{0x2728, 0x2728},
    CodePoints{0x274C, 0x274C}, CodePoints{0x274E, 0x274E}, CodePoints{0x2753, 0x2755},
    CodePoints{0x2757, 0x2757}, CodePoints{0x2795, 0x2797}, CodePoints{0x27B0, 0x27B0},
    CodePoints{0x27BF, 0x27BF}, CodePoints{0x2B1B, 0x2B1C}, CodePoints{0x2B50, 0x2B50},
    CodePoints{0x2B55, 0x2B55}, CodePoints{0x2E80, 0x3029}, // CJK radicals and punctuation
    CodePoints{0x302E, 0x303E}, CodePoints{0x3041, 0x3098},
    CodePoints{0x309B, 0x4DBF}, // kana, enclosed letters, ideographs
    CodePoints{0x4E00, 0xA4CF}, CodePoints{0xA960, 0xA97C},
    CodePoints{0xAC00, 0xD7A3}, // Hangul syllables
    CodePoints{0xF900, 0xFAFF}, CodePoints{0xFE10, 0xFE19}, CodePoints{0xFE30, 0xFE6B},
    CodePoints{0xFF01, 0xFF60}, // full-width forms
    CodePoints{0xFFE0, 0xFFE6}, CodePoints{0x16FE0, 0x18AFF}, CodePoints{0x1B000, 0x1B2FB},
    CodePoints{0x1F004, 0x1F004}, CodePoints{0x1F0CF, 0x1F0CF}, CodePoints{0x1F18E, 0x1F18E},
    CodePoints{0x1F191, 0x1F19A}, CodePoints{0x1F200, 0x1F320}, CodePoints{0x1F32D, 0x1F335},
    CodePoints{0x1F337, 0x1F37C}, CodePoints{0x1F37E, 0x1F393}, CodePoints{0x1F3A0, 0x1F3CA},
    CodePoints{0x1F3CF, 0x1F3D3}, CodePoints{0x1F3E0, 0x1F3F0}, CodePoints{0x1F3F4, 0x1F3F4},
    CodePoints{0x1F3F8, 0x1F43E}, CodePoints{0x1F440, 0x1F440}, CodePoints{0x1F442, 0x1F4FC},
    CodePoints{0x1F4FF, 0x1F53D}, CodePoints{0x1F54B, 0x1F54E}, CodePoints{0x1F550, 0x1F567},
    CodePoints{0x1F57A, 0x1F57A}, CodePoints{0x1F595, 0x1F596}, CodePoints{0x1F5A4, 0x1F5A4},
    CodePoints{0x1F5FB, 0x1F64F}, CodePoints{0x1F680, 0x1F6C5}, CodePoints{0x1F6CC, 0x1F6CC},
    CodePoints{0x1F6D0, 0x1F6D2}, CodePoints{0x1F6D5, 0x1F6D7}, CodePoints{0x1F6DC, 0x1F6DF},
    CodePoints{0x1F6EB, 0x1F6EC}, CodePoints{0x1F6F4, 0x1F6FC}, CodePoints{0x1F7E0, 0x1F7EB},
    CodePoints{0x1F90C, 0x1F93A}, CodePoints{0x1F93C, 0x1F945}, CodePoints{0x1F947, 0x1F9FF},
    CodePoints{0x1FA70, 0x1FAFF}, CodePoints{0x20000, 0x2FFFD}, CodePoints{0x30000, 0x3FFFD}};

template <std::size_t count>
constexpr bool isAscending(const std::array<CodePoints, count>& ranges)
{
    for (std::size_t i = 0; i < count; ++i)
        if (ranges[i].first > ranges[i].last || (i > 0 && ranges[i].first <= ranges[i - 1].last))
            return false;
    return true;
}
static_assert(isAscending(zeroWidth) && isAscending(doubleWidth));

template <std::size_t count>
bool contains(const std::array<CodePoints, count>& ranges, char32_t character)
{
    const auto after = std::upper_bound(ranges.begin(), ranges.end(), character,
        [](char32_t value, const CodePoints& range) { return value < range.first; });
    return after != ranges.begin() && character <= std::prev(after)->last;
}

} // namespace

std::size_t widthOf(char32_t character)
{
    if (contains(zeroWidth, character))
        return 0;
    return contains(doubleWidth, character) ? 2 : 1;
}

} // namespace Tools
