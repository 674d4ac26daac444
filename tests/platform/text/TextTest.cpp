// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/text/Escape.h"
#include "platform/text/Trim.h"
#include "platform/text/Utf8.h"

#include <gtest/gtest.h>

namespace TextTests {

using namespace std::string_literals;
using Text::Backslash;
using Text::cutAtCharacter;
using Text::firstCharacter;
using Text::toOneLine;
using Text::toValidUtf8;
using Text::trimmed;

const std::string unknown = "\xEF\xBF\xBD";

std::string escapedForTheLog(std::string_view text)
{
    std::string line;
    Text::appendEscaped(line, text, Backslash::doubled);
    return line;
}

TEST(Utf8Test, EncodesWhatItDecodesAtTheBoundsOfEachLength)
{
    for (const char32_t code : {U'\0', U'\u007F', U'\u0080', U'\u07FF', U'\u0800', U'\uD7FF',
             U'\uE000', U'\uFFFF', U'\U00010000', U'\U0010FFFF'}) {
        std::string text;
        Text::appendUtf8(text, code);
        const Text::Character character = firstCharacter(text + "\xFF");
        EXPECT_TRUE(character.isValid);
        EXPECT_EQ(character.code, code);
        EXPECT_EQ(character.size, text.size());
    }
}

TEST(Utf8Test, EncodesNumbersThatAreNoCodePointsAsTheReplacementCharacter)
{
    for (const char32_t code : {char32_t{0xD800}, char32_t{0xDFFF}, char32_t{0x110000}}) {
        std::string text;
        Text::appendUtf8(text, code);
        EXPECT_EQ(text, unknown);
    }
}

TEST(Utf8Test, DecodesAnInvalidByteAlone)
{
    const Text::Character character = firstCharacter("\xE6\xB8!");
    EXPECT_FALSE(character.isValid);
    EXPECT_EQ(character.code, Text::replacementCharacter);
    EXPECT_EQ(character.size, 1U);
}

TEST(Utf8Test, RepairKeepsCharactersOfEveryLength)
{
    const std::string text = "CPU \u00B0C \u6E29\u5EA6 \U0001F321 \xF4\x8F\xBF\xBF";
    EXPECT_EQ(toValidUtf8(text), text);
    EXPECT_EQ(toValidUtf8(""), "");
    EXPECT_EQ(toValidUtf8("a\0b"s), "a\0b"s);
}

TEST(Utf8Test, RepairReplacesEachByteThatBelongsToNoCharacter)
{
    EXPECT_EQ(toValidUtf8("Temp \xB0"
                          "C"),
        "Temp " + unknown + "C");
    EXPECT_EQ(toValidUtf8("\x80"), unknown);
    EXPECT_EQ(toValidUtf8("a\xE6\xB8"), "a" + unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xFF\xFE"), unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xC3\xC3\xBC"), unknown + "\xC3\xBC");
}

TEST(Utf8Test, RepairReplacesOverlongFormsSurrogatesAndWhatLiesAboveTheLastCharacter)
{
    EXPECT_EQ(toValidUtf8("\xC0\xAF"), unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xE0\x80\xAF"), unknown + unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xF0\x80\x80\x80"), unknown + unknown + unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xED\xA0\x80"), unknown + unknown + unknown);
    EXPECT_EQ(toValidUtf8("\xF4\x90\x80\x80"), unknown + unknown + unknown + unknown);
}

TEST(Utf8Test, CutsBetweenCharacters)
{
    EXPECT_EQ(cutAtCharacter("a\u00B0\U0001F321", 7), "a\u00B0\U0001F321");
    EXPECT_EQ(cutAtCharacter("a\u00B0\U0001F321", 6), "a\u00B0");
    EXPECT_EQ(cutAtCharacter("a\u00B0\U0001F321", 2), "a");
    EXPECT_EQ(cutAtCharacter("\u00B0", 1), "");
}

TEST(TrimTest, RemovesBlanksAtBothEnds)
{
    EXPECT_EQ(trimmed(" \t CPU Temp \r\n"), "CPU Temp");
    EXPECT_EQ(trimmed(" \t "), "");
    EXPECT_EQ(trimmed(""), "");
}

TEST(TrimTest, RemovesOnlyTheCharactersNamed)
{
    EXPECT_EQ(trimmed("//root/cimv2/", "/"), "root/cimv2");
}

TEST(EscapeTest, LeavesPlainTextAlone)
{
    const std::string text = "ENTERING: f() in F [Line: 1],Parameters List:  broker=0x7f~!\"#$%&'";
    EXPECT_EQ(escapedForTheLog(text), text);
    EXPECT_EQ(toOneLine(text), text);
}

TEST(EscapeTest, WritesANewlineAsTwoCharacters)
{
    EXPECT_EQ(toOneLine("a\nb\n"), "a\\nb\\n");
}

TEST(EscapeTest, WritesOtherControlCharactersInHexadecimal)
{
    EXPECT_EQ(toOneLine("\r\t\x1B[31m\x7F"), "\\x0D\\x09\\x1B[31m\\x7F");
    EXPECT_EQ(toOneLine("\0x"s), "\\x00x");
}

TEST(EscapeTest, EscapesEveryControlCharacter)
{
    for (char code = 0; code < 0x20; ++code) {
        const std::string line = toOneLine(std::string(1, code));
        EXPECT_EQ(line.front(), '\\') << int{code};
        EXPECT_EQ(line.find_first_of("\n\r\x1B"), std::string::npos) << int{code};
    }
}

TEST(EscapeTest, DoublesABackslashWhereItCouldBeAnEscape)
{
    EXPECT_EQ(escapedForTheLog("\\n"), "\\\\n");
    EXPECT_NE(escapedForTheLog("\\n"), escapedForTheLog("\n"));
    EXPECT_EQ(toOneLine("\\n"), "\\n");
}

TEST(EscapeTest, KeepsUtf8)
{
    EXPECT_EQ(toOneLine("Lüfter ファン 1"), "Lüfter ファン 1");
    EXPECT_EQ(toOneLine("L\xFC"
                        "fter\n"),
        "L\xEF\xBF\xBD"
        "fter\\n");
}

} // namespace TextTests
