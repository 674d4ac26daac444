// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Utf8.h"

#include <gtest/gtest.h>

namespace Utf8Tests {

using namespace std::string_literals;
using Vorn::escapeControls;
using Vorn::toValidUtf8;
using Vorn::trimBlanks;

const std::string unknown = "\xEF\xBF\xBD";

TEST(ValidUtf8, keepsCharactersOfEveryLength)
{
    const std::string text = "CPU \u00B0C \u6E29\u5EA6 \U0001F321 \xF4\x8F\xBF\xBF";
    EXPECT_EQ(toValidUtf8(text), text);
    EXPECT_EQ(toValidUtf8(""), "");
}

TEST(ValidUtf8, replacesBytesThatBelongToNoCharacter)
{
    EXPECT_EQ(toValidUtf8("Temp \xB0"
                          "C"),
        "Temp " + unknown + "C");
    EXPECT_EQ(toValidUtf8("\x80"), unknown);
    EXPECT_EQ(toValidUtf8("a\xE6\xB8"), "a" + unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xFF\xFE"), unknown + unknown);
}

TEST(ValidUtf8, replacesOverlongFormsSurrogatesAndWhatLiesAboveTheLastCharacter)
{
    EXPECT_EQ(toValidUtf8("\xC0\xAF"), unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xE0\x80\xAF"), unknown + unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xED\xA0\x80"), unknown + unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xF4\x90\x80\x80"), unknown + unknown + unknown + unknown);
}

TEST(TrimBlanks, takesBlanksAtBothEndsOnly)
{
    EXPECT_EQ(trimBlanks(" \t CPU Temp \r\n"), "CPU Temp");
    EXPECT_EQ(trimBlanks(" \t "), "");
    EXPECT_EQ(trimBlanks(""), "");
}

TEST(EscapeControls, writesControlCharactersInHexadecimal)
{
    EXPECT_EQ(escapeControls("a\n\x7F\0z \u00B0"s), "a\\x0a\\x7f\\x00z \u00B0");
}

} // namespace Utf8Tests
