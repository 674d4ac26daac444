// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Running out of memory while the capabilities record is appended. The global allocation
// functions are replaced for this executable alone.

#include "model/SensorHarvest.h"
#include "tests/support/LogCapture.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <new>

namespace {

// Allocations of exactly this size fail; 0 for none.
thread_local std::size_t failingSize = 0;

} // namespace

void* operator new(std::size_t size)
{
    if (failingSize != 0 && size == failingSize)
        throw std::bad_alloc();
    if (void* const memory = std::malloc(size))
        return memory;
    throw std::bad_alloc();
}

void operator delete(void* memory) noexcept
{
    std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept
{
    std::free(memory);
}

namespace {

using namespace Vorn::SensorProfileProvider;

// A vector about to grow to a size that nothing else asks for.
std::vector<SensorEnabledLogCap> fullVector()
{
    std::vector<SensorEnabledLogCap> capabilities(37);
    capabilities.shrink_to_fit();
    return capabilities;
}

TEST(CapabilitiesHarvest, reportsTheFailuresOwnTextWhenTheRecordCannotBeAppended)
{
    auto capabilities = fullVector();
    const Testing::LogCapture capture;
    ::testing::internal::CaptureStderr();
    failingSize = 2 * capabilities.size() * sizeof(SensorEnabledLogCap);
    const bool failed = getSensorEnabledLogCapInstances(capabilities);
    failingSize = 0;
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "std::bad_alloc\n");
    EXPECT_TRUE(failed);
    EXPECT_EQ(capabilities.size(), 37U);
    const auto lines = capture.log();
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_EQ(lines[0].line, 639U);
    EXPECT_EQ(lines[1].line, 654U);
}

} // namespace
