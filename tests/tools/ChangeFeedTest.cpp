// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The events that browsers receive.

#include "tools/page/ChangeFeed.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <thread>

namespace ChangeFeedTests {

using namespace Tools;
using nlohmann::json;

Sensor sensorOf(const std::string& label, std::int64_t reading)
{
    Sensor sensor;
    sensor.setNames(label, "/chip/" + label);
    sensor.reading = Quantity{reading, 0};
    return sensor;
}

struct Event {
    std::string name;
    json data;
};

class ChangeFeedTest : public testing::Test {
protected:
    void publish(
        const std::vector<Sensor>& sensors, const std::vector<std::string>& lostSources = {})
    {
        std::vector<const Sensor*> pointers;
        for (const Sensor& each : sensors)
            pointers.push_back(&each);
        feed.publish(pointers, lostSources, 1000);
    }

    static Event next(Host::Http::Stream& stream)
    {
        const auto text = stream.next();
        if (!text)
            return {};
        const std::size_t line = text->find('\n');
        EXPECT_TRUE(text->ends_with("\n\n"));
        EXPECT_EQ(std::count(text->begin(), text->end(), '\n'), 3);
        return {text->substr(7, line - 7), json::parse(text->substr(line + 7))};
    }

    ChangeFeed feed;
};

TEST_F(ChangeFeedTest, BeginsWithTheListAndContinuesWithChanges)
{
    const auto stream = feed.subscribe();
    publish({sensorOf("a", 1), sensorOf("b", 1)});
    publish({sensorOf("a", 1), sensorOf("b", 1)});
    publish({sensorOf("b", 2), sensorOf("c", 3)});
    const Event list = next(*stream);
    EXPECT_EQ(list.name, "sensors");
    ASSERT_EQ(list.data.size(), 2U);
    EXPECT_EQ(list.data[0]["label"], "a");
    EXPECT_EQ(next(*stream).data, json({{"lost", json::array()}}));
    const Event changes = next(*stream);
    EXPECT_EQ(changes.name, "changes");
    EXPECT_EQ(changes.data["time"], 1000);
    EXPECT_EQ(changes.data["gone"], json::array({"a:/chip/a"}));
    ASSERT_EQ(changes.data["sensors"].size(), 2U);
    EXPECT_EQ(changes.data["sensors"][0]["value"], 2);
    EXPECT_EQ(changes.data["sensors"][1]["label"], "c");
}

TEST_F(ChangeFeedTest, NewStreamGetsAListThatIsNewAtOnce)
{
    const auto first = feed.subscribe();
    publish({sensorOf("a", 1)});
    publish({sensorOf("a", 2)});
    const auto second = feed.subscribe();
    EXPECT_EQ(next(*second).data[0]["value"], 2);
    EXPECT_EQ(next(*second).name, "sources");
    publish({sensorOf("a", 3)});
    EXPECT_EQ(next(*second).data["sensors"][0]["value"], 3);
}

TEST_F(ChangeFeedTest, LostSourcesAreSentWhenTheyChange)
{
    const auto stream = feed.subscribe();
    const json lost = {{"lost", {"hwmon", "model:/a"}}};
    for (int i = 0; i < 2; ++i)
        publish({}, {"hwmon", "model:/a"});
    const auto second = feed.subscribe();
    publish({});
    for (Host::Http::Stream* const each : {stream.get(), second.get()}) {
        EXPECT_EQ(next(*each).name, "sensors");
        const Event sources = next(*each);
        EXPECT_EQ(sources.name, "sources");
        EXPECT_EQ(sources.data, lost);
        EXPECT_EQ(next(*each).data, json({{"lost", json::array()}}));
    }
}

TEST_F(ChangeFeedTest, NewStreamEndsTheWaitOfWhoPublishes)
{
    const auto begin = ChangeFeed::Clock::now();
    std::jthread subscriber([&] { (void)feed.subscribe(); });
    feed.waitUntil(begin + std::chrono::seconds(20), {});
    EXPECT_LT(ChangeFeed::Clock::now(), begin + std::chrono::seconds(10));
    feed.waitUntil(begin, {});
}

TEST_F(ChangeFeedTest, EventsAreSharedByAllStreams)
{
    const auto first = feed.subscribe();
    const auto second = feed.subscribe();
    publish({sensorOf("a", 1)});
    publish({sensorOf("a", 2)});
    for (const char* const name : {"sensors", "sources", "changes"}) {
        const auto event = first->next();
        EXPECT_EQ(event, second->next());
        EXPECT_TRUE(event->starts_with(std::string("event: ") + name + "\n"));
    }
}

TEST_F(ChangeFeedTest, StreamThatIsNotReadEnds)
{
    const auto stream = feed.subscribe();
    for (int i = 0; i < 20; ++i)
        publish({sensorOf("a", i)});
    EXPECT_EQ(stream->next(), nullptr);
    EXPECT_TRUE(feed.hasSubscribers());
}

TEST_F(ChangeFeedTest, HeartbeatsFollowWhileTheSensorsAreRead)
{
    ChangeFeed quick(std::chrono::milliseconds(200));
    const auto stream = quick.subscribe();
    quick.publish({}, {}, 1000);
    EXPECT_EQ(next(*stream).name, "sensors");
    EXPECT_EQ(next(*stream).name, "sources");
    std::jthread publisher([&] {
        for (int i = 0; i < 6; ++i) {
            std::this_thread::sleep_for(std::chrono::milliseconds(50));
            quick.publish({}, {}, 1000);
        }
    });
    const Event heartbeat = next(*stream);
    EXPECT_EQ(heartbeat.name, "alive");
    EXPECT_GT(heartbeat.data["time"], 1'000'000'000);
    publisher.join();
    while (const auto more = stream->next())
        EXPECT_TRUE(more->starts_with("event: alive"));
}

TEST_F(ChangeFeedTest, EndEndsTheWaitForAnEvent)
{
    const auto stream = feed.subscribe();
    std::jthread ending([&] { stream->end(); });
    EXPECT_EQ(stream->next(), nullptr);
}

TEST_F(ChangeFeedTest, DestroyedStreamIsNoSubscriber)
{
    EXPECT_FALSE(feed.hasSubscribers());
    auto stream = feed.subscribe();
    EXPECT_TRUE(feed.hasSubscribers());
    stream.reset();
    EXPECT_FALSE(feed.hasSubscribers());
    publish({sensorOf("a", 1)});
}

} // namespace ChangeFeedTests
