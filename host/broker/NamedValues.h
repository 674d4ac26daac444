// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Values found by name, in the order in which they were first set: the keys of a path, the
// properties of an instance.

#pragma once

#include "host/broker/ArenaList.h"
#include "host/broker/Value.h"

#include <cmpidt.h>

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace Host {

struct NamedValue {
    const String* name = nullptr; // never without text
    Value value;
};

// Each change takes memory from the given arena.
class NamedValues {
public:
    NamedValues() noexcept = default;
    NamedValues(NamedValues&&) noexcept = default;
    NamedValues& operator=(NamedValues&&) noexcept = default;

    std::size_t size() const noexcept { return elements_.size(); }
    auto begin() const noexcept { return elements_.begin(); }
    auto end() const noexcept { return elements_.end(); }

    // Returns the value of that name, in any letter case; null when there is none.
    const NamedValue* find(std::string_view name) const noexcept;

    // Replaces the value of that name in its place, or adds one at the end. The value must
    // live as long as the arena.
    void set(Arena& arena, std::string_view name, const Value& value);

    // Keeps the elements the predicate holds for.
    template <typename Predicate>
    void retain(Arena& arena, Predicate predicate)
    {
        ArenaList<NamedValue> kept;
        for (const NamedValue& element : elements_)
            if (predicate(element))
                kept.append(arena, element);
        elements_ = kept;
        isShared_ = false;
    }

    // Returns a copy that shares the elements until one of the two changes. The original must live
    // as long as the copy.
    NamedValues shared() const;

    // Return what the get functions of CMPI do. Throw Refusal with the code when there is no
    // such name, and with CMPI_RC_ERR_NO_SUCH_PROPERTY when the position is out of range.
    CMPIData get(const char* name, CMPIrc whenAbsent) const;
    CMPIData getAt(CMPICount position, CMPIString** name) const; // name may be null

private:
    ArenaList<NamedValue> elements_;
    std::uint64_t marks_ = 0; // of all names: most that are set are new, and need no search
    mutable bool isShared_ = false;
};

} // namespace Host
