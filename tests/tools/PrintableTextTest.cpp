// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/PrintableText.h"

#include <gtest/gtest.h>

namespace {

using namespace Tools;

constexpr const char* replacement = "\xEF\xBF\xBD";

TEST(PrintableTest, LeavesTextAlone)
{
    for (const char* const text : {"", "CPU 1 Temp", "Größe", "温度", "\xF0\x9F\x94\xA5", "\\x1B"})
        EXPECT_EQ(printable(text), text);
}

TEST(PrintableTest, EscapesControlCharacters)
{
    EXPECT_EQ(printable("a\nb\tc\rd"), "a\\nb\\tc\\rd");
    EXPECT_EQ(printable(std::string_view("\0\x1F\x7F", 3)), "\\x00\\x1F\\x7F");
    EXPECT_EQ(printable("\xC2\x80\xC2\x9F\xC2\xA0"), "\\u0080\\u009F\xC2\xA0");
}

TEST(PrintableTest, EscapesWhatReordersOrEndsLines)
{
    EXPECT_EQ(printable("\xE2\x80\xA8\xE2\x80\xA9"), "\\u2028\\u2029");
    EXPECT_EQ(printable("\xE2\x80\xAE\xE2\x81\xA6\xD8\x9C"), "\\u202E\\u2066\\u061C");
}

TEST(PrintableTest, ReplacesBytesThatAreNoCharacters)
{
    const std::string one = replacement;
    EXPECT_EQ(printable("\xFF"
                        "a"),
        one + "a");
    EXPECT_EQ(printable("\x80"), one);
    EXPECT_EQ(printable("\xC3"), one); // cut short
    EXPECT_EQ(printable("\xE2\x82"
                        "a"),
        one + one + "a");                                            // cut short in between
    EXPECT_EQ(printable("\xC0\x80"), one + one);                     // overlong
    EXPECT_EQ(printable("\xE0\x80\x9B"), one + one + one);           // overlong control
    EXPECT_EQ(printable("\xED\xA0\x80"), one + one + one);           // surrogate
    EXPECT_EQ(printable("\xF4\x90\x80\x80"), one + one + one + one); // beyond Unicode
}

TEST(DisplayWidthTest, CountsColumnsNotBytes)
{
    EXPECT_EQ(displayWidth(""), 0U);
    EXPECT_EQ(displayWidth("abc"), 3U);
    EXPECT_EQ(displayWidth("°C"), 2U);
    EXPECT_EQ(displayWidth("温度"), 4U);
    EXPECT_EQ(displayWidth("한글"), 4U);
    EXPECT_EQ(displayWidth("e\xCC\x81"), 1U);        // e and a combining accent
    EXPECT_EQ(displayWidth("\xF0\x9F\x94\xA5"), 2U); // an emoji
    EXPECT_EQ(displayWidth("ｱ"), 1U);                // half-width
    EXPECT_EQ(displayWidth("Ａ"), 2U);               // full-width
    EXPECT_EQ(displayWidth(replacement), 1U);
}

TEST(CutToWidthTest, LeavesTextThatFits)
{
    EXPECT_EQ(cutToWidth("abc", 3), "abc");
    EXPECT_EQ(cutToWidth("温度", 4), "温度");
}

TEST(CutToWidthTest, EndsInAnEllipsisAtACharacter)
{
    EXPECT_EQ(cutToWidth("abcd", 3), "ab…");
    EXPECT_EQ(cutToWidth("Größe!", 4), "Grö…");
    EXPECT_EQ(cutToWidth("温度計", 5), "温度…");
    EXPECT_EQ(cutToWidth("温度計", 4), "温…"); // half of a wide character does not fit
    EXPECT_EQ(cutToWidth("abc", 1), "…");
}

TEST(CutToWidthTest, KeepsAccentsWithTheirLetter)
{
    EXPECT_EQ(cutToWidth("abe\xCC\x81xyz", 4), "abe\xCC\x81…");
}

} // namespace
