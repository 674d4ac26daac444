// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Catalogs from any hand: whatever they hold, the text is fit to be a format.

#include "platform/locale/MessageCatalogs.h"
#include "platform/locale/MessageFile.h"
#include "platform/locale/TextFormat.h"
#include "tests/platform/locale/CatalogFile.h"

#include <gtest/gtest.h>

#include <sys/stat.h>

#include <thread>
#include <vector>

namespace MessageCatalogsTests {

using Testing::CatalogRoot;
using Testing::messageFile;
using Vorn::MessageCatalogs;

const std::wstring caption = L"MSGID_SENSOR_CAPTION";
const std::wstring english = L"Sensor %s";

// The caption that a catalog for "xx" with these bytes leads to.
std::wstring captionFrom(const std::string& bytes, const CatalogRoot& root = CatalogRoot())
{
    root.write("xx", bytes);
    return MessageCatalogs({root.path()}).text(L"xx/sensor-profile", caption);
}

std::wstring captionOf(const std::string& text)
{
    return captionFrom(messageFile({{"MSGID_SENSOR_CAPTION", text}}));
}

TEST(MessageCatalogs, GiveTheTextOfTheCatalog)
{
    EXPECT_EQ(captionOf("Capteur %s"), L"Capteur %s");
    EXPECT_EQ(captionOf("\xE3\x82\xBB\xE3\x83\xB3 %s 100%%"), L"\u30BB\u30F3 %s 100%%");
}

TEST(MessageCatalogs, ATextThatIsNoSafeFormatIsReplacedByTheEnglishOne)
{
    for (const std::string text :
        {"%n", "%s%n", "%s%s", "%d", "%5s", "no insert", "%s %", "%%s", "%1$s", "%ls", "%.*s", ""})
        EXPECT_EQ(captionOf(text), english) << text;
}

TEST(MessageCatalogs, AMissingTextIsReplacedByTheEnglishOne)
{
    const std::string other = messageFile({{"MSGID_OTHER", "Other %s"}});
    EXPECT_EQ(captionFrom(other), english);
}

TEST(MessageCatalogs, AMissingCatalogGivesEnglish)
{
    const CatalogRoot root;
    MessageCatalogs catalogs({root.path(), "/nowhere"});
    EXPECT_EQ(catalogs.text(L"xx/sensor-profile", caption), english);
    EXPECT_EQ(catalogs.text(L"xx/component-7", caption), english);
    EXPECT_EQ(MessageCatalogs({}).text(L"xx/sensor-profile", caption), english);
}

TEST(MessageCatalogs, AnUnknownMessageIsItsInsertAlone)
{
    EXPECT_EQ(MessageCatalogs({}).text(L"xx/sensor-profile", L"MSGID_UNKNOWN"), L"%s");
    EXPECT_EQ(MessageCatalogs({}).text(L"xx/sensor-profile", L""), L"%s");
}

TEST(MessageCatalogs, TheHeaderIsNoText)
{
    const CatalogRoot root;
    root.write("xx", messageFile({}, "%s Content-Type: text/plain; charset=UTF-8\n"));
    EXPECT_EQ(MessageCatalogs({root.path()}).text(L"xx/sensor-profile", L""), L"%s");
}

TEST(MessageCatalogs, ACountryFallsBackToItsLanguage)
{
    const CatalogRoot root;
    root.write("de", messageFile({{"MSGID_SENSOR_CAPTION", "de %s"}}));
    root.write("de_CH", messageFile({{"MSGID_SENSOR_CAPTION", "de_CH %s"}}));
    MessageCatalogs catalogs({root.path()});
    EXPECT_EQ(catalogs.text(L"de_AT/sensor-profile", caption), L"de %s");
    EXPECT_EQ(catalogs.text(L"de_CH/sensor-profile", caption), L"de_CH %s");
}

TEST(MessageCatalogs, ADamagedCatalogGivesWayToTheNextFolder)
{
    const CatalogRoot first, second;
    first.write("xx", "damaged");
    second.write("xx", messageFile({{"MSGID_SENSOR_CAPTION", "second %s"}}));
    MessageCatalogs catalogs({first.path(), second.path()});
    EXPECT_EQ(catalogs.text(L"xx/sensor-profile", caption), L"second %s");
}

TEST(MessageCatalogs, NamesCannotLeadOutOfTheFolder)
{
    const CatalogRoot root;
    root.write("xx", messageFile({{"MSGID_SENSOR_CAPTION", "found %s"}}));
    MessageCatalogs catalogs({root.path() + "/sub"});
    EXPECT_EQ(catalogs.text(L"../xx/sensor-profile", caption), english);
}

TEST(MessageCatalogs, ACatalogIsLoadedOnce)
{
    const CatalogRoot root;
    root.write("xx", messageFile({{"MSGID_SENSOR_CAPTION", "first %s"}}));
    MessageCatalogs catalogs({root.path()});
    EXPECT_EQ(catalogs.text(L"xx/sensor-profile", caption), L"first %s");
    root.write("xx", messageFile({{"MSGID_SENSOR_CAPTION", "second %s"}}));
    EXPECT_EQ(catalogs.text(L"xx/sensor-profile", caption), L"first %s");
}

TEST(MessageCatalogs, GoOnWorkingAfterManyNames)
{
    const CatalogRoot root;
    root.write("xx", messageFile({{"MSGID_SENSOR_CAPTION", "found %s"}}));
    MessageCatalogs catalogs({root.path()});
    for (int i = 0; i < 200; ++i)
        EXPECT_EQ(catalogs.text(std::to_wstring(i) + L"/sensor-profile", caption), english);
    EXPECT_EQ(catalogs.text(L"xx/sensor-profile", caption), L"found %s");
}

TEST(MessageCatalogs, ServeManyThreads)
{
    const CatalogRoot root;
    root.write("xx", messageFile({{"MSGID_SENSOR_CAPTION", "found %s"}}));
    MessageCatalogs catalogs({root.path()});
    std::vector<int> found(8);
    {
        std::vector<std::jthread> threads;
        for (int& count : found)
            threads.emplace_back([&] {
                for (int i = 0; i < 200; ++i) {
                    const std::wstring other = std::to_wstring(i) + L"/sensor-profile";
                    const bool right = catalogs.text(other, caption) == english &&
                                       catalogs.text(L"xx/sensor-profile", caption) == L"found %s";
                    count += right ? 1 : 0;
                }
            });
    }
    EXPECT_EQ(found, std::vector<int>(8, 200));
}

TEST(MessageFile, CutOffAnywhereIsNeverTrusted)
{
    const std::string whole = messageFile({{"MSGID_SENSOR_CAPTION", "whole %s"}});
    const CatalogRoot root;
    EXPECT_EQ(captionFrom(whole, root), L"whole %s");
    for (std::size_t size = 0; size < whole.size(); ++size)
        EXPECT_EQ(captionFrom(whole.substr(0, size), root), english) << size;
}

TEST(MessageFile, WithAnyByteChangedStillGivesASafeText)
{
    const std::string whole = messageFile({{"MSGID_SENSOR_CAPTION", "whole %s"}},
        "Content-Type: text/plain; charset=UTF-8\nPlural-Forms: nplurals=2; plural=(n!=1);\n");
    const CatalogRoot root;
    for (std::size_t place = 0; place < whole.size(); ++place)
        for (const char change : {'\x00', '\x01', '\x7F', '\xFF', '%'}) {
            std::string damaged = whole;
            damaged[place] = change;
            EXPECT_TRUE(Vorn::hasOneInsert(captionFrom(damaged, root))) << place;
        }
}

TEST(MessageFile, WithAnotherEncodingIsNotUsed)
{
    const std::string latin = messageFile(
        {{"MSGID_SENSOR_CAPTION", "L\xFC %s"}}, "Content-Type: text/plain; charset=ISO-8859-1\n");
    EXPECT_EQ(captionFrom(latin), english);
}

TEST(MessageFile, WithTextThatIsNotUtf8StillGivesASafeText)
{
    EXPECT_TRUE(Vorn::hasOneInsert(captionOf("L\xFC %s")));
    EXPECT_TRUE(Vorn::hasOneInsert(captionOf("%s \xE3\x82")));
}

TEST(MessageFile, WithADeepPluralFormulaDoesNoHarm)
{
    const auto withBrackets = [](std::size_t depth) {
        const std::string formula = std::string(depth, '(') + "n" + std::string(depth, ')');
        return captionFrom(messageFile({{"MSGID_SENSOR_CAPTION", "whole %s"}},
            "Content-Type: text/plain; charset=UTF-8\nPlural-Forms: nplurals=2; plural=" + formula +
                ";\n"));
    };
    EXPECT_EQ(withBrackets(900), L"whole %s");
    EXPECT_EQ(withBrackets(100'000), english);
}

TEST(MessageFile, TooLargeOrNoFileAtAllIsEmpty)
{
    const Testing::TemporaryFolder folder;
    const std::string pipe = (folder.path() / "pipe").string();
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_TRUE(Vorn::readMessageFile(pipe).empty());
    EXPECT_TRUE(Vorn::readMessageFile(folder.path().string()).empty());
    EXPECT_TRUE(Vorn::readMessageFile("/nowhere/at/all").empty());
    const std::string text = messageFile({{"a", std::string(2'000'000, 'x')}});
    EXPECT_TRUE(Vorn::readMessageFile(folder.write("large", text)).empty());
}

} // namespace MessageCatalogsTests
