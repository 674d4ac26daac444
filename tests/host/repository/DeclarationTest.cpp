// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The declarations of MOF files.

#include "tests/host/repository/MofTest.h"

#include <cmpidt.h>

#include <limits>
#include <utility>

namespace DeclarationTests {

using Host::Scope;
using Testing::classNamed;
using Testing::compile;
using Testing::compileBare;
using Testing::constant;
using Testing::defaultOf;
using Testing::propertyNamed;
using Testing::testNameSpace;

TEST(DeclarationTest, AnEmptyFileDeclaresNothing)
{
    for (const char* const text : {"", " \t\r\n\f\v", "// the end"})
        EXPECT_TRUE(compileBare(text)->findNamespace(testNameSpace)->classes().empty()) << text;
}

TEST(DeclarationTest, KeywordsAndTypesMayBeWrittenInAnyCase)
{
    const auto repository = compileBare(R"(
        QUALIFIER association : BOOLEAN = FALSE, SCOPE(ASSOCIATION), FLAVOR(DISABLEOVERRIDE);
        CLASS A { UINT8 P = NULL; };
        [ASSOCIATION] Class B { A REF One; A Ref Two; };
        clASs C : a { Boolean Q = True; };)");
    EXPECT_TRUE(classNamed(*repository, "B").isAssociation);
    EXPECT_EQ(classNamed(*repository, "C").superclass->name, "A");
}

TEST(DeclarationTest, ANameMayBeginWithAKeyword)
{
    const auto repository = compile("class class_A { uint8 string_P; sint8 refR; };");
    EXPECT_EQ(classNamed(*repository, "class_A").properties.size(), 2U);
}

TEST(DeclarationTest, QualifiersHaveTypeDefaultScopesAndFlavors)
{
    const auto repository = compileBare(R"(
        Qualifier One : boolean = true, Scope(class), Flavor(Translatable);
        Qualifier Two : string[], Scope(property, method, reference),
            Flavor(DisableOverride, Restricted);
        Qualifier Three : string = null, Scope(any), Flavor(EnableOverride, ToSubclass);)");
    const auto& one = *repository->findQualifier(testNameSpace, "one");
    EXPECT_EQ(one.name, "One");
    EXPECT_EQ(one.type, CMPI_boolean);
    EXPECT_EQ(one.defaultValue, constant(true));
    EXPECT_TRUE(one.scopes.has(Scope::classes));
    EXPECT_FALSE(one.scopes.has(Scope::property));
    EXPECT_EQ(one.flavor, (Host::Flavor{true, true, true}));

    const auto& two = *repository->findQualifier(testNameSpace, "Two");
    EXPECT_EQ(two.type, CMPI_stringA);
    EXPECT_TRUE(Host::isNull(two.defaultValue));
    EXPECT_TRUE(two.scopes.has(Scope::property));
    EXPECT_TRUE(two.scopes.has(Scope::method));
    EXPECT_TRUE(two.scopes.has(Scope::reference));
    EXPECT_FALSE(two.scopes.has(Scope::parameter));
    EXPECT_EQ(two.flavor, (Host::Flavor{false, false, false}));

    const auto& three = *repository->findQualifier(testNameSpace, "THREE");
    EXPECT_TRUE(Host::isNull(three.defaultValue));
    for (const Scope scope : {Scope::classes, Scope::association, Scope::indication,
             Scope::property, Scope::reference, Scope::method, Scope::parameter})
        EXPECT_TRUE(three.scopes.has(scope));
    EXPECT_EQ(three.flavor, Host::Flavor());
}

TEST(DeclarationTest, PropertiesHaveEveryTypeOfCim)
{
    const std::vector<std::pair<std::string, CMPIType>> types = {{"uint8", CMPI_uint8},
        {"uint16", CMPI_uint16}, {"uint32", CMPI_uint32}, {"uint64", CMPI_uint64},
        {"sint8", CMPI_sint8}, {"sint16", CMPI_sint16}, {"sint32", CMPI_sint32},
        {"sint64", CMPI_sint64}, {"real32", CMPI_real32}, {"real64", CMPI_real64},
        {"boolean", CMPI_boolean}, {"string", CMPI_string}, {"char16", CMPI_char16},
        {"datetime", CMPI_dateTime}};
    for (const auto& [name, type] : types) {
        const auto repository = compile("class A { " + name + " One; " + name + " Two[]; };");
        EXPECT_EQ(propertyNamed(*repository, "A", "One").type, type) << name;
        EXPECT_EQ(propertyNamed(*repository, "A", "Two").type, type | CMPI_ARRAY) << name;
    }
}

TEST(DeclarationTest, AssociationsReferToClassesThatMayComeLater)
{
    const auto repository = compile(R"(
        [Association] class L { [Key] A ref One; [Key] B ref Two; };
        class A {}; class B {};)");
    const auto& reference = propertyNamed(*repository, "L", "Two");
    EXPECT_EQ(reference.type, CMPI_ref);
    EXPECT_EQ(reference.referenceClass, "B");
    EXPECT_TRUE(reference.isReference());
    EXPECT_TRUE(reference.isKey);
}

TEST(DeclarationTest, QualifiersCarryValuesAndLists)
{
    const auto repository =
        compile("class A { [Values {\"a\", \"b\"}, MaxLen(16), Key, Description] string P; };");
    const auto& qualifiers = propertyNamed(*repository, "A", "P").qualifiers;
    EXPECT_EQ(Host::findQualifier(qualifiers, "VALUES")->value,
        Host::Constant(std::vector<Host::Scalar>{std::string("a"), std::string("b")}));
    EXPECT_EQ(Host::findQualifier(qualifiers, "MaxLen")->value, constant(std::uint64_t{16}));
    // Without a value, only a boolean qualifier has an effect.
    EXPECT_TRUE(Host::isQualified(qualifiers, "Key"));
    EXPECT_TRUE(Host::isNull(Host::findQualifier(qualifiers, "Description")->value));
}

TEST(DeclarationTest, IntegersReachTheEndsOfTheirTypes)
{
    EXPECT_EQ(defaultOf("uint8 P", "0"), constant(std::uint64_t{0}));
    EXPECT_EQ(defaultOf("uint8 P", "255"), constant(std::uint64_t{255}));
    EXPECT_EQ(defaultOf("sint8 P", "-128"), constant(std::int64_t{-128}));
    EXPECT_EQ(defaultOf("sint8 P", "127"), constant(std::int64_t{127}));
    EXPECT_EQ(defaultOf("uint64 P", "18446744073709551615"),
        constant(std::numeric_limits<std::uint64_t>::max()));
    EXPECT_EQ(defaultOf("sint64 P", "-9223372036854775808"),
        constant(std::numeric_limits<std::int64_t>::min()));
}

TEST(DeclarationTest, BlanksAndCommentsMayFollowAnyValue)
{
    EXPECT_EQ(defaultOf("boolean P", "true // not false\n"), constant(true));
    EXPECT_EQ(defaultOf("boolean P", "FALSE "), constant(false));
    EXPECT_EQ(defaultOf("uint8 P", "1 "), constant(std::uint64_t{1}));
}

TEST(DeclarationTest, AdjacentStringsAreOne)
{
    EXPECT_EQ(defaultOf("string P", R"("")"), constant(std::string()));
    EXPECT_EQ(defaultOf("string P", "\"one \" // and\n \"two\""), constant(std::string("one two")));
    EXPECT_EQ(defaultOf("string P", "\"\u00e9\u20ac\""), constant(std::string("\u00e9\u20ac")));
}

TEST(DeclarationTest, AnyTypeMayBeNull)
{
    for (const char* const type : {"boolean P", "uint8 P", "string P", "string P[]", "datetime P"})
        EXPECT_TRUE(Host::isNull(defaultOf(type, "null"))) << type;
}

} // namespace DeclarationTests
