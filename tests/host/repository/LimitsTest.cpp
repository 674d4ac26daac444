// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Texts made to exhaust time, memory or the stack end with an error or in good time.

#include "tests/host/repository/MofTest.h"

#include <gmock/gmock.h>

namespace LimitsTests {

using Testing::classNamed;
using Testing::compile;
using Testing::errorOf;
using ::testing::HasSubstr;

std::string repeated(const std::string& text, std::size_t count)
{
    std::string all;
    for (std::size_t i = 0; i < count; ++i)
        all += text;
    return all;
}

std::string chain(std::size_t length)
{
    std::string text = "class A0 {};\n";
    for (std::size_t i = 1; i < length; ++i)
        text += "class A" + std::to_string(i) + " : A" + std::to_string(i - 1) + " {};\n";
    return text;
}

TEST(LimitsTest, bracketsDoNotNest)
{
    for (const char* const bracket : {"{", "[", "(", "\"", "'", "/*", "class A {", "#pragma "})
        EXPECT_THAT(errorOf(repeated(bracket, 100'000)), HasSubstr("expected")) << bracket;
    EXPECT_THAT(errorOf("class A { uint8 P[] = " + repeated("{", 100'000)), HasSubstr("expected"));
}

TEST(LimitsTest, inheritanceIsDeepButNotBottomless)
{
    EXPECT_EQ(errorOf(chain(65)), "no error");
    EXPECT_EQ(errorOf(chain(66)), "test.mof:66:13: class A65 has more than 64 ancestors");
}

TEST(LimitsTest, manyClassesAndPropertiesAreNoTrouble)
{
    std::string text = "class Wide {";
    for (int i = 0; i < 50'000; ++i)
        text += "[Key]uint8 P" + std::to_string(i) + ";";
    text += "};";
    for (int i = 0; i < 20'000; ++i)
        text += "class A" + std::to_string(i) + "{uint8 P;};";
    const auto repository = compile(text);
    EXPECT_EQ(classNamed(*repository, "Wide").keys->size(), 50'000U);
    EXPECT_EQ(repository->findNamespace(Testing::NameSpace)->classes().size(), 20'001U);
}

TEST(LimitsTest, whatClassesInheritIsBounded)
{
    std::string text = "class Wide {";
    for (int i = 0; i < 10'000; ++i)
        text += "uint8 P" + std::to_string(i) + ";";
    text += "};\n";
    for (int i = 0; i < 300; ++i)
        text += "class A" + std::to_string(i) + " : Wide {};";
    EXPECT_EQ(errorOf(text), "test.mof:2:4097: the classes so far inherit too much in all");
}

TEST(LimitsTest, anElementCarriesManyQualifiersButNotAnyNumber)
{
    const auto qualified = [](int count) {
        std::string text;
        std::string uses;
        for (int i = 0; i < count; ++i) {
            text += "Qualifier Q" + std::to_string(i) + " : boolean, Scope(any);";
            uses += (i == 0 ? "Q" : ", Q") + std::to_string(i);
        }
        return text + "\n[" + uses + "]\nclass A {};";
    };
    EXPECT_EQ(errorOf(qualified(256)), "no error");
    EXPECT_THAT(errorOf(qualified(257)), HasSubstr("more than 256 qualifiers on one element"));
}

TEST(LimitsTest, longTextsAreReadWholeAndQuotedInPart)
{
    const std::string text = repeated("x", 1'000'000);
    EXPECT_EQ(Testing::defaultOf("string P", "\"" + text + "\""), Testing::constant(text));
    EXPECT_EQ(errorOf(text),
        "test.mof:1:1: expected #pragma, a qualifier declaration or a class, found \"" +
            repeated("x", 40) + "...\"");
}

} // namespace LimitsTests
