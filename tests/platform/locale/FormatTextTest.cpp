// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/formatText.h"
#include "platform/locale/TextFormat.h"

#include <gtest/gtest.h>

namespace FormatTextTests {

using Vorn::formatText;
using Vorn::hasOneInsert;

constexpr std::size_t roomy = 512;

TEST(FormatText, PutsTheArgumentInThePlaceOfTheInsert)
{
    EXPECT_EQ(formatText(L"Sensor %s here", "Fan 1", roomy), L"Sensor Fan 1 here");
    EXPECT_EQ(formatText(L"%s", "", roomy), L"");
}

TEST(FormatText, TwoPercentSignsGiveOne)
{
    EXPECT_EQ(formatText(L"100%% of %s%%", "x", roomy), L"100% of x%");
    EXPECT_EQ(formatText(L"%%s %s", "x", roomy), L"%s x");
}

TEST(FormatText, TheArgumentIsNoFormat)
{
    EXPECT_EQ(formatText(L"Sensor %s", "%s%n%%", roomy), L"Sensor %s%n%%");
}

TEST(FormatText, TakesTheArgumentAsUtf8WhateverTheLocale)
{
    EXPECT_EQ(formatText(L"Sensor %s",
                  "L\xC3\xBC"
                  "fter \xE3\x82\xBB \xF0\x9F\x8C\xA1",
                  roomy),
        L"Sensor L\u00FCfter \u30BB \U0001F321");
}

TEST(FormatText, ReplacesWhatIsNotUtf8)
{
    EXPECT_EQ(formatText(L"Sensor %s",
                  "a\xFF"
                  "b",
                  roomy),
        L"Sensor a\uFFFDb");
}

TEST(FormatText, CutsAtACharacterBoundary)
{
    const std::string thermometers = "\xF0\x9F\x8C\xA1\xF0\x9F\x8C\xA1\xF0\x9F\x8C\xA1";
    EXPECT_EQ(formatText(L"%s", thermometers, 3), L"\U0001F321\U0001F321");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 11), L"Sensor Fan");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 10), L"Sensor Fa");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 4), L"Sen");
}

TEST(FormatText, OfALongNameFillsTheBufferButForItsEnd)
{
    const std::wstring text = formatText(L"Sensor %s", std::string(10000, 'x'), roomy);
    EXPECT_EQ(text, std::wstring(L"Sensor ").append(roomy - 1 - 7, L'x'));
}

TEST(FormatText, OfTheSmallestBufferIsEmpty)
{
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 1), L"");
    EXPECT_EQ(formatText(L"Sensor %s", "Fan", 0), L"");
}

TEST(TextFormat, NeedsExactlyOneInsert)
{
    for (const auto* good :
        {L"%s", L"Sensor %s", L"%s is a sensor", L"100%% %s", L"%%%s", L"%%s%s"})
        EXPECT_TRUE(hasOneInsert(good)) << testing::PrintToString(std::wstring(good));
    for (const auto* bad : {L"", L"Sensor", L"%s %s", L"%%", L"%%s", L"%%%%"})
        EXPECT_FALSE(hasOneInsert(bad)) << testing::PrintToString(std::wstring(bad));
}

TEST(TextFormat, AllowsNoOtherConversion)
{
    for (const auto* bad : {L"%n", L"%s%n", L"%d", L"%s %d", L"%5s", L"%-s", L"%1$s", L"%ls", L"%S",
             L"%*s", L"%.3s", L"%s %", L"%", L"%s%%%"})
        EXPECT_FALSE(hasOneInsert(bad)) << testing::PrintToString(std::wstring(bad));
}

} // namespace FormatTextTests
