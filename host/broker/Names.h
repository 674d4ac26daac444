// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// CIM names (classes, properties, keys) are compared without regard to ASCII letter case.

#pragma once

#include <string_view>

namespace Host {

constexpr char foldCase(char c) noexcept
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

constexpr bool equalNames(std::string_view a, std::string_view b) noexcept
{
    if (a.size() != b.size())
        return false;
    if (a == b) // most names are written as they are declared
        return true;
    for (std::string_view::size_type i = 0; i < a.size(); ++i)
        if (foldCase(a[i]) != foldCase(b[i]))
            return false;
    return true;
}

} // namespace Host
