// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Errors in MOF files and their positions.

#include "tests/host/repository/MofTest.h"

#include <ostream>

namespace MofErrorTests {

struct MofError {
    const char* text;
    const char* error; // after "test.mof:"
};

std::ostream& operator<<(std::ostream& out, const MofError& each)
{
    return out << each.text;
}

class MofErrorTest : public ::testing::TestWithParam<MofError> {};

TEST_P(MofErrorTest, NamesPlaceAndReason)
{
    EXPECT_EQ(Testing::errorOf(GetParam().text), "test.mof:" + std::string(GetParam().error));
}

constexpr MofError syntax[] = {
    {"nothing", "1:1: expected #pragma, a qualifier declaration or a class"},
    {"\n\n  ;", "3:3: expected #pragma, a qualifier declaration or a class"},
    {"class A {}; /* comment */", "1:13: expected #pragma, a qualifier declaration or a class"},
    {"instance of A { };", "1:1: expected #pragma, a qualifier declaration or a class"},
    {"#pragma locale (\"en\")", "1:9: expected include or namespace"},
    {"#pragma include \"x\"", "1:17: expected ("},
    {"#pragma include (x)", "1:18: expected a string"},
    {"class", "1:6: expected the name of a class"},
    {"class A : {};", "1:11: expected the name of the superclass"},
    {"class A", "1:8: expected {"},
    {"class A {", "1:10: expected a property or }"},
    {"class A { [Key] };", "1:17: expected a property or }"},
    {"class A { uint8 ; };", "1:17: expected the name of the property"},
    {"class A { B ref }; ", "1:17: expected the name of the property"},
    {"class A { B ref C[]; }; ", "1:18: expected ; after the property"},
    {"class A { uint8 F(); }; ", "1:18: expected ; after the property"},
    {"class A { uint8 P[2]; };", "1:19: expected ]"},
    {"class A { } class B { };", "1:13: expected ;"},
    {"[] class A {};", "1:2: expected the name of a qualifier"},
    {"[Abstract class A {};", "1:11: expected , or ] after the qualifier"},
    {"[Abstract] A {};", "1:12: expected class after the qualifiers"},
    {"[Version()] class A {};", "1:10: expected a string, decimal number, true, false or null"},
    {"[Version(\"1\"] class A {};", "1:13: expected )"},
    {"Qualifier Q, Scope(any);", "1:12: expected :"},
    {"Qualifier Q : string, Flavor(Restricted);", "1:23: expected Scope"},
    {"Qualifier Q : string, Scope(any class);", "1:33: expected , or )"},
    {"class A { uint8 P = maybe; };",
        "1:21: expected a string, decimal number, true, false or null"},
    {"class A { uint8 P = 012; };", "1:21: expected a string, decimal number, true, false or null"},
    {"class A { uint8 P = 1x; };", "1:21: expected a string, decimal number, true, false or null"},
    {"[Values {\"a\"; ] class A {};", "1:13: expected , or } in the list"},
    {"class A { string P = \"open\n\"; };", "1:27: expected the closing \" of the string"},
    {"class A { string P = \"a\xFF\"; };", "1:24: expected the closing \" of the string"},
    {"class A { string P = \"a\\n\"; };", "1:24: expected the closing \" of the string"},
};

constexpr MofError unknown[] = {
    {"class A : B {};\nclass B {};", "1:11: B is no declared class"},
    {"class A {};\n[Association] class L { A ref One; B ref Two; };",
        "2:36: B is no declared class"},
    {"class A { [Key] uint17 P; };", "1:17: uint17 is no data type"},
    {"class A { B P; };", "1:11: B is no data type"},
    {"Qualifier Q : text, Scope(any), Flavor(Restricted);", "1:15: text is no data type"},
    {"Qualifier Q : string, Scope(schema), Flavor(Restricted);", "1:29: schema is no scope"},
    {"Qualifier Q : string, Scope(any), Flavor(any);", "1:42: any is no flavor"},
    {"[Funny] class A {};", "1:2: Funny is no declared qualifier"},
    {"class A { [Funny(1)] uint8 P; };", "1:12: Funny is no declared qualifier"},
    {"class A { [Override(\"P\")] uint8 P; };",
        "1:33: property P overrides none: no superclass has one of that name"},
};

constexpr MofError duplicates[] = {
    {"class A {};\nclass a {};", "2:7: a is declared twice"},
    {"class A { uint8 P; uint8 p; };", "1:26: property p is declared twice"},
    {"class A { uint8 P; };\nclass B : A { uint8 P; };",
        "2:21: property P is inherited from class A; to declare it anew, qualify it Override"},
    {"[Version(\"1\"), version(\"2\")] class A {};", "1:16: version stands here twice"},
    {"Qualifier Key : boolean = false, Scope(any), Flavor(Restricted);",
        "1:11: Key is declared twice"},
};

constexpr MofError types[] = {
    {"[Version(1)] class A {};", "1:10: the value is none of type string"},
    {"[Abstract(\"true\")] class A {};", "1:11: the value is none of type boolean"},
    {"class A { [MaxLen(-1)] string P; };", "1:19: the value is none of type uint32"},
    {"class A { [Values(\"a\")] string P; };", "1:19: the value is none of type string[]"},
    {"class A { [Values {\"a\", 1}] string P; };", "1:25: the value is none of type string"},
    {"class A { [MaxLen {1}] string P; };", "1:20: the value is none of type uint32"},
    {"class A { uint8 P = 256; };", "1:21: the value is none of type uint8"},
    {"class A { sint8 P = 128; };", "1:21: the value is none of type sint8"},
    {"class A { sint8 P = -129; };", "1:21: the value is none of type sint8"},
    {"class A { uint64 P = 18446744073709551616; };", "1:22: the value is none of type uint64"},
    {"class A { uint8 P; };\nclass B : A { [Override(\"P\")] uint16 P; };",
        "2:38: property P is overridden with another type"},
};

INSTANTIATE_TEST_SUITE_P(Syntax, MofErrorTest, ::testing::ValuesIn(syntax));
INSTANTIATE_TEST_SUITE_P(Unknown, MofErrorTest, ::testing::ValuesIn(unknown));
INSTANTIATE_TEST_SUITE_P(Duplicates, MofErrorTest, ::testing::ValuesIn(duplicates));
INSTANTIATE_TEST_SUITE_P(Types, MofErrorTest, ::testing::ValuesIn(types));

} // namespace MofErrorTests
