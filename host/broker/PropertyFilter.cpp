// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/PropertyFilter.h"

#include "host/broker/Arena.h"
#include "host/broker/Names.h"
#include "host/broker/String.h"

#include <algorithm>
#include <cstring>
#include <utility>

namespace Host {

namespace {

// Copies a null-terminated list of texts; a null pointer is an empty list.
std::span<const String*> copied(Arena& arena, const char** names)
{
    std::size_t count = 0;
    while (names != nullptr && names[count] != nullptr)
        ++count;
    auto* const copy = arena.makeArray<const String*>(count);
    std::transform(
        names, names + count, copy, [&arena](const char* name) { return &arena.name(name); });
    return {copy, count};
}

bool isCopy(std::span<const String*> copy, const char** names) noexcept
{
    if (names == nullptr)
        return copy.empty();
    for (const String* const name : copy) {
        if (*names == nullptr || std::strcmp(*names, name->characters()) != 0)
            return false;
        ++names;
    }
    return *names == nullptr;
}

} // namespace

PropertyFilter::PropertyFilter(Arena& arena, const char** properties, const char** keys)
    : hasProperties_(properties != nullptr), properties_(copied(arena, properties)),
      keys_(copied(arena, keys))
{
    const std::size_t count = properties_.size() + keys_.size();
    names_ = {arena.makeArray<const String*>(count), count};
    std::copy(keys_.begin(), keys_.end(),
        std::copy(properties_.begin(), properties_.end(), names_.begin()));
}

PropertyFilter& PropertyFilter::of(Arena& arena, const char** properties, const char** keys)
{
    PropertyFilter*& last = arena.lastFilter();
    if (last == nullptr || !last->isOf(properties, keys))
        last = &arena.make<PropertyFilter>(arena, properties, keys);
    last->next_ = 0;
    return *last;
}

bool PropertyFilter::isOf(const char** properties, const char** keys) const noexcept
{
    return hasProperties_ == (properties != nullptr) && isCopy(properties_, properties) &&
           isCopy(keys_, keys);
}

bool PropertyFilter::lists(std::string_view name) noexcept
{
    const auto isName = [name](const String* listed) { return equalNames(*listed->text(), name); };
    const auto next = names_.begin() + static_cast<std::ptrdiff_t>(next_);
    if (const auto found = std::find_if(next, names_.end(), isName); found != names_.end()) {
        std::swap(*found, *next);
        ++next_;
        return true;
    }
    return std::any_of(names_.begin(), next, isName);
}

} // namespace Host
