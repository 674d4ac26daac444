// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LineFormat.h"

#include <gtest/gtest.h>

namespace LineFormatTests {

using namespace std::string_literals;
using RynLog::formatLine;

std::string escaped(std::string_view text)
{
    std::string line;
    RynLog::appendEscaped(line, text);
    return line;
}

TEST(LineFormat, NamesChannelLevelComponentAndPlace)
{
    EXPECT_EQ(formatLine("log", 6000, {"setVector", "Sensor", 740}, "Nimbrel.Sensor", "some text"),
        "log 6000 Nimbrel.Sensor setVector(Sensor:740) some text");
}

TEST(LineFormat, PrintsNullTexts)
{
    EXPECT_EQ(formatLine("trace", 3000, {nullptr, nullptr, 0}, "c", ""),
        "trace 3000 c (null)((null):0) ");
}

TEST(LineFormat, EscapesEveryTextOfALine)
{
    EXPECT_EQ(
        formatLine("log", 1, {"f\n", "F\r", 2}, "c\t", "t\n"), "log 1 c\\x09 f\\n(F\\x0D:2) t\\n");
}

TEST(Escaping, LeavesPlainTextAlone)
{
    const std::string text = "ENTERING: f() in F [Line: 1],Parameters List:  broker=0x7f~!\"#$%&'";
    EXPECT_EQ(escaped(text), text);
}

TEST(Escaping, WritesANewlineAsTwoCharacters)
{
    EXPECT_EQ(escaped("a\nb\n"), "a\\nb\\n");
}

TEST(Escaping, WritesOtherControlCharactersInHexadecimal)
{
    EXPECT_EQ(escaped("\r\t\x1B[31m\x7F"), "\\x0D\\x09\\x1B[31m\\x7F");
    EXPECT_EQ(escaped("\0x"s), "\\x00x");
}

TEST(Escaping, EveryControlCharacterIsEscaped)
{
    for (int code = 0; code < 0x20; ++code) {
        const std::string line = escaped(std::string(1, static_cast<char>(code)));
        EXPECT_EQ(line.front(), '\\') << code;
        EXPECT_EQ(line.find_first_of("\n\r\x1B"), std::string::npos) << code;
    }
}

TEST(Escaping, TellsABackslashFromAnEscape)
{
    EXPECT_EQ(escaped("\\n"), "\\\\n");
    EXPECT_NE(escaped("\\n"), escaped("\n"));
}

TEST(Escaping, KeepsUtf8)
{
    EXPECT_EQ(escaped("Lüfter ファン 1"), "Lüfter ファン 1");
}

} // namespace LineFormatTests
