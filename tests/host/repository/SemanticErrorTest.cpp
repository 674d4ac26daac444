// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Declarations that read well and cannot be: each is reported where it stands, with the reason.

#include "tests/host/repository/MofTest.h"

namespace SemanticErrorTests {

using Testing::errorOf;

struct SemanticError {
    const char* text;
    const char* error; // after "test.mof:"
};

std::ostream& operator<<(std::ostream& out, const SemanticError& each)
{
    return out << each.text;
}

class SemanticErrorTest : public ::testing::TestWithParam<SemanticError> {};

TEST_P(SemanticErrorTest, namesPlaceAndReason)
{
    EXPECT_EQ(errorOf(GetParam().text), "test.mof:" + std::string(GetParam().error));
}

const SemanticError Classes[] = {
    {"class A : B {};", "1:11: superclass B is not declared"},
    {"class A : A {};", "1:11: superclass A is not declared"},
    {"class A : B {};\nclass B {};", "1:11: superclass B is not declared"},
    {"class A {};\nclass a {};", "2:7: class a is declared already, at test.mof:1:7"},
    {"class A { A ref P; };", "1:17: reference P stands in a class that is no association"},
    {"[Association] class L { };", "1:21: association L has fewer than two references"},
    {"class A {};\n[Association] class L { A ref One; };",
        "2:21: association L has fewer than two references"},
    {"class A {};\n[Association] class L : A { A ref One; A ref Two; };",
        "2:2: an association cannot have class A for its superclass, which is none"},
    {"class A {};\n[Association] class L { A ref One[]; A ref Two; };",
        "2:25: a property cannot be an array of references"},
};

const SemanticError References[] = {
    {"class A {};\n[Association] class L { A ref One; B ref Two; };",
        "2:36: class B is not declared"},
    {"class A { uint8 F(B ref X); };", "1:19: class B is not declared"},
    {"class A { B ref F(); };", "1:11: class B is not declared"},
    {"class A {}; class B {};\n[Association] class L { A ref One; A ref Two; };\n"
     "[Association] class M : L { [Override(\"One\")] B ref One; };",
        "3:47: class B is not derived from class A, which the overridden reference names"},
    {"class A {}; class B : A {};\n[Association] class L { B ref One; A ref Two; };\n"
     "[Association] class M : L { [Override(\"One\")] A ref One; };",
        "3:47: class A is not derived from class B, which the overridden reference names"},
};

const SemanticError Features[] = {
    {"class A { uint8 P; uint8 p; };", "1:26: property p is declared twice"},
    {"class A { uint8 F(); uint8 f(); };", "1:28: method f is declared twice"},
    {"class A { uint8 F(uint8 x, uint8 X); };", "1:34: parameter X is declared twice"},
    {"class A { uint8 P; };\nclass B : A { [Override(\"P\")] uint8 P; [Override(\"P\")] uint8 P; "
     "};",
        "2:62: property P is declared twice"},
    {"class A { uint8 P; };\nclass B : A { uint8 P; };",
        "2:21: property P is inherited from class A; to declare it anew, qualify it "
        "Override(\"P\")"},
    {"class A { uint8 F(); };\nclass B : A { uint8 F(); };",
        "2:21: method F is inherited from class A; to declare it anew, qualify it Override(\"F\")"},
    {"class A { [Override(\"P\")] uint8 P; };",
        "1:12: no superclass has a property P that could be overridden"},
    {"class A { uint8 P; };\nclass B : A { [Override(\"P\")] uint8 Q; };",
        "2:16: property Q cannot override \"P\", which has another name"},
    {"class A { uint8 P; };\nclass B : A { [Override(\"P\")] uint16 P; };",
        "2:31: P is overridden with type uint16, but has type uint8"},
    {"class A { uint8 P[]; };\nclass B : A { [Override(\"P\")] uint8 P; };",
        "2:31: P is overridden with type uint8, but has type uint8[]"},
    {"class A {};\n[Association] class L { A ref One; A ref Two; };\n"
     "[Association] class M : L { [Override(\"One\")] string One; };",
        "3:47: One is overridden with type string, but has type ref"},
    {"class A { uint8 F(); };\nclass B : A { [Override(\"F\")] uint16 F(); };",
        "2:31: F is overridden with type uint16, but has type uint8"},
    {"class A { uint8 F(uint8 x); };\nclass B : A { [Override(\"F\")] uint8 F(); };",
        "2:37: method F overrides one with 1 parameters, not 0"},
    {"class A { uint8 F(); };\nclass B : A { [Override(\"F\")] uint8 F(uint8 x); };",
        "2:37: method F overrides one with 0 parameters, not 1"},
    {"class A { uint8 F(uint8 x); };\nclass B : A { [Override(\"F\")] uint8 F(uint8 y); };",
        "2:45: parameter y stands where the overridden method has x"},
    {"class A { uint8 F(uint8 x); };\nclass B : A { [Override(\"F\")] uint8 F(sint8 x); };",
        "2:39: x is overridden with type sint8, but has type uint8"},
};

const SemanticError Keys[] = {
    {"class A { [Key] uint8 P; };\nclass B : A { [Key] uint8 Q; };",
        "2:27: property Q cannot be a key: class A has its keys already"},
    {"class A { [Key] uint8 P; uint8 Q; };\nclass B : A {};\n"
     "class C : B { [Key, Override(\"Q\")] uint8 Q; };",
        "3:42: property Q cannot be a key: class B has its keys already"},
};

const SemanticError Qualifiers[] = {
    {"[Funny] class A {};", "1:2: qualifier Funny is not declared"},
    {"class A { [Funny(1)] uint8 P; };", "1:12: qualifier Funny is not declared"},
    {"class A { uint8 F([Funny] uint8 x); };", "1:20: qualifier Funny is not declared"},
    {"[Version(\"1\"), version(\"2\")] class A {};", "1:16: qualifier version stands here twice"},
    {"[Version(1)] class A {};", "1:10: an integer is no value of type string"},
    {"[Abstract(\"true\")] class A {};", "1:11: a string is no value of type boolean"},
    {"class A { [MaxLen(-1)] string P; };", "1:19: the number does not fit into type uint32"},
    {"class A { [Values(\"a\")] string P; };", "1:19: a single value is none of type string[]"},
    {"class A { [MaxLen {1}] string P; };", "1:19: a list is no value of type uint32"},
    {"[Key] class A {};",
        "1:2: qualifier Key may not stand on this element: its scope has no class"},
    {"class A {};\n[Association, MaxLen(1)] class L { A ref One; A ref Two; };",
        "2:15: qualifier MaxLen may not stand on this element: its scope has no association"},
    {"[Indication, MaxLen(1)] class A {};",
        "1:14: qualifier MaxLen may not stand on this element: its scope has no indication"},
    {"class A { [Abstract] uint8 P; };",
        "1:12: qualifier Abstract may not stand on this element: its scope has no property"},
    {"class A {};\n[Association] class L { [MaxLen(1)] A ref One; A ref Two; };",
        "2:26: qualifier MaxLen may not stand on this element: its scope has no reference"},
    {"class A { [Key] uint8 F(); };",
        "1:12: qualifier Key may not stand on this element: its scope has no method"},
    {"class A { uint8 F([Key] uint8 x); };",
        "1:20: qualifier Key may not stand on this element: its scope has no parameter"},
    {"[Association(false)] class A {};",
        "1:2: qualifier Association may not stand on this element: its scope has no class"},
    {"class A { [Key] uint8 P; };\nclass B : A { [Key(false), Override(\"P\")] uint8 P; };",
        "2:16: qualifier Key may not get another value than it inherits"},
    {"class A { uint8 F([In] uint8 x); };\n"
     "class B : A { [Override(\"F\")] uint8 F([In(false)] uint8 x); };",
        "2:40: qualifier In may not get another value than it inherits"},
    {"[Description(\"a\") : DisableOverride] class A {};\n"
     "class B : A {};\n[Description(\"b\")] class C : B {};",
        "3:2: qualifier Description may not get another value than it inherits"},
    {"[Description(\"d\") : EnableOverride DisableOverride] class A {};",
        "1:36: this flavor excludes one before it"},
    {"[Description(\"d\") : Restricted ToSubclass] class A {};",
        "1:32: this flavor excludes one before it"},
    {"Qualifier Q : string, Scope(any), Flavor(ToSubclass, Restricted);",
        "1:54: this flavor excludes one before it"},
    {"Qualifier Q : uint8 = 256, Scope(any);", "1:23: the number does not fit into type uint8"},
    {"Qualifier Q : string, Scope(any);\nQualifier q : string, Scope(any);",
        "2:11: qualifier q is declared already, at test.mof:1:11"},
};

INSTANTIATE_TEST_SUITE_P(Classes, SemanticErrorTest, ::testing::ValuesIn(Classes));
INSTANTIATE_TEST_SUITE_P(References, SemanticErrorTest, ::testing::ValuesIn(References));
INSTANTIATE_TEST_SUITE_P(Features, SemanticErrorTest, ::testing::ValuesIn(Features));
INSTANTIATE_TEST_SUITE_P(Keys, SemanticErrorTest, ::testing::ValuesIn(Keys));
INSTANTIATE_TEST_SUITE_P(Qualifiers, SemanticErrorTest, ::testing::ValuesIn(Qualifiers));

} // namespace SemanticErrorTests
