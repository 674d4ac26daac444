// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The values that literals have, by the type they stand for.

#include "tests/host/repository/MofTest.h"

#include <limits>

namespace LiteralTests {

using Host::Scalar;
using Testing::constant;
using Testing::defaultOf;
using Testing::errorOf;

std::string textOf(const std::string& literal)
{
    const Host::Constant value = defaultOf("string P", literal);
    return std::get<std::string>(std::get<Scalar>(value));
}

TEST(LiteralTest, integersComeInFourBases)
{
    for (const char* const literal : {"10", "+10", "012", "0xA", "0Xa", "1010b", "001010B"})
        EXPECT_EQ(defaultOf("uint8 P", literal), constant(std::uint64_t{10})) << literal;
    for (const char* const literal : {"-10", "-012", "-0xA", "-1010b"})
        EXPECT_EQ(defaultOf("sint8 P", literal), constant(std::int64_t{-10})) << literal;
    EXPECT_EQ(defaultOf("uint8 P", "0"), constant(std::uint64_t{0}));
    EXPECT_EQ(defaultOf("uint8 P", "-0"), constant(std::uint64_t{0}));
    EXPECT_EQ(defaultOf("uint8 P", "0b"), constant(std::uint64_t{0}));
    EXPECT_EQ(defaultOf("uint16 P", "0x1b"), constant(std::uint64_t{27}));
}

TEST(LiteralTest, integersReachTheEndsOfTheirTypes)
{
    EXPECT_EQ(defaultOf("uint8 P", "255"), constant(std::uint64_t{255}));
    EXPECT_EQ(defaultOf("sint8 P", "-128"), constant(std::int64_t{-128}));
    EXPECT_EQ(defaultOf("uint64 P", "18446744073709551615"),
        constant(std::numeric_limits<std::uint64_t>::max()));
    EXPECT_EQ(defaultOf("sint64 P", "-9223372036854775808"),
        constant(std::numeric_limits<std::int64_t>::min()));
    EXPECT_EQ(defaultOf("sint64 P", "9223372036854775807"),
        constant(std::numeric_limits<std::int64_t>::max()));
}

TEST(LiteralTest, integersBeyondTheirTypesAreRefused)
{
    const auto refused = [](const std::string& type, const std::string& value) {
        return errorOf("class A { " + type + " P = " + value + "; };");
    };
    EXPECT_EQ(refused("uint8", "256"), "test.mof:1:21: the number does not fit into type uint8");
    EXPECT_EQ(refused("uint8", "-1"), "test.mof:1:21: the number does not fit into type uint8");
    EXPECT_EQ(refused("sint8", "128"), "test.mof:1:21: the number does not fit into type sint8");
    EXPECT_EQ(refused("sint8", "-129"), "test.mof:1:21: the number does not fit into type sint8");
    EXPECT_EQ(
        refused("uint16", "65536"), "test.mof:1:22: the number does not fit into type uint16");
    EXPECT_EQ(
        refused("sint32", "2147483648"), "test.mof:1:22: the number does not fit into type sint32");
    EXPECT_EQ(refused("sint64", "9223372036854775808"),
        "test.mof:1:22: the number does not fit into type sint64");
    EXPECT_EQ(refused("uint64", "18446744073709551616"),
        "test.mof:1:22: the number does not fit into 64 bits");
    EXPECT_EQ(refused("real64", "1.0e999"),
        "test.mof:1:22: the number is too large or too small for a real");
    EXPECT_EQ(
        refused("real32", "1.0e39"), "test.mof:1:22: the number does not fit into type real32");
}

TEST(LiteralTest, realsMayBeWrittenAsIntegers)
{
    EXPECT_EQ(defaultOf("real64 P", "1.5"), constant(1.5));
    EXPECT_EQ(defaultOf("real64 P", "+1.5E+2"), constant(150.0));
    EXPECT_EQ(defaultOf("real64 P", "-.5e-1"), constant(-0.05));
    EXPECT_EQ(defaultOf("real32 P", "0.25"), constant(0.25));
    EXPECT_EQ(defaultOf("real64 P", "-7"), constant(-7.0));
    EXPECT_EQ(defaultOf("real64 P", "0x10"), constant(16.0));
}

TEST(LiteralTest, booleansAndNulls)
{
    EXPECT_EQ(defaultOf("boolean P", "true"), constant(true));
    EXPECT_EQ(defaultOf("boolean P", "FALSE"), constant(false));
    for (const char* const type : {"boolean P", "uint8 P", "string P", "string P[]", "datetime P"})
        EXPECT_TRUE(Host::isNull(defaultOf(type, "null"))) << type;
}

TEST(LiteralTest, adjacentStringsAreOne)
{
    EXPECT_EQ(textOf(R"("")"), "");
    EXPECT_EQ(textOf(R"("one " /* and */ "two"
        // and
        "" " three")"),
        "one two three");
}

TEST(LiteralTest, escapesStandForCharacters)
{
    EXPECT_EQ(textOf(R"("\b\t\n\f\r\"\'\\")"), "\b\t\n\f\r\"'\\");
    EXPECT_EQ(textOf(R"("\x41\X42\x043z\x0044z")"), "ABCzDz");
    EXPECT_EQ(textOf(R"("\xe9\x20ac")"), "\u00e9\u20ac");
    EXPECT_EQ(textOf(R"("\x20ac1")"), "\u20ac1");
    EXPECT_EQ(textOf(R"("\xD83D\xDE00")"), "\U0001F600");
    EXPECT_EQ(textOf("\"\u00e9\u20ac\U0001F600\t'\""), "\u00e9\u20ac\U0001F600\t'");
}

TEST(LiteralTest, escapesThatStandForNoCharacterAreRefused)
{
    const auto refused = [](const std::string& text) {
        return errorOf("class A { string P = \"ab\" \"cd" + text + "\"; };");
    };
    for (const char* const text : {"\\xD83D", "\\xD83Dx", "\\xD83D\\x41", "\\xD83D\\n", "\\xDE00"})
        EXPECT_EQ(refused(text), "test.mof:1:30: half of a surrogate pair is no character") << text;
    EXPECT_EQ(refused("\\x0"), "test.mof:1:30: the character \\x0 cannot be kept");
    EXPECT_EQ(refused("\\x0000"), "test.mof:1:30: the character \\x0 cannot be kept");
}

TEST(LiteralTest, charactersAreSingleUtf16Units)
{
    EXPECT_EQ(defaultOf("char16 P", "'a'"), constant(std::uint64_t{'a'}));
    EXPECT_EQ(defaultOf("char16 P", "'\"'"), constant(std::uint64_t{'"'}));
    EXPECT_EQ(defaultOf("char16 P", "'\\''"), constant(std::uint64_t{'\''}));
    EXPECT_EQ(defaultOf("char16 P", "'\\n'"), constant(std::uint64_t{'\n'}));
    EXPECT_EQ(defaultOf("char16 P", "'\\x20AC'"), constant(std::uint64_t{0x20AC}));
    EXPECT_EQ(defaultOf("char16 P", "'\u00e9'"), constant(std::uint64_t{0xE9}));
    EXPECT_EQ(defaultOf("char16 P", "'\u20ac'"), constant(std::uint64_t{0x20AC}));
    EXPECT_EQ(errorOf("class A { char16 P = '\U0001F600'; };"),
        "test.mof:1:23: the character does not fit into 16 bits");
}

TEST(LiteralTest, dateTimesAreChecked)
{
    const std::string point = "20250131235959.000000+060";
    EXPECT_EQ(defaultOf("datetime P", "\"" + point + "\""), constant(point));
    EXPECT_EQ(errorOf("class A { datetime P = \"yesterday\"; };"),
        "test.mof:1:24: \"yesterday\" is no value of type datetime");
}

TEST(LiteralTest, listsHoldValuesAndNulls)
{
    EXPECT_EQ(defaultOf("sint8 P[]", "{-1, null, 0x7F}"),
        Host::Constant(std::vector<Scalar>{std::int64_t{-1}, std::monostate(), std::int64_t{127}}));
    EXPECT_EQ(defaultOf("string P[]", "{\"a\" \"b\", \"c\"}"),
        Host::Constant(std::vector<Scalar>{std::string("ab"), std::string("c")}));
    EXPECT_EQ(defaultOf("string P[]", "{}"), Host::Constant(std::vector<Scalar>()));
}

TEST(LiteralTest, valuesOfAnotherTypeAreRefusedWhereTheyStand)
{
    const auto refused = [](const std::string& property, const std::string& value) {
        return errorOf("class A {\n " + property + " =\n " + value + "; };");
    };
    EXPECT_EQ(refused("uint8 P", "\"1\""), "test.mof:3:2: a string is no value of type uint8");
    EXPECT_EQ(refused("boolean P", "1"), "test.mof:3:2: an integer is no value of type boolean");
    EXPECT_EQ(refused("string P", "1"), "test.mof:3:2: an integer is no value of type string");
    EXPECT_EQ(refused("uint8 P", "true"), "test.mof:3:2: a boolean is no value of type uint8");
    EXPECT_EQ(refused("uint8 P", "1.5"), "test.mof:3:2: a real is no value of type uint8");
    EXPECT_EQ(refused("string P", "'a'"), "test.mof:3:3: a character is no value of type string");
    EXPECT_EQ(
        refused("uint8 P[]", "{1, \"2\"}"), "test.mof:3:6: a string is no value of type uint8");
    EXPECT_EQ(refused("uint8 P[]", "1"), "test.mof:3:2: a single value is none of type uint8[]");
    EXPECT_EQ(refused("uint8 P", "{1}"), "test.mof:3:2: a list is no value of type uint8");
}

} // namespace LiteralTests
