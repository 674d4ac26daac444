// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/SourceList.h"

#include "platform/instrumentation/machinefile/MachineFileSource.h"
#include "tests/platform/instrumentation/Walk.h"

#include <gmock/gmock.h>

namespace SourceListTests {

using Testing::errorOf;
using testing::HasSubstr;
using Vorn::parseSourceList;

TEST(SourceListTest, SplitsEntriesAtCommasAndArgumentsAtTheFirstColon)
{
    const auto entries = parseSourceList("hwmon,model:/srv/a:b.json");
    ASSERT_EQ(entries.size(), 2U);
    EXPECT_EQ(entries[0].text, "hwmon");
    EXPECT_EQ(entries[0].scheme, "hwmon");
    EXPECT_EQ(entries[0].argument, "");
    EXPECT_EQ(entries[1].text, "model:/srv/a:b.json");
    EXPECT_EQ(entries[1].scheme, "model");
    EXPECT_EQ(entries[1].argument, "/srv/a:b.json");
}

TEST(SourceListTest, TakesACommaAfterABackslashForPartOfTheName)
{
    const auto entries = parseSourceList(R"(model:/srv/a\,b\\c.json,hwmon)");
    ASSERT_EQ(entries.size(), 2U);
    EXPECT_EQ(entries[0].argument, R"(/srv/a,b\c.json)");
    EXPECT_EQ(entries[1].scheme, "hwmon");
}

TEST(SourceListTest, ReadsBackEveryFileName)
{
    for (const std::string name : {"/a.json", "/a,b", R"(/a\b)", R"(\,\)", "a:b", " "}) {
        const auto entries = parseSourceList(Vorn::formatSourceEntry("model", name));
        ASSERT_EQ(entries.size(), 1U) << name;
        EXPECT_EQ(entries[0].scheme, "model");
        EXPECT_EQ(entries[0].argument, name);
    }
}

TEST(SourceListTest, NamesAnEntryWithoutAName)
{
    for (const std::string list : {"", ",hwmon", "hwmon,", "hwmon,,model:x"})
        EXPECT_THAT(
            errorOf([&] { parseSourceList(list); }), HasSubstr("source \"\" in \"" + list + '"'));
    EXPECT_THAT(errorOf([] { parseSourceList("hwmon,:x"); }), HasSubstr("source \":x\""));
}

TEST(SourceListTest, NamesAnEntryThatEndsInALoneBackslash)
{
    EXPECT_THAT(errorOf([] { parseSourceList("model:x\\"); }), HasSubstr("\"model:x\\\""));
}

} // namespace SourceListTests
