// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Table.h"

#include "tools/output/Terminal.h"

#include <gtest/gtest.h>

namespace {

using namespace Tools;

Table sample()
{
    Table table({{"NAME"}, {"VALUE", Column::Alignment::right}, {"", Column::Alignment::left, 1},
        {"STATE"}});
    table.add({{"a rather long name"}, {"1.5"}, {"V"}, {"Normal"}});
    table.add({{"温度"}, {"1200"}, {"RPM"}, {"Critical", Emphasis::critical}});
    table.add({{"x"}, {"-", Emphasis::faint}, {""}, {""}});
    return table;
}

TEST(TableTest, ColumnsAreAsWideAsTheirWidestCell)
{
    EXPECT_EQ(sample().toText({unlimited, false, true}), "NAME                VALUE      STATE\n"
                                                         "a rather long name    1.5 V    Normal\n"
                                                         "温度                 1200 RPM  Critical\n"
                                                         "x                       -\n");
}

TEST(TableTest, FirstColumnGivesWay)
{
    EXPECT_EQ(sample().toText({34, false, true}), "NAME           VALUE      STATE\n"
                                                  "a rather lon…    1.5 V    Normal\n"
                                                  "温度            1200 RPM  Critical\n"
                                                  "x                  -\n");
}

TEST(TableTest, FirstColumnKeepsAFewCharactersHoweverNarrowTheLine)
{
    const std::string narrow = sample().toText({1, false, true});
    EXPECT_NE(narrow.find("\na rather lo…    1.5 V    Normal\n"), std::string::npos) << narrow;
}

TEST(TableTest, HeadingsIgnoreTheColumns)
{
    Table table({{"NAME"}, {"VALUE"}});
    table.addHeading({{"a heading that is longer"}});
    table.add({{"x"}, {"1"}});
    EXPECT_EQ(
        table.toText({unlimited, false, true}), "NAME  VALUE\na heading that is longer\nx     1\n");
    EXPECT_EQ(table.toText({11, false, false}), "NAME  VALUE\na heading ~\nx     1\n");
    EXPECT_EQ(table.width(unlimited), 11U);
    EXPECT_EQ(table.width(2), 9U);
}

TEST(TableTest, ColorsOnlyTheTextOfACell)
{
    const std::string colored = sample().toText({unlimited, true, true});
    EXPECT_NE(
        colored.find("\x1B[1mNAME\x1B[0m                \x1B[1mVALUE\x1B[0m"), std::string::npos);
    EXPECT_NE(colored.find("RPM  \x1B[1;31mCritical\x1B[0m\n"), std::string::npos);
    EXPECT_NE(colored.find("    \x1B[2m-\x1B[0m\n"), std::string::npos);
}

TEST(TableTest, WithoutRowsHasItsTitles)
{
    EXPECT_EQ(Table({{"A"}, {"B"}}).toText({unlimited, false, true}), "A  B\n");
}

} // namespace
