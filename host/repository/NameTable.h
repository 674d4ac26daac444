// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A map whose keys are CIM names, compared without regard to letter case.

#pragma once

#include "host/broker/Names.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace Host {

struct NameHash {
    using is_transparent = void;
    std::size_t operator()(std::string_view name) const
    {
        std::string folded(name);
        for (char& c : folded)
            c = foldCase(c);
        return std::hash<std::string>()(folded);
    }
};

struct NameEquality {
    using is_transparent = void;
    bool operator()(std::string_view a, std::string_view b) const { return equalNames(a, b); }
};

template <typename Value>
using NameTable = std::unordered_map<std::string, Value, NameHash, NameEquality>;

} // namespace Host
