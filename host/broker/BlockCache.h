// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <array>
#include <cstddef>
#include <memory_resource>
#include <mutex>

namespace Host {

// The blocks of memory that arenas consist of. The blocks that were given back last are kept, up to
// a bound: without them, the page faults of fresh memory take a third of the time of a request for
// a thousand sensors. Blocks of megabytes are in huge pages where the system grants them. Any
// thread may call it.
class BlockCache final : public std::pmr::memory_resource {
public:
    // Keeps at most as many bytes; the others are those of the default resource.
    explicit BlockCache(std::size_t maximumKept) noexcept : maximumKept_(maximumKept) {}
    ~BlockCache() override;
    BlockCache(const BlockCache&) = delete;
    BlockCache& operator=(const BlockCache&) = delete;

private:
    struct Block {
        void* address = nullptr;
        std::size_t size = 0;
        std::size_t alignment = 0;
    };

    void* do_allocate(std::size_t size, std::size_t alignment) override;
    void do_deallocate(void* address, std::size_t size, std::size_t alignment) override;
    bool do_is_equal(const memory_resource& other) const noexcept override;

    void* take(std::size_t size, std::size_t alignment);
    void keep(const Block& block);
    void freeOldest();

    const std::size_t maximumKept_;
    std::pmr::memory_resource* const upstream_ = std::pmr::get_default_resource();
    std::mutex mutex_;
    std::array<Block, 64> kept_; // the first count_ of them, the oldest first
    std::size_t count_ = 0;
    std::size_t bytes_ = 0;
};

} // namespace Host
