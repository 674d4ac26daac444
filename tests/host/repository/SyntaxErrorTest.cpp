// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Each place where a text can go wrong names what was expected there and what was found.

#include "tests/host/repository/MofTest.h"

namespace SyntaxErrorTests {

using Testing::errorOf;

struct SyntaxError {
    const char* text;
    const char* error; // after "test.mof:"
};

std::ostream& operator<<(std::ostream& out, const SyntaxError& each)
{
    return out << each.text;
}

class SyntaxErrorTest : public ::testing::TestWithParam<SyntaxError> {};

TEST_P(SyntaxErrorTest, namesPlaceExpectationAndWhatWasFound)
{
    EXPECT_EQ(errorOf(GetParam().text), "test.mof:" + std::string(GetParam().error));
}

const SyntaxError Files[] = {
    {"nothing", "1:1: expected #pragma, a qualifier declaration or a class, found \"nothing\""},
    {"\n\n  ;", "3:3: expected #pragma, a qualifier declaration or a class, found \";\""},
    {"class A {}; }", "1:13: expected #pragma, a qualifier declaration or a class, found \"}\""},
    {"/* for ever", "1:3: expected */ at the end of the comment, found the end of the file"},
    {"\x01", "1:1: expected #pragma, a qualifier declaration or a class, found \"\\x01\""},
    {"instance of A { };", "1:1: expected a class or qualifier declaration (instances are not "
                           "accepted), found \"instance\""},
    {"[Description(\"d\")]\nInstance of A { };",
        "2:1: expected a class or qualifier declaration (instances are not accepted), found "
        "\"Instance\""},
    {"#pragma", "1:8: expected the name of the pragma, found the end of the file"},
    {"#pragma include \"x\"", "1:17: expected (, found \"\"\""},
    {"#pragma include (x)", "1:18: expected a string, found \"x\""},
    {"#pragma locale (\"x\";", "1:20: expected ), found \";\""},
};

const SyntaxError Classes[] = {
    {"class", "1:6: expected the name of the class, found the end of the file"},
    {"class 1A {};", "1:7: expected the name of the class, found \"1A\""},
    {"class A as B {};", "1:12: expected an alias such as $Name, found \"B\""},
    {"class A : {};", "1:11: expected the name of the superclass, found \"{\""},
    {"class A", "1:8: expected {, found the end of the file"},
    {"class A {",
        "1:10: expected a property, a reference, a method or }, found the end of the file"},
    {"class A { ; };", "1:11: expected a property, a reference, a method or }, found \";\""},
    {"class A { uint17 P; };",
        "1:11: expected a property, a reference, a method or }, found \"uint17\""},
    {"class A { [Key] uint17 P; };",
        "1:17: expected a data type, or the name of a class followed by ref, found \"uint17\""},
    {"class A { [Key] };",
        "1:17: expected a data type, or the name of a class followed by ref, found \"}\""},
    {"class A { uint8 ; };",
        "1:17: expected the name of the property, reference or method, found \";\""},
    {"class A { B ref }; ",
        "1:17: expected the name of the property, reference or method, found \"}\""},
    {"class A { uint8 P }; ", "1:19: expected ; after the declaration, found \"}\""},
    {"class A { uint8 P Q; }; ", "1:19: expected ; after the declaration, found \"Q\""},
    {"class A { uint8 F() = 1; }; ", "1:21: expected ; after the declaration, found \"=\""},
    {"class A { uint8 P }", "1:19: expected ; after the declaration, found \"}\""},
    {"class A { } class B { };", "1:13: expected ;, found \"class\""},
    {"class A { uint8 P[x]; };", "1:19: expected the array's size or ], found \"x\""},
    {"class A { uint8 P[2; };", "1:20: expected the array's size or ], found \";\""},
    {"class A { uint8 P[0]; };", "1:19: an array's size is at least 1 and fits into 32 bits"},
    {"class A { uint8 P[4294967296]; };",
        "1:19: an array's size is at least 1 and fits into 32 bits"},
    {"class A { uint8 F(; };",
        "1:19: expected a data type, or the name of a class followed by ref, found \";\""},
    {"class A { uint8 F(uint8); };", "1:24: expected the name of the parameter, found \")\""},
    {"class A { uint8 F(uint8 a b); };", "1:27: expected , or ) after the parameter, found \"b\""},
    {"class A { uint8 F(uint8 a,); };",
        "1:27: expected a data type, or the name of a class followed by ref, found \")\""},
};

const SyntaxError Qualifiers[] = {
    {"[] class A {};", "1:2: expected the name of a qualifier, found \"]\""},
    {"[Abstract,] class A {};", "1:11: expected the name of a qualifier, found \"]\""},
    {"[Abstract class A {};", "1:11: expected , or ] after the qualifier, found \"class\""},
    {"[Abstract] A {};", "1:12: expected class after the qualifiers, found \"A\""},
    {"[Version()] class A {};",
        "1:10: expected a string, character, number, true, false or null, found \")\""},
    {"[Version({\"1\"})] class A {};",
        "1:10: expected a string, character, number, true, false or null, found \"{\""},
    {"[Version(\"1\"] class A {};", "1:13: expected ), found \"]\""},
    {"[Version(\"1\") : Fast] class A {};",
        "1:17: expected EnableOverride, DisableOverride, ToSubclass, Restricted or Translatable, "
        "found \"Fast\""},
    {"Qualifier : string", "1:11: expected the name of the qualifier, found \":\""},
    {"Qualifier Q, Scope(any);", "1:12: expected : and the qualifier's type, found \",\""},
    {"Qualifier Q : text, Scope(any);", "1:15: expected a data type, found \"text\""},
    {"Qualifier Q : string;", "1:21: expected , and the qualifier's scope, found \";\""},
    {"Qualifier Q : string, Flavor(Restricted);", "1:23: expected Scope, found \"Flavor\""},
    {"Qualifier Q : string, Scope any;", "1:29: expected (, found \"any\""},
    {"Qualifier Q : string, Scope();",
        "1:29: expected schema, class, association, indication, qualifier, property, reference, "
        "method, parameter or any, found \")\""},
    {"Qualifier Q : string, Scope(any class);", "1:33: expected , or ), found \"class\""},
    {"Qualifier Q : string, Scope(any), Restricted;",
        "1:35: expected Flavor, found \"Restricted\""},
    {"Qualifier Q : string, Scope(any), Flavor(any);",
        "1:42: expected EnableOverride, DisableOverride, ToSubclass, Restricted or Translatable, "
        "found \"any\""},
    {"Qualifier Q : string, Scope(any), Flavor(Restricted;", "1:52: expected , or ), found \";\""},
    {"Qualifier Q : string, Scope(any)", "1:33: expected ;, found the end of the file"},
};

const SyntaxError Values[] = {
    {"class A { uint8 P = ; };", "1:21: expected a string, character, number, true, false, null "
                                 "or a list in braces, found \";\""},
    {"class A { uint8 P = maybe; };", "1:21: expected a string, character, number, true, false, "
                                      "null or a list in braces, found \"maybe\""},
    {"class A { uint8 P[] = {1; };", "1:25: expected , or } in the list, found \";\""},
    {"class A { uint8 P[] = {1,}; };",
        "1:26: expected a string, character, number, true, false or null, found \"}\""},
    {"class A { uint8 P[] = {{1}}; };",
        "1:24: expected a string, character, number, true, false or null, found \"{\""},
    {"class A { uint8 P = 08; };", "1:21: expected a number: decimal, octal from 0, hexadecimal "
                                   "from 0x, binary up to b, or real, found \"08\""},
    {"class A { uint8 P = 12x; };", "1:21: expected a number: decimal, octal from 0, hexadecimal "
                                    "from 0x, binary up to b, or real, found \"12x\""},
    {"class A { uint8 P = 0x; };", "1:21: expected a number: decimal, octal from 0, hexadecimal "
                                   "from 0x, binary up to b, or real, found \"0x\""},
    {"class A { real32 P = 1.; };", "1:22: expected a number: decimal, octal from 0, hexadecimal "
                                    "from 0x, binary up to b, or real, found \"1\""},
    {"class A { real32 P = 1.0.0; };", "1:22: expected a number: decimal, octal from 0, "
                                       "hexadecimal from 0x, binary up to b, or real, found \"1\""},
    {"class A { sint8 P = -; };", "1:21: expected a number: decimal, octal from 0, hexadecimal "
                                  "from 0x, binary up to b, or real, found \"-\""},
    {"class A { string P = \"open",
        "1:27: expected a character or the closing \" of the string, found the end of the file"},
    {"class A { string P = \"open\n\"; };",
        "1:27: expected a character or the closing \" of the string, found the end of the line"},
    {"class A { string P = \"a\xFF\"; };",
        "1:24: expected a character or the closing \" of the string, found \"\\xff\""},
    {"class A { string P = \"\\q\"; };",
        "1:24: expected one of b t n f r \" ' \\ or x with hexadecimal digits after the "
        "backslash, found \"q\""},
    {"class A { string P = \"\\xg\"; };",
        "1:24: expected one of b t n f r \" ' \\ or x with hexadecimal digits after the "
        "backslash, found \"xg\""},
    {"class A { char16 P = ''; };",
        "1:23: expected a character between the single quotes, found \"'\""},
    {"class A { char16 P = 'ab'; };", "1:24: expected the closing ' of the character, found \"b\""},
};

INSTANTIATE_TEST_SUITE_P(Files, SyntaxErrorTest, ::testing::ValuesIn(Files));
INSTANTIATE_TEST_SUITE_P(Classes, SyntaxErrorTest, ::testing::ValuesIn(Classes));
INSTANTIATE_TEST_SUITE_P(Qualifiers, SyntaxErrorTest, ::testing::ValuesIn(Qualifiers));
INSTANTIATE_TEST_SUITE_P(Values, SyntaxErrorTest, ::testing::ValuesIn(Values));

} // namespace SyntaxErrorTests
