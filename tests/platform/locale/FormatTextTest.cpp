// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/FormatText.h"

#include <gtest/gtest.h>

namespace FormatTextTests {

using Vorn::formatText;

constexpr std::size_t roomy = 512;

TEST(FormatTextTest, PutsTheArgumentInThePlaceOfTheInsert)
{
    EXPECT_EQ(formatText(L"Sensor %s here", "Fan 1", roomy), L"Sensor Fan 1 here");
    EXPECT_EQ(formatText(L"%s", "", roomy), L"");
}

TEST(FormatTextTest, TheArgumentIsNoFormat)
{
    EXPECT_EQ(formatText(L"Sensor %s", "%s%n%%", roomy), L"Sensor %s%n%%");
}

TEST(FormatTextTest, TakesTheArgumentAsUtf8WhateverTheLocale)
{
    EXPECT_EQ(formatText(L"Sensor %s",
                  "L\xC3\xBC"
                  "fter \xE3\x82\xBB \xF0\x9F\x8C\xA1",
                  roomy),
        L"Sensor L\u00FCfter \u30BB \U0001F321");
}

TEST(FormatTextTest, ReplacesWhatIsNotUtf8)
{
    EXPECT_EQ(formatText(L"Sensor %s",
                  "a\xFF"
                  "b",
                  roomy),
        L"Sensor a\uFFFDb");
}

TEST(FormatTextTest, CutsAtACharacterBoundary)
{
    const std::string thermometers = "\xF0\x9F\x8C\xA1\xF0\x9F\x8C\xA1\xF0\x9F\x8C\xA1";
    EXPECT_EQ(formatText(L"%s", thermometers, 3), L"\U0001F321\U0001F321");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 11), L"Sensor Fan");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 10), L"Sensor Fa");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 4), L"Sen");
}

TEST(FormatTextTest, OfALongNameFillsTheBufferButForItsEnd)
{
    const std::wstring text = formatText(L"Sensor %s", std::string(10000, 'x'), roomy);
    EXPECT_EQ(text, std::wstring(L"Sensor ").append(roomy - 1 - 7, L'x'));
}

TEST(FormatTextTest, OfTheSmallestBufferIsEmpty)
{
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 1), L"");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 0), L"");
}

} // namespace FormatTextTests
