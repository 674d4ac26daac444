// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/Locale.h"
#include "platform/locale/CatalogName.h"
#include "tests/support/Environment.h"

#include <gtest/gtest.h>

namespace LocaleTests {

using Testing::EnvironmentVariable;
using Vorn::CatalogName;
using Vorn::Locale;

std::string languageOf(
    const std::string& all, const std::string& messages, const std::string& language)
{
    const EnvironmentVariable allVariable("LC_ALL", all);
    const EnvironmentVariable messagesVariable("LC_MESSAGES", messages);
    const EnvironmentVariable languageVariable("LANG", language);
    return Locale::getLanguageId();
}

TEST(Language, TheFirstVariableThatIsSetWins)
{
    EXPECT_EQ(languageOf("de", "fr", "es"), "de");
    EXPECT_EQ(languageOf("", "fr", "es"), "fr");
    EXPECT_EQ(languageOf("", "", "es"), "es");
    EXPECT_EQ(languageOf("C", "fr", "es"), "en");
}

TEST(Language, IsEnglishWhenNoneIsSet)
{
    EXPECT_EQ(languageOf("", "", ""), "en");
    const EnvironmentVariable all("LC_ALL", ""), messages("LC_MESSAGES", ""), language("LANG", "");
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"})
        ::unsetenv(variable);
    EXPECT_EQ(Locale::getLanguageId(), "en");
}

TEST(Language, OtherVariablesAreNotConsulted)
{
    const EnvironmentVariable list("LANGUAGE", "ja:fr"), numbers("LC_NUMERIC", "fr_FR.UTF-8");
    EXPECT_EQ(languageOf("de_DE.UTF-8", "", ""), "de_DE");
}

TEST(Language, LosesItsEncodingAndModifier)
{
    EXPECT_EQ(languageOf("de_DE.UTF-8", "", ""), "de_DE");
    EXPECT_EQ(languageOf("de_DE@euro", "", ""), "de_DE");
    EXPECT_EQ(languageOf("de_DE.ISO-8859-15@euro", "", ""), "de_DE");
    EXPECT_EQ(languageOf("ja_JP.eucJP", "", ""), "ja_JP");
}

TEST(Language, OfTheStandardLocalesIsEnglish)
{
    for (const std::string name : {"C", "POSIX", "C.UTF-8", "POSIX.UTF-8"})
        EXPECT_EQ(languageOf(name, "", ""), "en") << name;
}

TEST(Language, WhatIsNoLanguageNameIsEnglish)
{
    for (const std::string name :
        {"../../etc/x", "/tmp/de", "de/..", ".UTF-8", "@euro", "d e", "d\xC3\xA9", "de\n"})
        EXPECT_EQ(languageOf(name, "", ""), "en") << name;
    EXPECT_EQ(languageOf(std::string(65, 'x'), "", ""), "en");
}

TEST(ResourceLibrary, NamesLanguageAndDomain)
{
    EXPECT_EQ(Locale::getResourceLibrary(2, "de_AT"), L"de_AT/sensor-profile");
}

TEST(ResourceLibrary, OfAnotherComponentIsAnother)
{
    EXPECT_NE(Locale::getResourceLibrary(1, "de"), Locale::getResourceLibrary(2, "de"));
    EXPECT_NE(Locale::getResourceLibrary(1, "de"), Locale::getResourceLibrary(3, "de"));
}

TEST(CatalogName, IsSplitIntoWhatItWasMadeOf)
{
    const auto name = CatalogName::split(Locale::getResourceLibrary(2, "de_AT"));
    ASSERT_TRUE(name);
    EXPECT_EQ(name->language, "de_AT");
    EXPECT_EQ(name->domain, "sensor-profile");
}

TEST(CatalogName, CannotLeadOutOfTheFolder)
{
    for (const std::wstring name : {L"", L"/", L"de", L"de/", L"/sensor-profile", L"../x", L"de/..",
             L"de/../x", L"de/a/b", L"de/a.b", L"d\u00E9/x"})
        EXPECT_FALSE(CatalogName::split(name)) << testing::PrintToString(name);
}

} // namespace LocaleTests
