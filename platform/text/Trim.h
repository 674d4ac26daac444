// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string_view>

namespace Text {

inline constexpr std::string_view asciiBlanks = " \t\n\v\f\r";

// Returns the text without the given characters at either end.
constexpr std::string_view trimmed(std::string_view text, std::string_view blanks = asciiBlanks)
{
    const auto first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

} // namespace Text
