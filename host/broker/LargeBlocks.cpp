// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/LargeBlocks.h"

#include <sys/mman.h>

namespace Host {

namespace {

constexpr std::size_t hugePage = std::size_t{2} << 20;

std::size_t alignmentFor(std::size_t size, std::size_t alignment) noexcept
{
    return size < hugePage || alignment > hugePage ? alignment : hugePage;
}

} // namespace

void* LargeBlocks::do_allocate(std::size_t size, std::size_t alignment)
{
    void* const block = upstream_->allocate(size, alignmentFor(size, alignment));
    if (size >= hugePage)
        madvise(block, size, MADV_HUGEPAGE); // without it, pages have the usual size
    return block;
}

void LargeBlocks::do_deallocate(void* block, std::size_t size, std::size_t alignment)
{
    upstream_->deallocate(block, size, alignmentFor(size, alignment));
}

bool LargeBlocks::do_is_equal(const memory_resource& other) const noexcept
{
    return this == &other;
}

} // namespace Host
