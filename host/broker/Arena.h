// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The memory of a request's CMPI objects, which is freed as a whole.

#pragma once

#include "host/broker/LargeBlocks.h"

#include <cstddef>
#include <memory>
#include <memory_resource>
#include <string_view>
#include <type_traits>
#include <unordered_map>
#include <utility>

namespace Host {

class PropertyFilter;
class String;

// Used by one thread at a time and without locks.
class Arena {
public:
    Arena() = default;
    Arena(const Arena&) = delete;
    Arena& operator=(const Arena&) = delete;

    // Constructs an object that lives as long as the arena. Destructors are never run.
    template <typename T, typename... Arguments>
    T& make(Arguments&&... arguments)
    {
        static_assert(std::is_trivially_destructible_v<T>);
        return *::new (memory_.allocate(sizeof(T), alignof(T)))
            T(std::forward<Arguments>(arguments)...);
    }

    // Returns as many value-initialised elements; null when count is 0.
    template <typename T>
    T* makeArray(std::size_t count)
    {
        static_assert(std::is_trivially_destructible_v<T>);
        if (count == 0)
            return nullptr;
        T* const elements = static_cast<T*>(memory_.allocate(count * sizeof(T), alignof(T)));
        std::uninitialized_value_construct_n(elements, count);
        return elements;
    }

    // Returns a zero-terminated copy.
    std::string_view text(std::string_view characters);

    // Returns one string object for each distinct text: for what repeats in every object of a
    // request, such as the names of properties, classes and namespaces.
    const String& name(std::string_view characters);

    // The filter that was set on an instance last; null before that.
    PropertyFilter*& lastFilter() noexcept { return lastFilter_; }

    // Returns the arena of this thread's current request; null when there is none.
    static Arena* current() noexcept { return current_; }
    // Returns the arena of this thread's current request. Throws Refusal (CMPI_RC_ERR_FAILED) when
    // there is none.
    static Arena& required()
    {
        if (current_ == nullptr)
            refuse();
        return *current_;
    }
    // Makes an arena (or none) the current one of this thread and returns the previous one.
    static Arena* makeCurrent(Arena* arena) noexcept;

private:
    static constexpr std::size_t firstBlock = std::size_t{16} << 10;

    struct Name {
        const String* string = nullptr;
        Name* next = nullptr; // the name that name() returned after this one the last time
    };

    Name& findName(std::string_view characters);
    [[noreturn]] static void refuse();

    static inline constinit thread_local Arena* current_ = nullptr;

    LargeBlocks blocks_;
    std::pmr::monotonic_buffer_resource memory_{firstBlock, &blocks_};
    std::pmr::unordered_map<std::string_view, Name> names_{&memory_};
    Name* lastName_ = nullptr;
    PropertyFilter* lastFilter_ = nullptr;
};

} // namespace Host
