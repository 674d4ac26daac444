// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/check/Range.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace {

using Tools::readRange;

TEST(RangeTest, EndsBelongToTheRange)
{
    EXPECT_FALSE(readRange("10:20").raisesAlert(10));
    EXPECT_FALSE(readRange("10:20").raisesAlert(20));
    EXPECT_TRUE(readRange("10:20").raisesAlert(9.9));
    EXPECT_TRUE(readRange("10:20").raisesAlert(20.1));
}

TEST(RangeTest, OneNumberBeginsAtZero)
{
    EXPECT_FALSE(readRange("10").raisesAlert(0));
    EXPECT_TRUE(readRange("10").raisesAlert(-1));
    EXPECT_TRUE(readRange("10").raisesAlert(11));
}

TEST(RangeTest, EndsMayBeInfinite)
{
    EXPECT_FALSE(readRange("10:").raisesAlert(1e9));
    EXPECT_TRUE(readRange("10:").raisesAlert(9));
    EXPECT_FALSE(readRange("~:10").raisesAlert(-1e9));
    EXPECT_TRUE(readRange("~:10").raisesAlert(11));
    EXPECT_FALSE(readRange("~:").raisesAlert(0));
}

TEST(RangeTest, AtSignInverts)
{
    EXPECT_TRUE(readRange("@10:20").raisesAlert(10));
    EXPECT_FALSE(readRange("@10:20").raisesAlert(21));
    EXPECT_EQ(readRange("@10:20").text, "@10:20");
}

TEST(RangeTest, OtherTextsAreRefused)
{
    for (const char* const text :
        {"", "@", ":", ":5", "a", "1:b", "1:2:3", "5:4", "nan", "inf:", " 1"})
        EXPECT_THROW(readRange(text), std::invalid_argument) << text;
}

} // namespace
