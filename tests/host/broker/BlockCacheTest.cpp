// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/BlockCache.h"

#include "tests/support/CountingMemory.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <thread>
#include <vector>

namespace HostTests {

namespace {

// Allocates blocks, writes to all of them and gives them back.
void use(Host::BlockCache& cache, std::size_t size, std::size_t count)
{
    std::vector<void*> blocks;
    for (std::size_t i = 0; i < count; ++i) {
        blocks.push_back(cache.allocate(size));
        std::memset(blocks.back(), 'x', size);
    }
    for (void* const block : blocks)
        cache.deallocate(block, size);
}

} // namespace

class BlockCacheTest : public testing::Test {
protected:
    Testing::CountingMemory memory_;
    Host::BlockCache cache_{1000};
};

TEST_F(BlockCacheTest, BlocksThatAreGivenBackServeTheNextRequests)
{
    use(cache_, 300, 2);
    EXPECT_EQ(memory_.taken(), 600U);
    void* const one = cache_.allocate(300);
    void* const other = cache_.allocate(300);
    EXPECT_EQ(memory_.taken(), 600U);
    EXPECT_NE(one, other);
    void* const larger = cache_.allocate(301);
    EXPECT_EQ(memory_.taken(), 901U);
    cache_.deallocate(larger, 301);
    cache_.deallocate(other, 300);
    cache_.deallocate(one, 300);
}

TEST_F(BlockCacheTest, TheOldestBlocksAreFreedBeyondTheBound)
{
    use(cache_, 300, 3);
    EXPECT_EQ(memory_.taken(), 900U);
    use(cache_, 500, 1);
    EXPECT_EQ(memory_.taken(), 800U);
    use(cache_, 1000, 1);
    EXPECT_EQ(memory_.taken(), 1000U);
    use(cache_, 1001, 1);
    EXPECT_EQ(memory_.taken(), 1000U);
}

TEST_F(BlockCacheTest, TheNumberOfKeptBlocksIsBounded)
{
    use(cache_, 1, 200);
    EXPECT_EQ(memory_.taken(), 64U);
}

TEST_F(BlockCacheTest, LargeBlocksBeginAtAHugePage)
{
    constexpr std::size_t hugePage = std::size_t{2} << 20;
    Host::BlockCache cache(4 * hugePage);
    use(cache, hugePage, 1);
    void* const block = cache.allocate(hugePage);
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block) % hugePage, 0U);
    EXPECT_EQ(memory_.taken(), hugePage);
    cache.deallocate(block, hugePage);
}

TEST_F(BlockCacheTest, ItFreesAllBlocksInTheEnd)
{
    {
        Host::BlockCache cache(1000);
        use(cache, 100, 5);
        EXPECT_EQ(memory_.taken(), 500U);
    }
    EXPECT_EQ(memory_.taken(), 0U);
}

TEST(BlockCacheThreadsTest, AnyThreadMayUseIt)
{
    Host::BlockCache cache(100'000);
    std::vector<std::jthread> threads;
    for (int thread = 0; thread < 4; ++thread)
        threads.emplace_back([&cache] {
            for (int round = 0; round < 50; ++round)
                use(cache, 10'000, 3);
        });
}

} // namespace HostTests
