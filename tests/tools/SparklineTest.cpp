// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/Sparkline.h"

#include <gtest/gtest.h>

#include <utility>

namespace {

using namespace Tools;

using Readings = std::deque<std::optional<std::int64_t>>;

constexpr std::size_t wide = WatchedSensor::keptReadings; // a bar for each reading

std::string sparkline(Readings readings, std::size_t width = wide, bool isUtf8 = false)
{
    WatchedSensor watched;
    watched.readings = std::move(readings);
    return Tools::sparkline(watched, width, isUtf8);
}

TEST(SparklineTest, ReachesFromTheLeastToTheGreatestReading)
{
    EXPECT_EQ(sparkline({0, 1, 2, 3, 4, 5, 6, 7}, wide, true), "▁▂▃▄▅▆▇█");
    EXPECT_EQ(sparkline({0, 1, 2, 3, 4, 5, 6, 7}), "_.-~+*%#");
    EXPECT_EQ(sparkline({-5, 1000}), "_#");
    EXPECT_EQ(sparkline({}), "");
}

TEST(SparklineTest, IsFlatWhereNothingChanges)
{
    EXPECT_EQ(sparkline({5, 5, 5}), "___");
    EXPECT_EQ(sparkline({12599, 12599, 12599, 12599, 12599}, wide / 3), "__");
}

TEST(SparklineTest, HasGapsWhereReadingsAreMissing)
{
    EXPECT_EQ(sparkline({1, std::nullopt, 3}), "_ #");
    EXPECT_EQ(sparkline({std::nullopt}), " ");
    EXPECT_EQ(sparkline({1, std::nullopt, std::nullopt, std::nullopt, 3}, wide / 2), "_ #");
}

TEST(SparklineTest, BarsOfANarrowOneAreMeans)
{
    EXPECT_EQ(sparkline({0, 0, 0, 7, 7, 7, 21}, wide / 2), "_.-#");
    EXPECT_EQ(sparkline({0, 0, 0, 7, 7, 7, 28}, wide / 3), "_-#");
}

// A step from 0 to 1 moves to the left as a whole while readings are added, and all kept readings
// are within the width.
TEST(SparklineTest, BarsKeepTheirReadings)
{
    for (const std::size_t width : {8U, 24U, 32U, 60U, 119U}) {
        const std::size_t readingsPerBar = (wide + width - 1) / width;
        WatchedSensor watched;
        watched.readings.assign(wide, 0);
        for (std::size_t added = 0; added < wide; ++added) {
            watched.readings.push_back(1);
            watched.readings.pop_front();
            ++watched.droppedReadings;
            const std::string seen = Tools::sparkline(watched, width, false);
            ASSERT_LE(seen.size(), width);
            ASSERT_GE(seen.size() * readingsPerBar, wide - readingsPerBar);
            ASSERT_EQ(seen.find_first_not_of("_#"), std::string::npos) << seen;
        }
    }
}

} // namespace
