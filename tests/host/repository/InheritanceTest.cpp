// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The inheritance and overriding of properties and qualifiers.

#include "tests/host/repository/MofTest.h"

#include <gmock/gmock.h>

#include <cmpidt.h>

namespace InheritanceTests {

using Testing::classNamed;
using Testing::compile;
using ::testing::ElementsAre;
using Testing::propertyNamed;
using Testing::testNameSpace;

template <typename List>
std::vector<std::string> namesOf(const List& list)
{
    std::vector<std::string> names;
    for (const auto& each : list)
        names.push_back(each->name);
    return names;
}

TEST(InheritanceTest, PropertiesOfAncestorsComeFirstAndKeepTheirPlace)
{
    const auto repository = compile(R"(
        class A { uint8 P; uint8 Q; };
        class B : A { uint8 R; [Override("p")] uint8 p; };
        class C : B { uint8 S; };)");
    EXPECT_THAT(namesOf(classNamed(*repository, "C").properties), ElementsAre("p", "Q", "R", "S"));
}

TEST(InheritanceTest, PropertiesKnowWhoIntroducedAndWhoDeclaredThem)
{
    const auto repository = compile(R"(
        class A { uint8 P; uint8 Q; };
        class B : A { [Override("P")] uint8 P; };
        class C : B { };)");
    const auto& overridden = propertyNamed(*repository, "C", "P");
    EXPECT_EQ(overridden.origin->name, "A");
    EXPECT_EQ(overridden.declaredIn->name, "B");
    EXPECT_EQ(propertyNamed(*repository, "C", "Q").declaredIn->name, "A");
    EXPECT_EQ(propertyNamed(*repository, "A", "P").declaredIn->name, "A");
}

TEST(InheritanceTest, KeysAreThoseOfTheClassThatDeclaresThem)
{
    const auto repository = compile(R"(
        class Root { string Name; string Other; };
        class A : Root { [Key] string Two; [Key] string One; [Key, Override("Name")] string Name; };
        class B : A { [Override("One")] string ONE; string Three; };)");
    EXPECT_THAT(*repository->keysOf(testNameSpace, "Root"), ElementsAre());
    EXPECT_THAT(*repository->keysOf(testNameSpace, "A"), ElementsAre("Two", "One", "Name"));
    EXPECT_THAT(*repository->keysOf(testNameSpace, "B"), ElementsAre("Two", "One", "Name"));
    EXPECT_TRUE(propertyNamed(*repository, "B", "One").isKey);
    EXPECT_FALSE(propertyNamed(*repository, "Root", "Name").isKey);
    EXPECT_EQ(repository->keysOf(testNameSpace, "C"), nullptr);
}

TEST(InheritanceTest, AnOverriddenPropertyKeepsItsDefaultUnlessItGetsAnother)
{
    const auto repository = compile(R"(
        class A { uint8 P = 1; uint8 Q = 1; };
        class B : A { [Override("P")] uint8 P; [Override("Q")] uint8 Q = 2; };)");
    EXPECT_EQ(
        propertyNamed(*repository, "B", "P").defaultValue, Testing::constant(std::uint64_t{1}));
    EXPECT_EQ(
        propertyNamed(*repository, "B", "Q").defaultValue, Testing::constant(std::uint64_t{2}));
}

TEST(InheritanceTest, AReferenceMayBeNarrowedToASubclass)
{
    const auto repository = compile(R"(
        class A {}; class B : A {};
        [Association] class L { [Key] A ref One; [Key] A ref Two; };
        [Association] class M : L { [Override("One")] B ref One; };
        [Association] class N : M { [Override("One")] b ref One; };)");
    const auto references = repository->referencesOf(testNameSpace, "m");
    ASSERT_EQ(references.size(), 2U);
    EXPECT_EQ(references[0].name, "One");
    EXPECT_EQ(references[0].className, "B");
    EXPECT_EQ(references[1].name, "Two");
    EXPECT_EQ(references[1].className, "A");
}

TEST(InheritanceTest, AssociationsPassThatOnToTheirSubclasses)
{
    const auto repository = compile(R"(
        class A {};
        [Association] class L { A ref One; A ref Two; };
        class M : L { };)");
    EXPECT_TRUE(classNamed(*repository, "M").isAssociation);
    EXPECT_FALSE(classNamed(*repository, "A").isAssociation);
}

TEST(QualifierPropagationTest, RestrictedQualifiersEndWithTheirClass)
{
    const auto repository = compile(R"(
        [Abstract, Version("1"), Description("d")]
        class A { [Description("p")] string P; };
        class B : A { [Override("P")] string P; };
        class C : B { };)");
    const auto& inherited = classNamed(*repository, "B");
    EXPECT_EQ(Host::findQualifier(inherited.qualifiers, "Abstract"), nullptr);
    EXPECT_EQ(Host::findQualifier(inherited.qualifiers, "Version"), nullptr);
    EXPECT_EQ(Host::qualifierText(inherited.qualifiers, "Description"), "d");
    EXPECT_TRUE(Host::findQualifier(inherited.qualifiers, "Description")->isPropagated);
    const auto& qualifiers = propertyNamed(*repository, "C", "P").qualifiers;
    EXPECT_EQ(Host::findQualifier(qualifiers, "Override"), nullptr);
    EXPECT_EQ(Host::qualifierText(qualifiers, "Description"), "p");
    EXPECT_NE(
        Host::findQualifier(propertyNamed(*repository, "B", "P").qualifiers, "Override"), nullptr);
}

TEST(QualifierPropagationTest, AnOverridableQualifierTakesTheNearestValue)
{
    const auto repository = compile(R"(
        class A { [Description("a")] string P; };
        class B : A { [Override("P"), Description("b")] string P; };
        class C : B { [Override("P")] string P; };)");
    const auto& qualifiers = propertyNamed(*repository, "C", "P").qualifiers;
    EXPECT_EQ(Host::qualifierText(qualifiers, "Description"), "b");
    EXPECT_TRUE(Host::findQualifier(qualifiers, "Description")->isPropagated);
    EXPECT_EQ(
        Host::qualifierText(propertyNamed(*repository, "A", "P").qualifiers, "Description"), "a");
}

} // namespace InheritanceTests
