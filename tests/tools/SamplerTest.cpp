// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// How often the sensors are read.

#include "tools/page/Sampler.h"
#include "tests/support/WaitUntil.h"
#include "tools/history/SensorHistory.h"
#include "tools/page/ChangeFeed.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

namespace SamplerTests {

using namespace Tools;

class SamplerTest : public testing::Test {
protected:
    static std::shared_ptr<const Harvest> makeHarvest()
    {
        Harvest harvest;
        harvest.sensors.emplace_back().setNames("a", "/chip/a");
        return std::make_shared<const Harvest>(std::move(harvest));
    }

    std::atomic<int> harvested{0};
    SingleFlight<Harvest> harvests{[this] {
        ++harvested;
        return makeHarvest();
    }};
    ChangeFeed feed;
};

TEST_F(SamplerTest, OneHarvestIsForAllStreams)
{
    const Sampler sampler(harvests, feed, nullptr);
    std::vector<std::unique_ptr<Host::Http::Stream>> streams;
    for (int i = 0; i < 100; ++i)
        streams.push_back(feed.subscribe());
    for (const auto& stream : streams)
        EXPECT_TRUE(stream->next()->starts_with("event: sensors\n"));
    std::this_thread::sleep_for(std::chrono::milliseconds(2500));
    EXPECT_GE(harvested, 2);
    EXPECT_LE(harvested, 3);
}

TEST_F(SamplerTest, WithoutStreamsAndHistoryNothingIsRead)
{
    const Sampler sampler(harvests, feed, nullptr);
    std::this_thread::sleep_for(std::chrono::milliseconds(100));
    EXPECT_EQ(harvested, 0);
}

TEST_F(SamplerTest, FirstSampleOfTheHistoryIsTakenAtOnce)
{
    SensorHistory history;
    const Sampler sampler(harvests, feed, &history);
    EXPECT_TRUE(Testing::waitUntil([&] { return history.newest() > 0; }));
    EXPECT_EQ(harvested, 1);
}

} // namespace SamplerTests
