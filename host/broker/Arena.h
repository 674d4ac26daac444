// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The memory CMPI objects live in. Each thread of a request has one arena, and so has each
// clone; everything in an arena goes when the arena goes.

#pragma once

#include "host/broker/LargeBlocks.h"

#include <cstddef>
#include <memory>
#include <memory_resource>
#include <string_view>
#include <type_traits>
#include <unordered_map>
#include <utility>
#include <vector>

namespace Host {

class String;

// Used by one thread at a time and without locks.
class Arena {
public:
    enum class Purpose { request, clone };

    explicit Arena(Purpose purpose = Purpose::request);
    Arena(const Arena&) = delete;
    Arena& operator=(const Arena&) = delete;

    // Builds an object that lives as long as the arena. Destructors are never run, so there
    // must be nothing for them to do.
    template <typename T, typename... Arguments>
    T& make(Arguments&&... arguments)
    {
        static_assert(std::is_trivially_destructible_v<T>);
        return *::new (memory_.allocate(sizeof(T), alignof(T)))
            T(std::forward<Arguments>(arguments)...);
    }

    // As many value-initialised elements; null when count is 0.
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

    // A zero-terminated copy.
    std::string_view text(std::string_view characters);

    // One string object for each distinct text: for what repeats in every object of a
    // request, such as the names of properties, classes and namespaces.
    const String& name(std::string_view characters);

    // Suitably aligned for any object.
    void* bytes(std::size_t size) { return memory_.allocate(size); }

    // Whether this is the home of a clone, which outlives the request it was made in.
    bool isCloneHome() const noexcept { return purpose_ == Purpose::clone; }

    // Keeps another thread's arena alive as long as this one.
    void adopt(std::shared_ptr<Arena> other) { adopted_.push_back(std::move(other)); }

    // The arena of the request this thread works for; null when there is none.
    static Arena* current() noexcept;
    // The same. Throws Refusal (CMPI_RC_ERR_FAILED) when there is none.
    static Arena& required();
    // Makes an arena (or none) the current one of this thread and returns the one before.
    static Arena* makeCurrent(Arena* arena) noexcept;

private:
    Purpose purpose_;
    LargeBlocks blocks_;
    std::pmr::monotonic_buffer_resource memory_;
    std::pmr::unordered_map<std::string_view, const String*> names_;
    std::vector<std::shared_ptr<Arena>> adopted_;
};

} // namespace Host
