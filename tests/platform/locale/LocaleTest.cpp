// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/Locale.h"
#include "tests/support/Environment.h"

#include <gtest/gtest.h>

namespace LocaleTests {

using Testing::EnvironmentVariable;
using Vorn::Locale;

std::string languageOf(
    const std::string& all, const std::string& messages, const std::string& language)
{
    const EnvironmentVariable allVariable("LC_ALL", all);
    const EnvironmentVariable messagesVariable("LC_MESSAGES", messages);
    const EnvironmentVariable languageVariable("LANG", language);
    return Locale::getLanguageId();
}

TEST(LanguageTest, TheFirstVariableThatIsSetWins)
{
    EXPECT_EQ(languageOf("de", "fr", "es"), "de");
    EXPECT_EQ(languageOf("", "fr", "es"), "fr");
    EXPECT_EQ(languageOf("", "", "es"), "es");
    EXPECT_EQ(languageOf("C", "fr", "es"), "en");
}

TEST(LanguageTest, IsEnglishWhenNoneIsSet)
{
    EXPECT_EQ(languageOf("", "", ""), "en");
    const EnvironmentVariable all("LC_ALL", ""), messages("LC_MESSAGES", ""), language("LANG", "");
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"})
        ::unsetenv(variable);
    EXPECT_EQ(Locale::getLanguageId(), "en");
}

TEST(LanguageTest, OtherVariablesAreNotConsulted)
{
    const EnvironmentVariable list("LANGUAGE", "ja:fr"), numbers("LC_NUMERIC", "fr_FR.UTF-8");
    EXPECT_EQ(languageOf("de_DE.UTF-8", "", ""), "de_DE");
}

TEST(LanguageTest, LosesItsEncodingAndModifier)
{
    EXPECT_EQ(languageOf("de_DE.UTF-8", "", ""), "de_DE");
    EXPECT_EQ(languageOf("de_DE@euro", "", ""), "de_DE");
    EXPECT_EQ(languageOf("de_DE.ISO-8859-15@euro", "", ""), "de_DE");
    EXPECT_EQ(languageOf("ja_JP.eucJP", "", ""), "ja_JP");
}

TEST(LanguageTest, OfTheStandardLocalesIsEnglish)
{
    for (const std::string name : {"C", "POSIX", "C.UTF-8", "POSIX.UTF-8"})
        EXPECT_EQ(languageOf(name, "", ""), "en") << name;
}

TEST(ResourceLibraryTest, NamesLanguageAndComponent)
{
    EXPECT_EQ(Locale::getResourceLibrary(2, "de_AT"), L"de_AT/sensor-profile");
}

TEST(ResourceLibraryTest, OfAnotherComponentIsAnother)
{
    EXPECT_NE(Locale::getResourceLibrary(1, "de"), Locale::getResourceLibrary(2, "de"));
    EXPECT_NE(Locale::getResourceLibrary(1, "de"), Locale::getResourceLibrary(3, "de"));
}

} // namespace LocaleTests
