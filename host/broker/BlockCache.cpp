// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/BlockCache.h"

#include <sys/mman.h>

#include <algorithm>

namespace Host {

namespace {

constexpr std::size_t hugePage = std::size_t{2} << 20;

std::size_t alignmentFor(std::size_t size, std::size_t alignment) noexcept
{
    return size < hugePage ? alignment : std::max(alignment, hugePage);
}

} // namespace

BlockCache::~BlockCache()
{
    while (count_ != 0)
        freeOldest();
}

void* BlockCache::do_allocate(std::size_t size, std::size_t alignment)
{
    alignment = alignmentFor(size, alignment);
    if (void* const kept = take(size, alignment))
        return kept;
    void* const block = upstream_->allocate(size, alignment);
    if (size >= hugePage)
        madvise(block, size, MADV_HUGEPAGE); // without it, pages have the usual size
    return block;
}

void BlockCache::do_deallocate(void* address, std::size_t size, std::size_t alignment)
{
    alignment = alignmentFor(size, alignment);
    if (size <= maximumKept_)
        keep({address, size, alignment});
    else
        upstream_->deallocate(address, size, alignment);
}

// Arenas grow by the same steps, so that blocks of the same sizes are asked for again.
void* BlockCache::take(std::size_t size, std::size_t alignment)
{
    const std::lock_guard lock(mutex_);
    auto* const end = kept_.begin() + count_;
    auto* const found = std::find_if(kept_.begin(), end,
        [&](const Block& block) { return block.size == size && block.alignment == alignment; });
    if (found == end)
        return nullptr;
    void* const taken = found->address;
    std::copy(found + 1, end, found);
    --count_;
    bytes_ -= size;
    return taken;
}

void BlockCache::keep(const Block& block)
{
    const std::lock_guard lock(mutex_);
    while (count_ == kept_.size() || bytes_ + block.size > maximumKept_)
        freeOldest();
    kept_[count_++] = block;
    bytes_ += block.size;
}

void BlockCache::freeOldest()
{
    const Block oldest = kept_.front();
    std::copy(kept_.begin() + 1, kept_.begin() + count_, kept_.begin());
    --count_;
    bytes_ -= oldest.size;
    upstream_->deallocate(oldest.address, oldest.size, oldest.alignment);
}

bool BlockCache::do_is_equal(const memory_resource& other) const noexcept
{
    return this == &other;
}

} // namespace Host
