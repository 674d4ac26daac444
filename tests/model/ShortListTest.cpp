// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/ShortList.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

// Of which two lie in the list itself.
using List = Vorn::SensorProfileProvider::ShortList<int, 2>;

List listOf(int count)
{
    List list;
    for (int element = 1; element <= count; ++element)
        list.append(element);
    return list;
}

std::vector<int> elementsOf(const List& list)
{
    return list.as<int>();
}

TEST(ShortList, givesItsElementsInOrderBeyondTheUsualOnesToo)
{
    EXPECT_THAT(elementsOf(List()), IsEmpty());
    EXPECT_THAT(elementsOf(listOf(1)), ElementsAre(1));
    EXPECT_THAT(elementsOf(listOf(2)), ElementsAre(1, 2));
    EXPECT_THAT(elementsOf(listOf(3)), ElementsAre(1, 2, 3));
    EXPECT_THAT(elementsOf(listOf(5)), ElementsAre(1, 2, 3, 4, 5));
}

TEST(ShortList, convertsItsElements)
{
    Vorn::SensorProfileProvider::ShortList<const char*, 1> texts;
    texts.append("one");
    texts.append("two");
    EXPECT_THAT(texts.as<std::string>(), ElementsAre("one", "two"));
}

TEST(ShortList, aCopyIsItsOwn)
{
    List list = listOf(3);
    const List copy = list;
    list.append(4);
    EXPECT_THAT(elementsOf(copy), ElementsAre(1, 2, 3));
    EXPECT_THAT(elementsOf(list), ElementsAre(1, 2, 3, 4));
}

TEST(ShortList, clearedItIsEmptyAndGrowsAgain)
{
    for (const int count : {0, 1, 2, 3}) {
        List list = listOf(count);
        list.clear();
        EXPECT_THAT(elementsOf(list), IsEmpty()) << count;
        for (const int element : {7, 8, 9})
            list.append(element);
        EXPECT_THAT(elementsOf(list), ElementsAre(7, 8, 9)) << count;
    }
}

TEST(ShortList, aMoveTakesAllElements)
{
    for (const int count : {1, 2, 3, 5}) {
        List from = listOf(count);
        const List to = std::move(from);
        EXPECT_EQ(elementsOf(to), elementsOf(listOf(count)));
        List assigned = listOf(4);
        assigned = listOf(count);
        EXPECT_EQ(elementsOf(assigned), elementsOf(listOf(count)));
    }
}

TEST(ShortList, aListThatWasMovedFromCanBeUsed)
{
    List from = listOf(5);
    const List to = std::move(from);
    EXPECT_LE(elementsOf(from).size(), 5U); // NOLINT(bugprone-use-after-move)
    from.append(9);
    EXPECT_EQ(elementsOf(from).back(), 9);
    from.clear();
    from.append(6);
    EXPECT_THAT(elementsOf(from), ElementsAre(6));
    EXPECT_THAT(elementsOf(to), ElementsAre(1, 2, 3, 4, 5));
}

} // namespace
