// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"

#include <gtest/gtest.h>

namespace {

using namespace std::string_literals;
using Vorn::make_string;
using Vorn::make_wstring;

TEST(WideStringsTest, ConvertEveryLengthOfSequence)
{
    const std::string narrow = "a\xC3\xBC\xE3\x82\xBB\xF0\x9F\x8C\xA1";
    const std::wstring wide = L"a\u00FC\u30BB\U0001F321";
    EXPECT_EQ(make_wstring(narrow), wide);
    EXPECT_EQ(make_string(wide), narrow);
}

TEST(WideStringsTest, KeepTheFirstAndTheLastOfEachLength)
{
    const std::wstring bounds = L"\u007F\u0080\u07FF\u0800\uD7FF\uE000\uFFFF\U00010000\U0010FFFF"s;
    EXPECT_EQ(make_wstring(make_string(bounds)), bounds);
}

TEST(WideStringsTest, KeepZeroCharactersAndEmptyTexts)
{
    EXPECT_EQ(make_wstring("a\0b"s), L"a\0b"s);
    EXPECT_EQ(make_string(L"a\0b"s), "a\0b"s);
    EXPECT_EQ(make_wstring(""), L"");
    EXPECT_EQ(make_string(L""), "");
}

TEST(WideStringsTest, ReplaceBytesThatBelongToNoCharacter)
{
    EXPECT_EQ(make_wstring("a\xFF!\xE3\x82!"), L"a\uFFFD!\uFFFD\uFFFD!");
}

TEST(WideStringsTest, ReplaceWideCharactersThatAreNoCodePoints)
{
    const std::wstring invalid = {static_cast<wchar_t>(0xD800), static_cast<wchar_t>(0xDFFF),
        static_cast<wchar_t>(0x110000), static_cast<wchar_t>(-1)};
    EXPECT_EQ(make_string(invalid), "\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD");
}

} // namespace
