// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/SingleFlight.h"
#include "tests/support/WaitUntil.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <future>
#include <stdexcept>
#include <thread>
#include <vector>

namespace {

using Tools::SingleFlight;

std::shared_ptr<const int> shared(int value)
{
    return std::make_shared<const int>(value);
}

TEST(SingleFlightTest, CallersOneAfterTheOtherGetResultsOfTheirOwn)
{
    int calls = 0;
    SingleFlight<int> flight([&] { return shared(++calls); });
    EXPECT_EQ(*flight.get(), 1);
    EXPECT_EQ(*flight.get(), 2);
}

// Has several callers ask while a call runs, which ends the time after they have begun. Returns how
// many calls there were in all.
int callsFor(int callers, std::chrono::milliseconds time)
{
    std::promise<void> goOn;
    const std::shared_future<void> signal = goOn.get_future().share();
    std::atomic<int> calls = 0;
    SingleFlight<int> flight([&] {
        const int call = ++calls;
        if (call == 1)
            signal.wait();
        return shared(call);
    });
    auto first = std::async(std::launch::async, [&] { return flight.get(); });
    EXPECT_TRUE(Testing::waitUntil([&] { return calls == 1; }));
    std::atomic<int> begun = 0;
    std::vector<std::future<std::shared_ptr<const int>>> others;
    for (int i = 0; i < callers; ++i)
        others.push_back(std::async(std::launch::async, [&] {
            ++begun;
            return flight.get();
        }));
    EXPECT_TRUE(Testing::waitUntil([&] { return begun == callers; }));
    std::this_thread::sleep_for(time);
    goOn.set_value();
    EXPECT_EQ(*first.get(), 1);
    for (auto& each : others)
        EXPECT_GE(*each.get(), 2); // none is older than its request
    return calls;
}

TEST(SingleFlightTest, ThoseWhoWaitShareTheNextResult)
{
    // A caller whose thread is slow to run has a call of its own.
    auto time = std::chrono::milliseconds(1);
    while (callsFor(8, time) > 2 && time < std::chrono::seconds(4))
        time *= 2;
    EXPECT_LT(time, std::chrono::seconds(4));
}

TEST(SingleFlightTest, FailureIsThrownAndNotKept)
{
    bool fails = true;
    SingleFlight<int> flight([&] {
        if (fails)
            throw std::runtime_error("broken");
        return shared(1);
    });
    EXPECT_THROW(flight.get(), std::runtime_error);
    fails = false;
    EXPECT_EQ(*flight.get(), 1);
}

TEST(SingleFlightTest, KeepsNoResult)
{
    SingleFlight<int> flight([] { return shared(1); });
    const std::weak_ptr<const int> result = flight.get();
    EXPECT_TRUE(result.expired());
}

} // namespace
