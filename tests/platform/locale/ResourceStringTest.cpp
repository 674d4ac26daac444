// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/ResourceString.h"
#include "platform/locale/FormatText.h"
#include "platform/locale/Locale.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tests/support/Environment.h"

#include <gtest/gtest.h>

#include <clocale>
#include <locale>

namespace ResourceStringTests {

using Testing::EnvironmentVariable;
using Vorn::Locale;
using Vorn::ResourceString;

// Returns the text that a request publishes in the language of the locale.
std::string published(const std::string& locale, const std::wstring& id, const std::string& name)
{
    const EnvironmentVariable language("LC_ALL", locale);
    const ResourceString text(Locale::getResourceLibrary(2, Locale::getLanguageId()), id);
    return Vorn::make_string(Vorn::formatText(text.text(), name, 512));
}

std::string caption(const std::string& locale)
{
    return published(locale, L"MSGID_SENSOR_CAPTION", "Lüfter セ");
}

std::string description(const std::string& locale)
{
    return published(locale, L"MSGID_SENSOR_DESCRIPTION", "Lüfter セ");
}

TEST(ResourceStringTest, CaptionsInEveryLanguageKeepAUtf8Name)
{
    EXPECT_EQ(caption("en"), "Sensor Lüfter セ");
    EXPECT_EQ(caption("de"), "Sensor Lüfter セ");
    EXPECT_EQ(caption("fr"), "Capteur Lüfter セ");
    EXPECT_EQ(caption("es"), "Sensor Lüfter セ");
    EXPECT_EQ(caption("ja"), "センサー Lüfter セ");
}

TEST(ResourceStringTest, DescriptionsInEveryLanguageKeepAUtf8Name)
{
    EXPECT_EQ(description("en"), "Numeric sensor Lüfter セ, read from this computer's hardware");
    EXPECT_EQ(description("de"),
        "Numerischer Sensor Lüfter セ, ausgelesen aus der Hardware dieses Computers");
    EXPECT_EQ(
        description("fr"), "Capteur numérique Lüfter セ, lu sur le matériel de cet ordinateur");
    EXPECT_EQ(description("es"), "Sensor numérico Lüfter セ, leído del hardware de este equipo");
    EXPECT_EQ(
        description("ja"), "このコンピューターのハードウェアから読み取る数値センサー Lüfter セ");
}

TEST(ResourceStringTest, TheFormOfTheLocaleNameDoesNotMatter)
{
    for (const std::string locale :
        {"fr", "fr_FR", "fr_FR.UTF-8", "fr_FR.ISO-8859-1", "fr_CA@euro"})
        EXPECT_EQ(caption(locale), "Capteur Lüfter セ") << locale;
}

TEST(ResourceStringTest, AnUnknownLanguageIsEnglish)
{
    for (const std::string locale : {"", "C", "POSIX", "C.UTF-8", "tlh_KX", ".UTF-8", "@euro",
             "../de", "de/..", "d e", "d\xC3\xA9", "de\n"})
        EXPECT_EQ(
            description(locale), "Numeric sensor Lüfter セ, read from this computer's hardware")
            << locale;
}

TEST(ResourceStringTest, AnUnknownComponentIsEnglish)
{
    const std::wstring id = L"MSGID_SENSOR_CAPTION";
    EXPECT_EQ(ResourceString(Locale::getResourceLibrary(3, "fr"), id).text(), L"Sensor %s");
    EXPECT_EQ(ResourceString(L"", id).text(), L"Sensor %s");
}

TEST(ResourceStringTest, AnUnknownMessageIsItsInsertAlone)
{
    for (const std::wstring id : {L"MSGID_UNKNOWN", L""})
        EXPECT_EQ(ResourceString(L"de/sensor-profile", id).text(), L"%s");
}

TEST(ResourceStringTest, TheProcessKeepsItsLocale)
{
    ASSERT_STREQ(std::setlocale(LC_ALL, nullptr), "C");
    ASSERT_EQ(std::locale().name(), "C");
    caption("ja_JP.UTF-8");
    EXPECT_STREQ(std::setlocale(LC_ALL, nullptr), "C");
    EXPECT_EQ(std::locale().name(), "C");
}

} // namespace ResourceStringTests
