// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/OpenEnumerations.h"

#include "host/broker/Arena.h"
#include "host/broker/Refusal.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <set>
#include <thread>

namespace {

using Host::ClassName;
using Host::EnumerationOwner;
using Host::FoundObjects;
using namespace std::chrono_literals;

const EnumerationOwner someOwner = {"somebody", "root/test", false};

std::string refusalOf(const std::function<void()>& operation)
{
    try {
        operation();
    } catch (const Host::Refusal& refusal) {
        return std::to_string(refusal.code()) + ": " + refusal.what();
    }
    return "none";
}

class OpenEnumerationsTest : public testing::Test {
protected:
    // Returns class names, which stand for objects of any kind.
    static FoundObjects objects(std::size_t count)
    {
        static const std::string digits = "0123456789";
        FoundObjects made;
        for (std::size_t i = 0; i < count; ++i)
            made.add(ClassName{std::string_view(digits).substr(i % 10, 1)});
        return made;
    }

    std::string open(std::size_t count, std::chrono::seconds timeout = 30s)
    {
        return enumerations_.open({someOwner, objects(count), {}, timeout});
    }

    // Returns the pulled objects, followed by a full stop at the end of the enumeration.
    std::string pull(
        const std::string& context, std::size_t count, EnumerationOwner owner = someOwner)
    {
        std::string text;
        const auto pulled = enumerations_.pull(context, owner, count);
        for (std::size_t i = 0; i < pulled.objects.size(); ++i)
            text += std::get<ClassName>(pulled.objects[i]).text;
        return text + (pulled.isOver ? "." : "");
    }

    bool isOpen(const std::string& context)
    {
        const std::string refusal = refusalOf([&] { pull(context, 0); });
        EXPECT_TRUE(refusal == "none" || refusal.starts_with("21: no such enumeration is open"));
        return refusal == "none";
    }

    Host::OperationLimits limits_{.maximumOpenEnumerations = 3, .maximumHeldObjects = 100};
    std::chrono::steady_clock::time_point now_;
    Host::OpenEnumerations enumerations_{limits_, [this] { return now_; }};
};

TEST_F(OpenEnumerationsTest, ObjectsComeInOrderUntilThereAreNoMore)
{
    const std::string context = open(5);
    EXPECT_EQ(pull(context, 2), "01");
    EXPECT_EQ(pull(context, 0), "");
    EXPECT_EQ(pull(context, 2), "23");
    EXPECT_EQ(pull(context, 2), "4.");
    EXPECT_FALSE(isOpen(context));
}

TEST_F(OpenEnumerationsTest, TheLastObjectsEndItEvenWhenNoMoreWereWanted)
{
    const std::string context = open(4);
    EXPECT_EQ(pull(context, 4), "0123.");
}

TEST_F(OpenEnumerationsTest, ContextsAre128BitsAndNeverTheSame)
{
    std::set<std::string> contexts;
    for (int i = 0; i < 1000; ++i) {
        const std::string context = open(1);
        EXPECT_EQ(context.size(), 32U);
        EXPECT_EQ(context.find_first_not_of("0123456789abcdef"), std::string::npos);
        contexts.insert(context);
        enumerations_.close(context, someOwner);
    }
    EXPECT_EQ(contexts.size(), 1000U);
}

TEST_F(OpenEnumerationsTest, NobodyElseGetsAnything)
{
    const std::string context = open(5);
    for (const EnumerationOwner& other :
        {EnumerationOwner{"", "root/test", false}, EnumerationOwner{"Somebody", "root/test", false},
            EnumerationOwner{"somebody", "root/other", false}}) {
        EXPECT_THAT(refusalOf([&] { pull(context, 1, other); }), testing::StartsWith("21: "));
        EXPECT_THAT(
            refusalOf([&] { enumerations_.close(context, other); }), testing::StartsWith("21: "));
    }
    EXPECT_EQ(pull(context, 5), "01234.");
}

TEST_F(OpenEnumerationsTest, PathsAreNotPulledFromInstances)
{
    const std::string context = open(5);
    EXPECT_THAT(refusalOf([&] {
        pull(context, 1, {"somebody", "root/test", true});
    }),
        testing::StartsWith("21: "));
    EXPECT_TRUE(isOpen(context));
    enumerations_.close(context, {"somebody", "root/test", true});
    EXPECT_FALSE(isOpen(context));
}

TEST_F(OpenEnumerationsTest, TheyHoldNoMoreThanTheLimit)
{
    const std::string first = open(60);
    EXPECT_EQ(
        refusalOf([&] { open(41); }), "27: open enumerations would hold more than 100 objects");
    open(40, 10s);
    pull(first, 59); // one object is left, and the memory of all
    EXPECT_THAT(refusalOf([&] { open(1); }), testing::StartsWith("27: "));
    pull(first, 1);
    open(60);
    EXPECT_THAT(refusalOf([&] { open(1); }), testing::StartsWith("27: "));
    now_ += 10s;
    open(40);
}

TEST_F(OpenEnumerationsTest, MemoryStaysWithWhatWasPulled)
{
    auto memory = std::make_shared<Host::Arena>();
    const std::weak_ptr<Host::Arena> watched = memory;
    FoundObjects made(std::move(memory));
    for (int i = 0; i < 4; ++i)
        made.add(ClassName{"x"});
    const std::string context = enumerations_.open({someOwner, std::move(made), {}, 10s});
    auto pulled = enumerations_.pull(context, someOwner, 1);
    enumerations_.close(context, someOwner);
    EXPECT_FALSE(watched.expired());
    pulled = {};
    EXPECT_TRUE(watched.expired());
}

TEST_F(OpenEnumerationsTest, MemoryGoesWithTheTime)
{
    auto memory = std::make_shared<Host::Arena>();
    const std::weak_ptr<Host::Arena> watched = memory;
    FoundObjects made(std::move(memory));
    made.add(ClassName{"x"});
    enumerations_.open({someOwner, std::move(made), {}, 10s});
    now_ += 9s;
    enumerations_.removeExpired();
    EXPECT_FALSE(watched.expired());
    now_ += 1s;
    enumerations_.removeExpired();
    EXPECT_TRUE(watched.expired());
}

TEST(OpenEnumerationsThreadsTest, EachObjectIsPulledOnce)
{
    constexpr std::size_t count = 4000;
    Host::OpenEnumerations enumerations({.maximumOpenEnumerations = 1000});
    FoundObjects made;
    for (std::size_t i = 0; i < count; ++i)
        made.add(ClassName{"x"});
    const std::string context = enumerations.open({someOwner, std::move(made), {}, 60s});
    std::atomic<std::size_t> pulled = 0;
    std::atomic<int> ends = 0;
    std::vector<std::thread> threads;
    for (int i = 0; i < 8; ++i)
        threads.emplace_back([&] {
            try {
                for (;;) {
                    const auto next = enumerations.pull(context, someOwner, 3);
                    pulled += next.objects.size();
                    ends += next.isOver ? 1 : 0;
                    // Other enumerations are opened and closed.
                    enumerations.close(
                        enumerations.open({someOwner, next.objects, {}, 60s}), someOwner);
                }
            } catch (const Host::Refusal& refusal) {
                EXPECT_EQ(static_cast<int>(refusal.code()), 21);
            }
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(pulled, count);
    EXPECT_EQ(ends, 1);
}

} // namespace
