// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What subclasses inherit, and how they change it.

#include "tests/host/repository/MofTest.h"

#include <gmock/gmock.h>

#include <cmpidt.h>

namespace InheritanceTests {

using Testing::classNamed;
using Testing::compile;
using ::testing::ElementsAre;
using Testing::NameSpace;
using Testing::propertyNamed;

template <typename List>
std::vector<std::string> namesOf(const List& list)
{
    std::vector<std::string> names;
    for (const auto& each : list)
        names.push_back(each->name);
    return names;
}

TEST(InheritanceTest, propertiesOfAncestorsComeFirstAndKeepTheirPlace)
{
    const auto repository = compile(R"(
        class A { uint8 P; uint8 Q; };
        class B : A { uint8 R; [Override("p")] uint8 p; };
        class C : B { uint8 S; };)");
    EXPECT_THAT(namesOf(classNamed(*repository, "C").properties), ElementsAre("p", "Q", "R", "S"));
}

TEST(InheritanceTest, propertiesKnowWhoIntroducedAndWhoDeclaredThem)
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

TEST(InheritanceTest, methodsAreInheritedAndOverridden)
{
    const auto repository = compile(R"(
        class A { [Description("a")] uint8 F([In, Description("x")] string X); uint8 G(); };
        class B : A { [Override("F"), Description("b")] uint8 f(string x); };
        class C : B { uint8 H(); };)");
    const auto& declared = classNamed(*repository, "C");
    EXPECT_THAT(namesOf(declared.methods), ElementsAre("f", "G", "H"));
    const auto& method = *declared.method("F");
    EXPECT_EQ(method.origin->name, "A");
    EXPECT_EQ(method.declaredIn->name, "B");
    EXPECT_EQ(Host::qualifierText(method.qualifiers, "Description"), "b");
    EXPECT_EQ(Host::qualifierText(method.parameters[0].qualifiers, "Description"), "x");
}

TEST(InheritanceTest, keysAreThoseOfTheClassThatDeclaresThem)
{
    const auto repository = compile(R"(
        class Root { string Name; string Other; };
        class A : Root { [Key] string Two; [Key] string One; [Key, Override("Name")] string Name; };
        class B : A { [Override("One")] string ONE; string Three; };)");
    EXPECT_THAT(*repository->keysOf(NameSpace, "Root"), ElementsAre());
    EXPECT_THAT(*repository->keysOf(NameSpace, "A"), ElementsAre("Two", "One", "Name"));
    EXPECT_THAT(*repository->keysOf(NameSpace, "B"), ElementsAre("Two", "One", "Name"));
    EXPECT_TRUE(propertyNamed(*repository, "B", "One").isKey);
    EXPECT_FALSE(propertyNamed(*repository, "Root", "Name").isKey);
    EXPECT_EQ(repository->keysOf(NameSpace, "C"), nullptr);
}

TEST(InheritanceTest, anOverriddenPropertyKeepsItsDefaultUnlessItGetsAnother)
{
    const auto repository = compile(R"(
        class A { uint8 P = 1; uint8 Q = 1; uint8 R = 1; };
        class B : A { [Override("P")] uint8 P; [Override("Q")] uint8 Q = 2;
            [Override("R")] uint8 R = null; };)");
    EXPECT_EQ(
        *propertyNamed(*repository, "B", "P").defaultValue, Testing::constant(std::uint64_t{1}));
    EXPECT_EQ(
        *propertyNamed(*repository, "B", "Q").defaultValue, Testing::constant(std::uint64_t{2}));
    EXPECT_TRUE(Host::isNull(*propertyNamed(*repository, "B", "R").defaultValue));
}

TEST(InheritanceTest, aReferenceMayBeNarrowedToASubclass)
{
    const auto repository = compile(R"(
        class A {}; class B : A {};
        [Association] class L { [Key] A ref One; [Key] A ref Two; };
        [Association] class M : L { [Override("One")] B ref One; };
        [Association] class N : M { [Override("One")] b ref One; };)");
    const auto references = repository->referencesOf(NameSpace, "m");
    ASSERT_EQ(references.size(), 2U);
    EXPECT_EQ(references[0].name, "One");
    EXPECT_EQ(references[0].className, "B");
    EXPECT_EQ(references[1].name, "Two");
    EXPECT_EQ(references[1].className, "A");
}

TEST(InheritanceTest, associationsPassThatOnToTheirSubclasses)
{
    const auto repository = compile(R"(
        class A {};
        [Association] class L { A ref One; A ref Two; };
        class M : L { };)");
    EXPECT_TRUE(repository->isAssociation(NameSpace, "M"));
    EXPECT_FALSE(repository->isAssociation(NameSpace, "A"));
}

TEST(QualifierPropagationTest, restrictedQualifiersEndWithTheirClass)
{
    const auto repository = compile(R"(
        [Abstract, Version("1"), Description("d")]
        class A {
            [Description("p"), MaxLen(5) : Restricted] string P;
            [MaxLen(5) : Restricted, Description("f")] string F([MaxLen(5) : Restricted] string X);
        };
        class B : A { };
        class C : B { [Override("P")] string P; };)");
    EXPECT_TRUE(classNamed(*repository, "A").isAbstract);
    const auto& inherited = classNamed(*repository, "B");
    EXPECT_FALSE(inherited.isAbstract);
    EXPECT_EQ(Host::findQualifier(inherited.qualifiers, "Version"), nullptr);
    EXPECT_EQ(Host::qualifierText(inherited.qualifiers, "Description"), "d");
    EXPECT_TRUE(Host::findQualifier(inherited.qualifiers, "Description")->isPropagated);
    for (const char* const className : {"B", "C"}) {
        const auto& qualifiers = propertyNamed(*repository, className, "P").qualifiers;
        EXPECT_EQ(Host::findQualifier(qualifiers, "MaxLen"), nullptr) << className;
        EXPECT_EQ(Host::qualifierText(qualifiers, "Description"), "p") << className;
    }
    const auto& method = *inherited.method("F");
    EXPECT_EQ(Host::findQualifier(method.qualifiers, "MaxLen"), nullptr);
    EXPECT_EQ(Host::qualifierText(method.qualifiers, "Description"), "f");
    EXPECT_EQ(Host::findQualifier(method.parameters[0].qualifiers, "MaxLen"), nullptr);
    EXPECT_NE(
        Host::findQualifier(propertyNamed(*repository, "A", "P").qualifiers, "MaxLen"), nullptr);
}

TEST(QualifierPropagationTest, anOverridableQualifierTakesTheNearestValue)
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

TEST(QualifierPropagationTest, whatMayNotBeOverriddenMayBeRepeated)
{
    const auto repository = compile(R"(
        class A { [Key] string P; [MaxLen(5) : DisableOverride] string Q; };
        class B : A { [Key, Override("P")] string P; [MaxLen(5), Override("Q")] string Q; };)");
    EXPECT_TRUE(propertyNamed(*repository, "B", "P").isKey);
    const auto* const length =
        Host::findQualifier(propertyNamed(*repository, "B", "Q").qualifiers, "MaxLen");
    EXPECT_FALSE(length->isPropagated);
    EXPECT_FALSE(length->flavor.isOverridable); // for the next subclass too
}

} // namespace InheritanceTests
