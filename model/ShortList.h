// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstddef>
#include <vector>

namespace Vorn::SensorProfileProvider {

// A list that keeps its first elements in itself: with a list on the heap in each of many
// thousand records, the allocator's work outgrows the harvest's.
template <typename Element, std::size_t Usual>
class ShortList {
public:
    void append(const Element& element)
    {
        if (size_ < Usual)
            first_[size_] = element;
        else
            rest_.push_back(element);
        ++size_;
    }

    void clear() noexcept
    {
        size_ = 0;
        rest_.clear();
    }

    // The elements in order, each converted to the list's type.
    template <typename Other>
    std::vector<Other> as() const
    {
        std::vector<Other> elements;
        elements.reserve(size_);
        for (std::size_t i = 0; i < size_; ++i)
            elements.emplace_back(i < Usual ? first_[i] : rest_[i - Usual]);
        return elements;
    }

private:
    std::array<Element, Usual> first_{};
    std::vector<Element> rest_;
    std::size_t size_ = 0;
};

} // namespace Vorn::SensorProfileProvider
