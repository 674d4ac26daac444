// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests on many threads, with the real providers.

#include "tests/host/operations/ShippedManager.h"

#include <atomic>
#include <future>
#include <thread>
#include <vector>

namespace OperationTests {

namespace {

constexpr int clients = 8;
constexpr int rounds = 10;

class OperationThreadsTest : public testing::Test {
protected:
    std::string ask(const std::string& operation, const std::string& parameters)
    {
        return answerTo(*manager_, callIn("root/cimv2", operation, parameters));
    }

    // Pulls all objects one by one. Returns their number.
    std::size_t pullAll()
    {
        const std::string one = valueOf("MaxObjectCount", "1");
        std::string answer =
            ask("OpenEnumerateInstances", classOf("ClassName", "CIM_ManagedElement") + one);
        std::size_t count = 0;
        for (;;) {
            EXPECT_EQ(errorIn(answer), "");
            count += countOf(answer, "<VALUE.INSTANCEWITHPATH>");
            if (isEndOfSequence(answer) || !errorIn(answer).empty())
                return count;
            answer = ask(
                "PullInstancesWithPath", valueOf("EnumerationContext", contextIn(answer)) + one);
        }
    }

    static void onThreads(const std::function<void()>& work)
    {
        std::vector<std::thread> threads;
        for (int i = 0; i < clients; ++i)
            threads.emplace_back([&work] {
                for (int round = 0; round < rounds; ++round)
                    work();
            });
        for (std::thread& thread : threads)
            thread.join();
    }

    ShippedManager manager_;
};

TEST_F(OperationThreadsTest, EverybodyGetsTheWholeAnswer)
{
    const std::string enumeration = classOf("ClassName", "CIM_ManagedElement");
    const std::string instances = ask("EnumerateInstances", enumeration);
    const std::string associations =
        ask("EnumerateInstances", classOf("ClassName", "CIM_Component"));
    EXPECT_EQ(countOf(instances, "<VALUE.NAMEDINSTANCE>"), 5U);
    EXPECT_EQ(countOf(associations, "<VALUE.NAMEDINSTANCE>"), 3U);
    std::atomic<int> wrong = 0;
    onThreads([&] {
        if (ask("EnumerateInstances", enumeration) != instances ||
            ask("EnumerateInstances", classOf("ClassName", "CIM_Component")) != associations ||
            pullAll() != 5)
            ++wrong;
    });
    EXPECT_EQ(wrong, 0);
}

TEST_F(OperationThreadsTest, PullsOfOneEnumerationShareItsObjects)
{
    onThreads([this] {
        const std::string context =
            contextIn(ask("OpenEnumerateInstances", classOf("ClassName", "CIM_NumericSensor")));
        const std::string pull = callIn("root/cimv2", "PullInstancesWithPath",
            valueOf("EnumerationContext", context) + valueOf("MaxObjectCount", "1"));
        const auto read = [&] { return answerTo(*manager_, pull); };
        auto first = std::async(std::launch::async, read);
        auto second = std::async(std::launch::async, read);
        auto third = std::async(std::launch::async, read);
        const std::string all = first.get() + second.get() + third.get();
        for (const char* const sensor : {"CPU:/board/temp1", "Fan:/board/fan1", "/board/in1"})
            EXPECT_EQ(countOf(all, std::string(sensor) + "</KEYVALUE>"), 1U) << sensor;
    });
}

TEST_F(OperationThreadsTest, ClassesAndTheManagerItselfAreAskedByAll)
{
    const auto classes = [this] {
        return ask("EnumerateClasses", valueOf("DeepInheritance", "TRUE"));
    };
    const auto profile = [this] {
        return answerTo(*manager_, callIn("root/interop", "EnumerateInstances",
                                       classOf("ClassName", "CIM_ManagedElement")));
    };
    const std::string allClasses = classes();
    const std::string itself = profile();
    EXPECT_EQ(countOf(itself, "<VALUE.NAMEDINSTANCE>"), 4U);
    std::atomic<int> wrong = 0;
    onThreads([&] {
        if (classes() != allClasses || profile() != itself)
            ++wrong;
    });
    EXPECT_EQ(wrong, 0);
}

} // namespace

} // namespace OperationTests
