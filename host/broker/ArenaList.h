// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A list in an arena. It grows by chunks: an arena cannot free the memory that a growing array
// would leave behind.

#pragma once

#include "host/broker/Arena.h"

#include <array>
#include <cstddef>

namespace Host {

template <typename Element>
class ArenaList {
    static constexpr std::size_t chunkSize = 4;
    struct Chunk {
        std::array<Element, chunkSize> elements;
        Chunk* next = nullptr;
    };

public:
    class Iterator {
    public:
        const Element& operator*() const noexcept { return chunk_->elements[index_ % chunkSize]; }
        Iterator& operator++() noexcept
        {
            if (++index_ % chunkSize == 0)
                chunk_ = chunk_->next;
            return *this;
        }
        bool operator==(const Iterator& other) const noexcept { return index_ == other.index_; }

    private:
        friend class ArenaList;
        Iterator(const Chunk* chunk, std::size_t index) noexcept : chunk_(chunk), index_(index) {}
        const Chunk* chunk_;
        std::size_t index_;
    };

    std::size_t size() const noexcept { return size_; }
    Iterator begin() const noexcept { return {first_, 0}; }
    Iterator end() const noexcept { return {nullptr, size_}; }

    // Returns null when the position is out of range.
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
            auto& chunk = arena.make<Chunk>();
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
