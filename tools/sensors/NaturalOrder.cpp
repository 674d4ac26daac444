// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/NaturalOrder.h"

#include "host/broker/Names.h"

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
        const auto left = static_cast<unsigned char>(Host::foldCase(first.front()));
        const auto right = static_cast<unsigned char>(Host::foldCase(second.front()));
        if (const auto order = left <=> right; order != 0)
            return order;
        first.remove_prefix(1);
        second.remove_prefix(1);
    }
    return first.size() <=> second.size();
}

} // namespace Tools
