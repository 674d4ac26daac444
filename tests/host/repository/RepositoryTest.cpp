// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The look-ups in a compiled repository.

#include "tests/host/repository/MofTest.h"

#include <gmock/gmock.h>

#include <atomic>
#include <thread>

namespace RepositoryTests {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Testing::testNameSpace;
using Depth = Host::Repository::Depth;

class RepositoryTest : public ::testing::Test {
protected:
    static std::vector<std::string> names(const std::vector<const Host::ClassDeclaration*>& classes)
    {
        std::vector<std::string> found;
        for (const auto* const each : classes)
            found.push_back(each->name);
        return found;
    }

    std::unique_ptr<const Host::Repository> repository_ = Testing::compile(R"(
        class Top { [Key] string Id; };
        class Left : Top { };
        class Right : Top { };
        class LeftOne : Left { };
        class LeftTwo : Left { };
        class Other { };
        [Association] class Link { [Key] Top ref One; [Key] Other ref Two; string Note; };)");
};

TEST_F(RepositoryTest, FindsClassesInAnyCaseAndSpellsThemAsDeclared)
{
    EXPECT_EQ(repository_->findClass("ROOT/TEST", "LEFTone")->name, "LeftOne");
    EXPECT_EQ(repository_->findClass("/root/test/", "LeftOne")->name, "LeftOne");
    EXPECT_EQ(repository_->findClass(testNameSpace, "Left One"), nullptr);
    EXPECT_EQ(repository_->findClass(testNameSpace, ""), nullptr);
    EXPECT_EQ(repository_->findClass("root/other", "Left"), nullptr);
    EXPECT_EQ(repository_->findQualifier(testNameSpace, "KEY")->name, "Key");
    EXPECT_EQ(repository_->findQualifier(testNameSpace, "Lock"), nullptr);
    EXPECT_EQ(repository_->findQualifier("", "Key"), nullptr);
    EXPECT_EQ(repository_->findNamespace(testNameSpace)->qualifiers().front()->name, "Abstract");
}

TEST_F(RepositoryTest, FindsNamesOfPropertiesOfAnyClass)
{
    EXPECT_EQ(*repository_->findPropertyName("ID"), "Id");
    EXPECT_EQ(*repository_->findPropertyName("note"), "Note");
    EXPECT_EQ(repository_->findPropertyName("Left"), nullptr);
}

TEST_F(RepositoryTest, ListsSubclassesDirectAndDeep)
{
    EXPECT_THAT(names(repository_->subclasses(testNameSpace, "top", Depth::direct)),
        ElementsAre("Left", "Right"));
    EXPECT_THAT(names(repository_->subclasses(testNameSpace, "Top", Depth::deep)),
        ElementsAre("Left", "LeftOne", "LeftTwo", "Right"));
    EXPECT_THAT(repository_->subclasses(testNameSpace, "LeftOne", Depth::deep), IsEmpty());
    EXPECT_THAT(repository_->subclasses(testNameSpace, "None", Depth::deep), IsEmpty());
    EXPECT_THAT(repository_->subclasses("root", "Top", Depth::deep), IsEmpty());
}

TEST_F(RepositoryTest, ListsTheRootsForNoClass)
{
    EXPECT_THAT(names(repository_->subclasses(testNameSpace, "", Depth::direct)),
        ElementsAre("Top", "Other", "Link"));
    EXPECT_THAT(names(repository_->subclasses(testNameSpace, "", Depth::deep)),
        ElementsAre("Top", "Left", "LeftOne", "LeftTwo", "Right", "Other", "Link"));
    EXPECT_THAT(repository_->subclasses("root", "", Depth::deep), IsEmpty());
}

TEST_F(RepositoryTest, FindsDescentAtAnyDistance)
{
    EXPECT_TRUE(repository_->isDerivedFrom(testNameSpace, "LeftOne", "TOP"));
    EXPECT_TRUE(repository_->isDerivedFrom(testNameSpace, "LeftOne", "Left"));
    EXPECT_FALSE(repository_->isDerivedFrom(testNameSpace, "LeftOne", "Right"));
    EXPECT_FALSE(repository_->isDerivedFrom(testNameSpace, "Top", "Top"));
    EXPECT_FALSE(repository_->isDerivedFrom(testNameSpace, "None", "Top"));
    EXPECT_FALSE(repository_->isDerivedFrom("root", "Left", "Top"));
}

TEST_F(RepositoryTest, ClassesTellDescentFromOneAnother)
{
    const auto& left = Testing::classNamed(*repository_, "Left");
    EXPECT_TRUE(Testing::classNamed(*repository_, "LeftOne").isDerivedFrom(left));
    EXPECT_FALSE(left.isDerivedFrom(left));
    EXPECT_FALSE(Testing::classNamed(*repository_, "Right").isDerivedFrom(left));
}

TEST_F(RepositoryTest, ListsReferencesOfAssociationsOnly)
{
    const auto references = repository_->referencesOf(testNameSpace, "LINK");
    ASSERT_EQ(references.size(), 2U);
    EXPECT_EQ(references[0].name, "One");
    EXPECT_EQ(references[0].className, "Top");
    EXPECT_EQ(references[1].className, "Other");
    EXPECT_THAT(repository_->referencesOf(testNameSpace, "Top"), IsEmpty());
    EXPECT_THAT(repository_->referencesOf(testNameSpace, "None"), IsEmpty());
}

TEST_F(RepositoryTest, KeysAreTheSameListAtEveryRequest)
{
    const auto* const keys = repository_->keysOf(testNameSpace, "Right");
    ASSERT_NE(keys, nullptr);
    EXPECT_THAT(*keys, ElementsAre("Id"));
    EXPECT_EQ(repository_->keysOf("Root/Test", "right"), keys);
    EXPECT_EQ(repository_->keysOf("root", "Right"), nullptr);
}

TEST_F(RepositoryTest, AnswersManyThreadsAtOnce)
{
    std::atomic<int> right = 0;
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&] {
            for (int round = 0; round < 500; ++round)
                right += repository_->isDerivedFrom(testNameSpace, "LeftTwo", "Top") &&
                         repository_->keysOf(testNameSpace, "LeftTwo")->size() == 1 &&
                         repository_->subclasses(testNameSpace, "Top", Depth::deep).size() == 4;
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(right, 2000);
}

} // namespace RepositoryTests
