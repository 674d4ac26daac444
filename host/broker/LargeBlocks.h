// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <memory_resource>

namespace Host {

// Memory of the default resource, blocks of megabytes in huge pages where the system grants them:
// in an answer of ten thousand instances the page faults would take as much time as writing the
// pages.
class LargeBlocks final : public std::pmr::memory_resource {
    void* do_allocate(std::size_t size, std::size_t alignment) override;
    void do_deallocate(void* block, std::size_t size, std::size_t alignment) override;
    bool do_is_equal(const memory_resource& other) const noexcept override;

    std::pmr::memory_resource* upstream_ = std::pmr::get_default_resource();
};

} // namespace Host
