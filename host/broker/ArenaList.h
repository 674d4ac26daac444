// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A list that grows in an arena: elements stay where they are and no memory is left behind
// by growing.

#pragma once

#include "host/broker/Arena.h"

#include <array>
#include <cstddef>
#include <iterator>

namespace Host {

template <typename Element>
class ArenaList {
    static constexpr std::size_t chunkSize = 4;
    struct Chunk {
        std::array<Element, chunkSize> elements;
        Chunk* next = nullptr;
    };

public:
    // Stays good when elements are appended, also at the end that it has reached: it keeps where
    // the list says which chunk it is in, and looks there when it is read. The list must stay
    // where it is.
    class Iterator {
    public:
        using iterator_category = std::forward_iterator_tag;
        using value_type = Element;
        using difference_type = std::ptrdiff_t;
        using pointer = const Element*;
        using reference = const Element&;

        Iterator() noexcept = default;
        reference operator*() const noexcept { return (*chunk_)->elements[index_ % chunkSize]; }
        pointer operator->() const noexcept { return &**this; }
        Iterator& operator++() noexcept
        {
            if (++index_ % chunkSize == 0)
                chunk_ = &(*chunk_)->next;
            return *this;
        }
        Iterator operator++(int) noexcept
        {
            const Iterator before = *this;
            ++*this;
            return before;
        }
        bool operator==(const Iterator& other) const noexcept { return index_ == other.index_; }

    private:
        friend class ArenaList;
        Iterator(Chunk* const* chunk, std::size_t index) noexcept : chunk_(chunk), index_(index) {}
        Chunk* const* chunk_ = nullptr;
        std::size_t index_ = 0;
    };

    std::size_t size() const noexcept { return size_; }
    Iterator begin() const noexcept { return {&first_, 0}; }
    Iterator end() const noexcept { return {nullptr, size_}; }

    // Null when the position is out of range.
    const Element* at(std::size_t position) const noexcept
    {
        if (position >= size_)
            return nullptr;
        const Chunk* chunk = first_;
        for (std::size_t skipped = chunkSize; skipped <= position; skipped += chunkSize)
            chunk = chunk->next;
        return &chunk->elements[position % chunkSize];
    }

    void append(Arena& arena, const Element& element)
    {
        if (size_ % chunkSize == 0) {
            Chunk& chunk = arena.make<Chunk>();
            (first_ == nullptr ? first_ : last_->next) = &chunk;
            last_ = &chunk;
        }
        last_->elements[size_ % chunkSize] = element;
        ++size_;
    }

private:
    Chunk* first_ = nullptr;
    Chunk* last_ = nullptr;
    std::size_t size_ = 0;
};

} // namespace Host
