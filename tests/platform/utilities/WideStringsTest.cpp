// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

using namespace std::string_literals;
using Vorn::make_string;
using Vorn::make_wstring;

TEST(WideStrings, ConvertEveryLengthOfSequence)
{
    const std::string narrow = "a\xC3\xBC\xE3\x82\xBB\xF0\x9F\x8C\xA1";
    const std::wstring wide = L"a\u00FC\u30BB\U0001F321";
    EXPECT_EQ(make_wstring(narrow), wide);
    EXPECT_EQ(make_string(wide), narrow);
}

TEST(WideStrings, KeepTheFirstAndTheLastOfEachLength)
{
    const std::wstring bounds = L"\u007F\u0080\u07FF\u0800\uD7FF\uE000\uFFFF\U00010000\U0010FFFF"s;
    EXPECT_EQ(make_wstring(make_string(bounds)), bounds);
}

TEST(WideStrings, KeepZeroCharactersAndEmptyTexts)
{
    EXPECT_EQ(make_wstring("a\0b"s), L"a\0b"s);
    EXPECT_EQ(make_string(L"a\0b"s), "a\0b"s);
    EXPECT_EQ(make_wstring(""), L"");
    EXPECT_EQ(make_string(L""), "");
}

TEST(WideStrings, ReplaceEachBrokenSequenceOnce)
{
    struct Case {
        std::string bytes;
        std::wstring text;
    };
    const std::vector<Case> cases = {
        {"a\xFF"
         "b",
            L"a\uFFFDb"},
        {"\x80\xBF", L"\uFFFD\uFFFD"},           // continuation bytes alone
        {"\xE3\x82", L"\uFFFD"},                 // cut off
        {"\xE3\x82!", L"\uFFFD!"},               // broken off
        {"\xC0\xAF", L"\uFFFD\uFFFD"},           // overlong
        {"\xE0\x80\x80", L"\uFFFD\uFFFD\uFFFD"}, // overlong
        {"\xF0\x80\x80\x80", L"\uFFFD\uFFFD\uFFFD\uFFFD"},
        {"\xED\xA0\x80", L"\uFFFD\uFFFD\uFFFD"},           // a surrogate
        {"\xF4\x90\x80\x80", L"\uFFFD\uFFFD\uFFFD\uFFFD"}, // above the last code
        {"\xC3\xC3\xBC", L"\uFFFD\u00FC"},                 // the next one is whole
    };
    for (const Case& broken : cases)
        EXPECT_EQ(make_wstring(broken.bytes), broken.text) << testing::PrintToString(broken.bytes);
}

TEST(WideStrings, ReplaceWideCharactersThatAreNoCodePoints)
{
    const std::wstring invalid = {static_cast<wchar_t>(0xD800), static_cast<wchar_t>(0xDFFF),
        static_cast<wchar_t>(0x110000), static_cast<wchar_t>(-1)};
    EXPECT_EQ(make_string(invalid), "\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD");
}

} // namespace
