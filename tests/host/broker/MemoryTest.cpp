// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The memory services of the broker.

#include "tests/host/broker/BrokerTest.h"

#include <cstdint>
#include <cstring>

namespace HostTests {

class MemoryTest : public BrokerTest {
protected:
    const CMPIBrokerMemFT& memory = *mb->mft;
};

TEST_F(MemoryTest, GivesBlocksAlignedForAnything)
{
    for (const std::size_t size : {0UL, 1UL, 3UL, 1000UL}) {
        void* const block = memory.cmpiMalloc(mb, size);
        ASSERT_NE(block, nullptr);
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block) % alignof(std::max_align_t), 0U);
        std::memset(block, 0xFF, size);
        memory.cmpiFree(mb, block);
    }
}

TEST_F(MemoryTest, GivesZeroedBlocks)
{
    const auto* const block = static_cast<char*>(memory.cmpiCalloc(mb, 3, 4));
    EXPECT_EQ(std::string(block, 12), std::string(12, '\0'));
}

TEST_F(MemoryTest, KeepsTheContentWhenItGrowsABlock)
{
    auto* const block = static_cast<char*>(memory.cmpiMalloc(mb, 4));
    std::memcpy(block, "abc", 4);
    auto* const grown = static_cast<char*>(memory.cmpiRealloc(mb, block, 4000));
    EXPECT_STREQ(grown, "abc");
    EXPECT_EQ(std::string(static_cast<char*>(memory.cmpiRealloc(mb, grown, 2)), 2), "ab");
    EXPECT_NE(memory.cmpiRealloc(mb, nullptr, 4), nullptr);
}

TEST_F(MemoryTest, CopiesTexts)
{
    EXPECT_STREQ(memory.cmpiStrDup(mb, "text"), "text");
    EXPECT_EQ(memory.cmpiStrDup(mb, nullptr), nullptr);
}

TEST_F(MemoryTest, SaysNoToImpossibleSizes)
{
    EXPECT_EQ(memory.cmpiMalloc(mb, SIZE_MAX), nullptr);
    EXPECT_EQ(memory.cmpiCalloc(mb, SIZE_MAX / 2, 3), nullptr);
}

TEST_F(MemoryTest, FreesClones)
{
    memory.freeString(mb, CMClone(string("text"), nullptr));
    memory.freeArray(mb, CMClone(array({1}), nullptr));
    memory.freeObjectPath(mb, CMClone(path(), nullptr));
    memory.freeInstance(mb, CMClone(instance(), nullptr));
    memory.freeArgs(mb, CMClone(CMNewArgs(mb, nullptr), nullptr));
    memory.freeDateTime(mb, CMClone(CMNewDateTime(mb, nullptr), nullptr));
}

TEST_F(MemoryTest, DoesNotOfferMarks)
{
    EXPECT_EQ(memory.mark(mb, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(memory.release(mb, nullptr).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

} // namespace HostTests
