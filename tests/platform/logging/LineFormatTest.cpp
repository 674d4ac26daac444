// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LineFormat.h"

#include <gtest/gtest.h>

namespace LineFormatTests {

using RynLog::formatLine;

TEST(LineFormatTest, NamesChannelLevelComponentAndPlace)
{
    EXPECT_EQ(formatLine("log", 6000, {"setVector", "Sensor", 740}, "Nimbrel.Sensor", "some text"),
        "log 6000 Nimbrel.Sensor setVector(Sensor:740) some text");
}

TEST(LineFormatTest, PrintsNullTexts)
{
    EXPECT_EQ(formatLine("trace", 3000, {nullptr, nullptr, 0}, "c", ""),
        "trace 3000 c (null)((null):0) ");
}

TEST(LineFormatTest, EscapesEveryTextOfALine)
{
    EXPECT_EQ(formatLine("log", 1, {"f\n", "F\r", 2}, "c\t", "t\\\n"),
        "log 1 c\\x09 f\\n(F\\x0D:2) t\\\\\\n");
}

} // namespace LineFormatTests
