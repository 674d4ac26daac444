// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What qualifiers may stand on, and what becomes of them in subclasses.

#pragma once

#include <cstdint>

namespace Host {

enum class Scope : std::uint16_t {
    schema = 1,
    classes = 2,
    association = 4,
    indication = 8,
    qualifier = 16,
    property = 32,
    reference = 64,
    method = 128,
    parameter = 256,
    any = 511,
};

class ScopeSet {
public:
    constexpr ScopeSet() = default;
    constexpr ScopeSet(Scope scope) : bits_(static_cast<std::uint16_t>(scope)) {}

    constexpr void add(Scope scope)
    {
        bits_ = static_cast<std::uint16_t>(bits_ | static_cast<std::uint16_t>(scope));
    }
    constexpr bool has(Scope scope) const
    {
        const auto wanted = static_cast<std::uint16_t>(scope);
        return (bits_ & wanted) == wanted;
    }

private:
    std::uint16_t bits_ = 0;
};

// The defaults are those of a qualifier declared without flavors.
struct Flavor {
    bool isOverridable = true; // EnableOverride: a subclass may give it another value
    bool isInherited = true;   // ToSubclass, else Restricted
    bool isTranslatable = false;

    bool operator==(const Flavor&) const = default;
};

enum class FlavorChange : std::uint8_t {
    enableOverride,
    disableOverride,
    toSubclass,
    restricted,
    translatable,
};

} // namespace Host
