// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A history to which tests add samples.

#pragma once

#include "tools/history/HistoryJson.h"
#include "tools/history/SensorHistory.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <ctime>
#include <optional>
#include <string>
#include <vector>

namespace SensorHistoryTests {

using namespace Tools;
using nlohmann::json;

// The beginning of a minute.
constexpr std::time_t start = 1'800'000'000;

inline Sensor sensorOf(const std::string& label, std::optional<std::int64_t> reading,
    const std::string& state = "Normal")
{
    Sensor sensor;
    sensor.setNames(label, "/chip/" + label);
    if (reading)
        sensor.reading = Quantity{*reading, 0};
    sensor.state = stateOf(state, {});
    return sensor;
}

class SensorHistoryTest : public testing::Test {
protected:
    // Adds samples at that many seconds after the start.
    void add(const std::vector<Sensor>& sensors, std::time_t seconds)
    {
        std::vector<const Sensor*> pointers;
        for (const Sensor& each : sensors)
            pointers.push_back(&each);
        history.add(pointers, std::chrono::system_clock::from_time_t(start + seconds));
    }

    template <typename Append>
    static json jsonOf(const SensorHistory& from, const std::string& label, Append append)
    {
        std::string text;
        const bool isKnown = from.visit({label + ":/chip/" + label},
            [&](const std::string&, const Samples& samples, SlotNumber newest) {
                append(text, label, samples, newest);
            });
        return isKnown ? json::parse(text) : json();
    }
    json hour(const std::string& label) const
    {
        return jsonOf(history, label, [](auto&&... all) { appendHour(all...); });
    }
    json thinnedHour(const std::string& label) const
    {
        return jsonOf(history, label, [](auto&&... all) { appendThinnedHour(all...); });
    }
    static json dayIn(const SensorHistory& from, const std::string& label)
    {
        return jsonOf(from, label, [](auto&&... all) { appendDay(all...); });
    }
    json day(const std::string& label) const { return dayIn(history, label); }

    static json last(const json& values, std::size_t count)
    {
        return json(
            std::vector<json>(values.end() - static_cast<std::ptrdiff_t>(count), values.end()));
    }

    SensorHistory history;
};

} // namespace SensorHistoryTests
