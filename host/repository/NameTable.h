// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A map whose keys are CIM names, compared without regard to letter case.

#pragma once

#include "host/broker/Names.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>

namespace Host {

struct NameHash {
    using is_transparent = void;
    std::size_t operator()(std::string_view name) const
    {
        std::uint64_t hash = 0xcbf29ce484222325; // FNV-1a
        for (const char c : name)
            hash = (hash ^ static_cast<unsigned char>(foldCase(c))) * 0x100000001b3;
        return static_cast<std::size_t>(hash);
    }
};

struct NameEquality {
    using is_transparent = void;
    bool operator()(std::string_view a, std::string_view b) const { return equalNames(a, b); }
};

template <typename Value>
using NameTable = std::unordered_map<std::string, Value, NameHash, NameEquality>;

} // namespace Host
