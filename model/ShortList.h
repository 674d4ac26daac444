// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstddef>
#include <vector>

namespace Vorn::SensorProfileProvider {

// A list that keeps its first elements in itself: with a list on the heap in each of many
// thousand records, the allocator's work outgrows the harvest's. One that was moved from holds
// elements of no certain number, and can be used like any other.
template <typename Element, std::size_t Usual>
class ShortList {
public:
    void append(const Element& element)
    {
        if (held_ < Usual)
            first_[held_++] = element;
        else
            rest_.push_back(element);
    }

    void clear() noexcept
    {
        held_ = 0;
        rest_.clear();
    }

    // The elements in order, each converted to the list's type.
    template <typename Other>
    std::vector<Other> as() const
    {
        std::vector<Other> elements;
        elements.reserve(held_ + rest_.size());
        for (std::size_t i = 0; i < held_; ++i)
            elements.emplace_back(first_[i]);
        for (const Element& element : rest_)
            elements.emplace_back(element);
        return elements;
    }

private:
    std::array<Element, Usual> first_{};
    std::size_t held_ = 0;      // how many of the first ones
    std::vector<Element> rest_; // its length is told by itself: a move leaves it empty
};

} // namespace Vorn::SensorProfileProvider
