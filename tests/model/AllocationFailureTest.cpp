// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An allocation failure while the capabilities record is appended.

#include "model/SensorHarvest.h"
#include "tests/model/FailingAllocation.h"
#include "tests/support/LogCapture.h"

#include <gtest/gtest.h>

namespace {

using namespace Vorn::SensorProfileProvider;

// Returns a full vector, whose next allocation has a size that no other allocation has.
std::vector<SensorEnabledLogCap> fullVector()
{
    std::vector<SensorEnabledLogCap> capabilities(37);
    capabilities.shrink_to_fit();
    return capabilities;
}

TEST(CapabilitiesHarvestTest, ReportsTheFailuresOwnTextWhenTheRecordCannotBeAppended)
{
    auto capabilities = fullVector();
    const Testing::LogCapture capture;
    ::testing::internal::CaptureStderr();
    bool failed = false;
    {
        const Testing::FailingAllocation failing(
            2 * capabilities.size() * sizeof(SensorEnabledLogCap));
        failed = getSensorEnabledLogCapInstances(capabilities);
    }
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "std::bad_alloc\n");
    EXPECT_TRUE(failed);
    EXPECT_EQ(capabilities.size(), 37U);
    const auto lines = capture.log();
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_EQ(lines[0].line, 639U);
    EXPECT_EQ(lines[1].line, 654U);
}

} // namespace
