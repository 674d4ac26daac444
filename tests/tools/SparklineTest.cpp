// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/Sparkline.h"

#include <gtest/gtest.h>

namespace {

using Tools::sparkline;

TEST(SparklineTest, ReachesFromTheLeastToTheGreatestReading)
{
    EXPECT_EQ(sparkline({0, 1, 2, 3, 4, 5, 6, 7}, 20, true), "▁▂▃▄▅▆▇█");
    EXPECT_EQ(sparkline({0, 1, 2, 3, 4, 5, 6, 7}, 20, false), "_.-~+*%#");
    EXPECT_EQ(sparkline({-5, 1000}, 20, false), "_#");
}

TEST(SparklineTest, ShowsTheLatestReadingsThatFit)
{
    EXPECT_EQ(sparkline({99, 0, 7}, 2, false), "_#");
    EXPECT_EQ(sparkline({1, 2}, 0, false), "");
}

TEST(SparklineTest, IsFlatWhereNothingChanges)
{
    EXPECT_EQ(sparkline({5, 5, 5}, 9, false), "___");
}

TEST(SparklineTest, HasGapsWhereReadingsAreMissing)
{
    EXPECT_EQ(sparkline({1, std::nullopt, 3}, 9, false), "_ #");
    EXPECT_EQ(sparkline({std::nullopt}, 9, false), " ");
    EXPECT_EQ(sparkline({}, 9, false), "");
}

} // namespace
