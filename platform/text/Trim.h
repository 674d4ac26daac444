// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <algorithm>
#include <string_view>

namespace Text {

inline constexpr std::string_view asciiBlanks = " \t\n\v\f\r";

// Returns the text without the given characters at either end.
constexpr std::string_view trimmed(std::string_view text, std::string_view blanks = asciiBlanks)
{
    const auto isBlank = [blanks](char character) {
        return std::find(blanks.begin(), blanks.end(), character) != blanks.end();
    };
    while (!text.empty() && isBlank(text.front()))
        text.remove_prefix(1);
    while (!text.empty() && isBlank(text.back()))
        text.remove_suffix(1);
    return text;
}

} // namespace Text
