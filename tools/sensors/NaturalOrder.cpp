// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/NaturalOrder.h"

#include "platform/text/Utf8.h"
#include "tools/sensors/LetterCase.h"

#include <algorithm>

namespace Tools {

namespace {

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

// Removes the number at the beginning and returns its digits without leading zeros.
std::string_view takeNumber(std::string_view& text)
{
    const auto end = std::find_if_not(text.begin(), text.end(), isDigit);
    std::string_view digits = text.substr(0, static_cast<std::size_t>(end - text.begin()));
    text.remove_prefix(digits.size());
    digits.remove_prefix(std::min(digits.find_first_not_of('0'), digits.size()));
    return digits;
}

// Removes the first character and returns it in lower case.
char32_t takeLetter(std::string_view& text)
{
    const Text::Character character = Text::firstCharacter(text);
    text.remove_prefix(character.size);
    return lowerCase(character.code);
}

} // namespace

std::weak_ordering compareNaturally(std::string_view first, std::string_view second)
{
    while (!first.empty() && !second.empty()) {
        if (isDigit(first.front()) && isDigit(second.front())) {
            const std::string_view left = takeNumber(first);
            const std::string_view right = takeNumber(second);
            if (const auto order = left.size() <=> right.size(); order != 0)
                return order;
            if (const auto order = left <=> right; order != 0)
                return order;
            continue;
        }
        const char32_t left = takeLetter(first);
        const char32_t right = takeLetter(second);
        if (const auto order = left <=> right; order != 0)
            return order;
    }
    return first.size() <=> second.size();
}

} // namespace Tools
