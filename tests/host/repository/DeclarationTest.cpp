// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Everything a MOF file may hold.

#include "tests/host/repository/MofTest.h"

#include <gmock/gmock.h>

#include <cmpidt.h>

namespace DeclarationTests {

using Host::Scope;
using Testing::classNamed;
using Testing::compile;
using Testing::compileBare;
using Testing::NameSpace;
using Testing::propertyNamed;

TEST(DeclarationTest, anEmptyFileDeclaresNothing)
{
    for (const char* const text : {"", " \t\r\n\f\v", "// the end", "/* nothing */", "\xEF\xBB\xBF",
             "/**//***/ // x\n/* a\n * b */"}) {
        const auto repository = compileBare(text);
        EXPECT_TRUE(repository->findNamespace(NameSpace)->classes().empty()) << text;
    }
}

TEST(DeclarationTest, commentsAndBlanksMayStandBetweenAnyTokens)
{
    const auto repository = compile("class/**/A//x\n{/*1*/uint8/*2*/P/*3*/[/*4*/3/*5*/]/*6*/=/*7*/"
                                    "{/*8*/1/*9*/,2,3}/*10*/;/*11*/}/*12*/;/*13*/");
    EXPECT_EQ(propertyNamed(*repository, "A", "P").arraySize, 3U);
}

TEST(DeclarationTest, keywordsMayBeWrittenInAnyCase)
{
    const auto repository = compileBare(R"(
        #PRAGMA Locale ("en_US")
        QUALIFIER association : BOOLEAN = FALSE, SCOPE(ASSOCIATION), FLAVOR(DISABLEOVERRIDE);
        CLASS A { UINT8 P = NULL; };
        [ASSOCIATION] Class B AS $B { A REF One; A Ref Two; };
        clASs C : a { Boolean Q = True; };)");
    EXPECT_TRUE(repository->isAssociation(NameSpace, "B"));
    EXPECT_EQ(classNamed(*repository, "C").superclass->name, "A");
}

TEST(DeclarationTest, aNameMayBeginWithAKeyword)
{
    const auto repository = compile("class class_A { uint8 string_P; boolean trueQ; };"
                                    "class instance_B : class_A { sint8 refR; };");
    EXPECT_EQ(classNamed(*repository, "instance_B").properties.size(), 3U);
}

TEST(DeclarationTest, qualifiersHaveTypeDefaultScopesAndFlavors)
{
    const auto repository = compileBare(R"(
        Qualifier One : boolean, Scope(class);
        Qualifier Two : uint8[] = {1, 2}, Scope(property, method, reference),
            Flavor(DisableOverride, Restricted, Translatable);
        Qualifier Three : string[4] = null, Scope(any), Flavor(EnableOverride, ToSubclass);)");
    const auto& one = *repository->findQualifier(NameSpace, "one");
    EXPECT_EQ(one.name, "One");
    EXPECT_EQ(one.type, CMPI_boolean);
    EXPECT_TRUE(Host::isNull(one.defaultValue));
    EXPECT_TRUE(one.scopes.has(Scope::classes));
    EXPECT_FALSE(one.scopes.has(Scope::property));
    EXPECT_FALSE(one.scopes.has(Scope::any));
    EXPECT_EQ(one.flavor, (Host::Flavor{true, true, false}));

    const auto& two = *repository->findQualifier(NameSpace, "Two");
    EXPECT_EQ(two.type, CMPI_uint8A);
    EXPECT_EQ(two.defaultValue,
        Host::Constant(std::vector<Host::Scalar>{std::uint64_t{1}, std::uint64_t{2}}));
    EXPECT_TRUE(two.scopes.has(Scope::property));
    EXPECT_TRUE(two.scopes.has(Scope::method));
    EXPECT_TRUE(two.scopes.has(Scope::reference));
    EXPECT_FALSE(two.scopes.has(Scope::parameter));
    EXPECT_EQ(two.flavor, (Host::Flavor{false, false, true}));

    const auto& three = *repository->findQualifier(NameSpace, "THREE");
    EXPECT_EQ(three.arraySize, 4U);
    EXPECT_TRUE(three.scopes.has(Scope::any));
    EXPECT_TRUE(three.scopes.has(Scope::parameter));
    EXPECT_EQ(three.flavor, Host::Flavor());
}

TEST(DeclarationTest, everyScopeIsReadAsItsOwn)
{
    const std::vector<std::pair<std::string, Scope>> scopes = {{"schema", Scope::schema},
        {"class", Scope::classes}, {"association", Scope::association},
        {"indication", Scope::indication}, {"qualifier", Scope::qualifier},
        {"property", Scope::property}, {"reference", Scope::reference}, {"method", Scope::method},
        {"parameter", Scope::parameter}};
    for (const auto& [word, expected] : scopes) {
        const auto repository =
            compileBare("Qualifier Q : boolean, Scope(" + std::string(word) + ");");
        for (const auto& [other, scope] : scopes)
            EXPECT_EQ(
                repository->findQualifier(NameSpace, "Q")->scopes.has(scope), scope == expected)
                << word << " " << other;
    }
}

TEST(DeclarationTest, propertiesHaveEveryTypeOfCim)
{
    const std::vector<std::pair<std::string, CMPIType>> types = {{"uint8", CMPI_uint8},
        {"uint16", CMPI_uint16}, {"uint32", CMPI_uint32}, {"uint64", CMPI_uint64},
        {"sint8", CMPI_sint8}, {"sint16", CMPI_sint16}, {"sint32", CMPI_sint32},
        {"sint64", CMPI_sint64}, {"real32", CMPI_real32}, {"real64", CMPI_real64},
        {"boolean", CMPI_boolean}, {"string", CMPI_string}, {"char16", CMPI_char16},
        {"datetime", CMPI_dateTime}};
    for (const auto& [name, type] : types) {
        const auto repository =
            compile("class A { " + name + " One; " + name + " Two[]; " + name + " Three[7]; };");
        EXPECT_EQ(propertyNamed(*repository, "A", "One").type, type) << name;
        EXPECT_EQ(propertyNamed(*repository, "A", "One").arraySize, std::nullopt);
        EXPECT_EQ(propertyNamed(*repository, "A", "Two").type, type | CMPI_ARRAY) << name;
        EXPECT_EQ(propertyNamed(*repository, "A", "Two").arraySize, std::nullopt);
        EXPECT_EQ(propertyNamed(*repository, "A", "Three").type, type | CMPI_ARRAY) << name;
        EXPECT_EQ(propertyNamed(*repository, "A", "Three").arraySize, 7U);
    }
}

TEST(DeclarationTest, associationsReferToClassesThatMayComeLater)
{
    const auto repository = compile(R"(
        [Association] class L { [Key] A ref One; [Key] B ref Two = null; };
        class A {}; class B {};)");
    const auto& reference = propertyNamed(*repository, "L", "Two");
    EXPECT_EQ(reference.type, CMPI_ref);
    EXPECT_EQ(reference.referenceClass, "B");
    EXPECT_TRUE(reference.isReference());
    EXPECT_TRUE(reference.isKey);
}

TEST(DeclarationTest, methodsHaveParametersOfAllKinds)
{
    const auto repository = compile(R"(
        class A {
            [Description("d")] uint32 Start();
            boolean Move([In, Description("e")] string Where[], [In(false)] A ref Which,
                uint8 Fixed[2], A ref Many[]);
            A ref Self();
        };)");
    const auto& declared = classNamed(*repository, "A");
    EXPECT_EQ(declared.method("start")->type, CMPI_uint32);
    EXPECT_EQ(Host::qualifierText(declared.method("Start")->qualifiers, "Description"), "d");
    EXPECT_EQ(declared.method("Self")->type, CMPI_ref);
    EXPECT_EQ(declared.method("Self")->referenceClass, "A");
    const auto& move = *declared.method("Move");
    ASSERT_EQ(move.parameters.size(), 4U);
    EXPECT_EQ(move.parameters[0].type, CMPI_stringA);
    EXPECT_TRUE(Host::isQualified(move.parameters[0].qualifiers, "In"));
    EXPECT_EQ(move.parameters[1].type, CMPI_ref);
    EXPECT_EQ(move.parameters[1].referenceClass, "A");
    EXPECT_FALSE(Host::isQualified(move.parameters[1].qualifiers, "In"));
    EXPECT_EQ(move.parameters[2].arraySize, 2U);
    EXPECT_EQ(move.parameters[3].type, CMPI_refA);
    EXPECT_EQ(move.parameters[3].name, "Many");
}

TEST(DeclarationTest, qualifiersCarryValuesListsAndFlavors)
{
    const auto repository = compile(R"(
        [Abstract, Version("1.0") : Translatable ToSubclass]
        class A {
            [Values {"a", "b"}, MaxLen(0x10) : DisableOverride, Description] string P;
        };)");
    const auto& declared = classNamed(*repository, "A");
    EXPECT_TRUE(declared.isAbstract);
    const auto* const version = Host::findQualifier(declared.qualifiers, "VERSION");
    ASSERT_NE(version, nullptr);
    EXPECT_EQ(version->flavor, (Host::Flavor{true, true, true}));
    const auto& qualifiers = declared.property("P")->qualifiers;
    EXPECT_EQ(*Host::findQualifier(qualifiers, "Values")->value,
        Host::Constant(std::vector<Host::Scalar>{std::string("a"), std::string("b")}));
    EXPECT_EQ(
        *Host::findQualifier(qualifiers, "MaxLen")->value, Testing::constant(std::uint64_t{16}));
    EXPECT_FALSE(Host::findQualifier(qualifiers, "MaxLen")->flavor.isOverridable);
    // Without a value only a boolean qualifier says something.
    EXPECT_TRUE(Host::isNull(*Host::findQualifier(qualifiers, "Description")->value));
}

TEST(DeclarationTest, indicationsAreNoAssociations)
{
    const auto repository = compile("[Indication] class A { string P; }; class B {};");
    EXPECT_TRUE(classNamed(*repository, "A").isIndication);
    EXPECT_FALSE(classNamed(*repository, "A").isAssociation);
    EXPECT_FALSE(classNamed(*repository, "B").isIndication);
}

TEST(DeclarationTest, declarationsKnowTheirPlace)
{
    const auto repository = compile("class A {\n  uint8\n    P;\n};");
    EXPECT_EQ(Host::toText(classNamed(*repository, "A").position), "test.mof:1:7");
    EXPECT_EQ(Host::toText(propertyNamed(*repository, "A", "P").position), "test.mof:3:5");
}

TEST(DeclarationTest, linesEndWithOrWithoutCarriageReturn)
{
    const auto repository = compile("// one\r\nclass A {\r\n  uint8 P;\r\n};\r\n");
    EXPECT_EQ(Host::toText(propertyNamed(*repository, "A", "P").position), "test.mof:3:9");
}

} // namespace DeclarationTests
