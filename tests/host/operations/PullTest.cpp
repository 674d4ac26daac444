// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Messages that open, pull and close enumerations.

#include "tests/host/operations/ScriptedManager.h"
#include "tests/support/CountingMemory.h"

namespace OperationTests {

namespace {

using namespace std::chrono_literals;
using testing::StartsWith;

constexpr std::string_view instanceElement = "<VALUE.INSTANCEWITHPATH>";

class PullTest : public testing::Test {
protected:
    PullTest() { manager_.deliverThings(5); }

    std::string ask(
        const std::string& operation, const std::string& parameters, const Caller& caller = {})
    {
        return answerTo(*manager_, call(operation, parameters), caller);
    }
    std::string open(unsigned count, const std::string& more = {}, const Caller& caller = {})
    {
        return ask("OpenEnumerateInstances",
            classOf("ClassName", "Thing") + valueOf("MaxObjectCount", std::to_string(count)) + more,
            caller);
    }
    std::string pull(const std::string& context, unsigned count, const Caller& caller = {})
    {
        return ask("PullInstancesWithPath",
            valueOf("EnumerationContext", context) +
                valueOf("MaxObjectCount", std::to_string(count)),
            caller);
    }

    Testing::CountingMemory memory_;
    ScriptedManager manager_{
        {.maximumOpenEnumerations = 2, .maximumHeldObjects = 12, .maximumObjectCount = 3}};
};

TEST_F(PullTest, WhatComesAtOnceStaysNotOpen)
{
    manager_.deliverThings(2);
    for (int i = 0; i < 10; ++i) {
        const std::string answer = open(3);
        EXPECT_EQ(errorIn(answer), "");
        EXPECT_EQ(countOf(answer, instanceElement), 2U);
        EXPECT_TRUE(isEndOfSequence(answer));
        EXPECT_EQ(contextIn(answer), "");
    }
}

TEST_F(PullTest, AnEmptyEnumerationEndsWhenItIsOpened)
{
    manager_.deliverThings(0);
    EXPECT_TRUE(isEndOfSequence(open(0)));
}

TEST_F(PullTest, AnAnswerHasNoMoreObjectsThanTheLimit)
{
    const std::string first = open(100);
    EXPECT_EQ(countOf(first, instanceElement), 3U);
    EXPECT_FALSE(isEndOfSequence(first));
    const std::string second = pull(contextIn(first), 4'000'000'000U);
    EXPECT_EQ(countOf(second, instanceElement), 2U);
    EXPECT_TRUE(isEndOfSequence(second));
}

TEST_F(PullTest, TheSelectionIsThatOfTheOpening)
{
    const std::string first =
        open(1, parameter("PropertyList", "<VALUE.ARRAY><VALUE>Index</VALUE></VALUE.ARRAY>") +
                    valueOf("IncludeClassOrigin", "TRUE"));
    const std::string second = pull(contextIn(first), 1);
    for (const std::string& answer : {first, second})
        EXPECT_EQ(between(answer, "<INSTANCE CLASSNAME=\"Thing\">", "</INSTANCE>"),
            "<PROPERTY NAME=\"Index\" TYPE=\"uint16\" CLASSORIGIN=\"Thing\"><VALUE>7</VALUE>"
            "</PROPERTY>");
}

TEST_F(PullTest, OnlyWhoOpenedItMayPull)
{
    const std::string context = contextIn(open(0, {}, {"anna", "a"}));
    EXPECT_THAT(errorIn(pull(context, 1, {"bert", "a"})), StartsWith("21"));
    EXPECT_THAT(errorIn(pull(context, 1)), StartsWith("21"));
    // The client's address does not matter.
    EXPECT_EQ(errorIn(pull(context, 1, {"anna", "b"})), "");
}

TEST_F(PullTest, ItIsOpenAsLongAsWasAskedFor)
{
    const std::string context = contextIn(open(0, valueOf("OperationTimeout", "600")));
    manager_.wait(599s);
    EXPECT_EQ(errorIn(pull(context, 0)), "");
    manager_.wait(600s);
    EXPECT_THAT(errorIn(pull(context, 0)), StartsWith("21"));
}

TEST_F(PullTest, WithoutATimeItIsTheDefault)
{
    const std::string context = contextIn(open(0));
    manager_.wait(59s);
    EXPECT_EQ(errorIn(pull(context, 0)), "");
    manager_.wait(60s);
    EXPECT_THAT(errorIn(pull(context, 0)), StartsWith("21"));
}

TEST_F(PullTest, AnyOperationGivesBackTheMemoryWhenTheTimeIsOver)
{
    const std::size_t before = memory_.taken();
    open(0);
    EXPECT_GT(memory_.taken(), before);
    manager_.wait(59s);
    ask("EnumerateClassNames", "");
    EXPECT_GT(memory_.taken(), before);
    manager_.wait(1s);
    ask("EnumerateClassNames", "");
    EXPECT_EQ(memory_.taken(), before);
}

TEST_F(PullTest, BadTimesAreRefusedBeforeAnythingIsEnumerated)
{
    manager_.script("Things", [](const ProviderCall&) {
        ADD_FAILURE() << "was asked";
        return ok;
    });
    for (const char* const time : {"0", "601", "4294967295"})
        EXPECT_THAT(errorIn(open(0, valueOf("OperationTimeout", time))),
            StartsWith("22: parameter OperationTimeout: must be from 1 to 600 seconds"));
    EXPECT_THAT(errorIn(open(0, valueOf("FilterQuery", "x"))), StartsWith("25"));
    EXPECT_THAT(errorIn(open(0, valueOf("FilterQueryLanguage", "x"))), StartsWith("25"));
    EXPECT_THAT(errorIn(open(0, valueOf("ContinueOnError", "TRUE"))), StartsWith("26"));
}

TEST_F(PullTest, TooManyAreRefused)
{
    const std::string context = contextIn(open(1));
    EXPECT_EQ(errorIn(open(1)), "");
    EXPECT_EQ(errorIn(open(1)), "27: there are 2 open enumerations already");
    const std::string toClose = valueOf("EnumerationContext", context);
    EXPECT_EQ(errorIn(ask("CloseEnumeration", toClose)), "");
    EXPECT_THAT(errorIn(ask("CloseEnumeration", toClose)), StartsWith("21"));
    EXPECT_EQ(errorIn(open(1)), "");
    EXPECT_THAT(errorIn(open(1)), StartsWith("27"));
    manager_.wait(60s); // they time out
    EXPECT_EQ(errorIn(open(1)), "");
}

TEST_F(PullTest, TooLargeOnesAreRefused)
{
    manager_.deliverThings(13);
    EXPECT_EQ(errorIn(open(1)), "27: open enumerations would hold more than 12 objects");
}

TEST_F(PullTest, WhatWasPulledIsReadWhenTheRestIsGone)
{
    const std::string context = contextIn(open(1));
    const auto pulled = (*manager_).answer(
        Message(call("PullInstancesWithPath",
            valueOf("EnumerationContext", context) + valueOf("MaxObjectCount", "3"))),
        {});
    ask("CloseEnumeration", valueOf("EnumerationContext", context));
    EXPECT_THAT(errorIn(pull(context, 1)), StartsWith("21"));
    const std::string answer = textOf(*pulled);
    EXPECT_EQ(countOf(answer, instanceElement), 3U);
    EXPECT_EQ(contextIn(answer), context);
}

} // namespace

} // namespace OperationTests
