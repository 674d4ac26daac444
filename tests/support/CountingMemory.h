// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <memory_resource>

namespace Testing {

// Counts the bytes that are allocated and not freed. It is the default memory resource during its
// lifetime.
class CountingMemory : public std::pmr::memory_resource {
public:
    CountingMemory() : before_(std::pmr::set_default_resource(this)) {}
    ~CountingMemory() override { std::pmr::set_default_resource(before_); }

    std::size_t taken() const { return taken_; }

private:
    void* do_allocate(std::size_t size, std::size_t alignment) override
    {
        taken_ += size;
        return before_->allocate(size, alignment);
    }
    void do_deallocate(void* block, std::size_t size, std::size_t alignment) override
    {
        taken_ -= size;
        before_->deallocate(block, size, alignment);
    }
    bool do_is_equal(const memory_resource& other) const noexcept override
    {
        return this == &other;
    }

    std::pmr::memory_resource* before_;
    std::size_t taken_ = 0;
};

} // namespace Testing
