// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/NaturalOrder.h"

#include <gtest/gtest.h>

namespace {

bool isBefore(std::string_view first, std::string_view second)
{
    return Tools::compareNaturally(first, second) < 0;
}

TEST(NaturalOrderTest, NumbersAreComparedByValue)
{
    EXPECT_TRUE(isBefore("temp2", "temp10"));
    EXPECT_FALSE(isBefore("temp10", "temp2"));
    EXPECT_TRUE(isBefore("3.3 V", "12 V"));
    EXPECT_TRUE(isBefore("3.3 V", "3.3 V Standby"));
    EXPECT_TRUE(isBefore("a99999999999999999998", "a99999999999999999999"));
}

TEST(NaturalOrderTest, LettersAreComparedWithoutRegardToCase)
{
    EXPECT_TRUE(isBefore("alpha", "Beta"));
    EXPECT_TRUE(isBefore("Alpha", "beta"));
    EXPECT_FALSE(isBefore("TEMP1", "temp1"));
    EXPECT_FALSE(isBefore("temp1", "TEMP1"));
    EXPECT_FALSE(isBefore("Lüfter", "LÜFTER"));
    EXPECT_FALSE(isBefore("LÜFTER", "Lüfter"));
    EXPECT_TRUE(isBefore("lÜfter 2", "LüFTER 10"));
}

TEST(NaturalOrderTest, LeadingZerosDoNotCount)
{
    EXPECT_FALSE(isBefore("a01", "a1"));
    EXPECT_FALSE(isBefore("a1", "a01"));
    EXPECT_TRUE(isBefore("a00", "a1"));
}

TEST(NaturalOrderTest, NothingIsBeforeItself)
{
    for (const char* const text : {"", "a", "1", "a1b2"})
        EXPECT_FALSE(isBefore(text, text));
    EXPECT_TRUE(isBefore("", "a"));
    EXPECT_FALSE(isBefore("a", ""));
}

} // namespace
