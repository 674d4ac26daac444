// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <span>
#include <string_view>

namespace Host {

class Arena;
class String;

// The lists of CMSetPropertyFilter: of the properties that a provider wants its instances to have,
// and of their keys. Used by one thread at a time.
class PropertyFilter {
public:
    // Returns a filter with these lists, which are null or end with a null. A provider sets the
    // same filter on each instance of an answer, so that they share one in the arena.
    static PropertyFilter& of(Arena& arena, const char** properties, const char** keys);

    std::span<const String* const> keys() const noexcept { return keys_; }
    bool hasProperties() const noexcept { return hasProperties_; }

    // Returns whether one of the lists has the name, in any letter case.
    bool lists(std::string_view name) noexcept;

private:
    friend class Arena;
    PropertyFilter(Arena& arena, const char** properties, const char** keys);
    bool isOf(const char** properties, const char** keys) const noexcept;

    bool hasProperties_; // also where the list is empty
    std::span<const String*> properties_;
    std::span<const String*> keys_;

    // The names of both lists. They take the order in which a provider sets properties, which is
    // the same for each instance, so that the next one is found at once.
    std::span<const String*> names_;
    std::size_t next_ = 0;
};

} // namespace Host
