// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/SingleFlight.h"
#include "tests/support/WaitUntil.h"

#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <stdexcept>
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

TEST(SingleFlightTest, ThoseWhoWaitShareTheNextResult)
{
    constexpr int waiting = 8;
    std::promise<void> goOn;
    const std::shared_future<void> signal = goOn.get_future().share();
    std::atomic<int> calls = 0;
    SingleFlight<int> flight([&] {
        const int call = ++calls;
        if (call == 1)
            signal.wait();
        return shared(call);
    });
    const auto get = [&] { return flight.get(); };
    auto first = std::async(std::launch::async, get);
    ASSERT_TRUE(Testing::waitUntil([&] { return calls == 1; }));
    std::atomic<int> begun = 0;
    std::vector<std::future<std::shared_ptr<const int>>> others;
    for (int i = 0; i < waiting; ++i)
        others.push_back(std::async(std::launch::async, [&] {
            ++begun;
            return flight.get();
        }));
    ASSERT_TRUE(Testing::waitUntil([&] { return begun == waiting; }));
    std::this_thread::sleep_for(std::chrono::milliseconds(50)); // until all of them wait
    goOn.set_value();
    EXPECT_EQ(*first.get(), 1);
    const auto result = others.front().get();
    EXPECT_EQ(*result, 2);
    for (int i = 1; i < waiting; ++i)
        EXPECT_EQ(others[static_cast<std::size_t>(i)].get(), result);
    EXPECT_EQ(calls, 2);
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
