// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Harvest.h"

#include "platform/instrumentation/hwmon/Catalogue.h"
#include "tests/support/Environment.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <map>
#include <string>

namespace HarvestTests {

using Tools::Sensors;
using Tools::statesOfSources;
using States = std::map<std::string, bool>;

TEST(StatesOfSourcesTest, SourceIsDownWhenAnyOfItsSensorsIsMissing)
{
    const Testing::TemporaryFolder folder;
    const auto fileOf = [&](const std::string& name) {
        std::string nodes;
        for (const std::string type : {"temperature", "voltage", "tachometer"})
            for (const std::string number : {"1", "2"})
                nodes += (nodes.empty() ? "" : ",") + (R"({"type": ")" + type) +
                         R"(", "description": "A", "path": "/)" + name + "/" + type + number +
                         "\"}";
        return folder.write(name, R"({"nodes": [)" + nodes + "]}");
    };
    const std::string one = fileOf("one");
    const std::string other = fileOf("other");
    const Testing::EnvironmentVariable sources(
        "VORN_INSTRUMENTATION", "model:" + one + ",model:" + other);
    Sensors all = Tools::sensorsInFile(one);
    ASSERT_EQ(all.size(), 6U);
    for (const Tools::Sensor& sensor : Tools::sensorsInFile(other))
        all.push_back(sensor);
    EXPECT_EQ(
        statesOfSources(all, nullptr), (States{{"model:" + one, true}, {"model:" + other, true}}));
    for (std::size_t i = 0; i < all.size(); ++i) {
        Sensors rest = all;
        rest.erase(rest.begin() + static_cast<std::ptrdiff_t>(i));
        EXPECT_EQ(statesOfSources(rest, nullptr),
            (States{{"model:" + one, i >= 6}, {"model:" + other, i < 6}}))
            << all[i].deviceId;
    }
}

TEST(StatesOfSourcesTest, ChipsAreDownWhenAnyOfTheirSensorsIsMissing)
{
    const Testing::EnvironmentVariable sources("VORN_INSTRUMENTATION", "hwmon");
    Vorn::Hwmon::Catalogue chips;
    Sensors all;
    for (const std::string name : {"fan1", "temp1"}) {
        chips.features.emplace_back();
        chips.features.back().node.path = "/hwmon/chip/" + name;
        chips.features.back().node.description = name;
        all.emplace_back().setNames(name, chips.features.back().node.path);
    }
    EXPECT_EQ(statesOfSources(all, &chips), (States{{"hwmon", true}}));
    EXPECT_EQ(statesOfSources(all, nullptr), (States{{"hwmon", false}}));
    EXPECT_EQ(statesOfSources(Sensors{all.front()}, &chips), (States{{"hwmon", false}}));
    EXPECT_EQ(statesOfSources(Sensors{all.back()}, &chips), (States{{"hwmon", false}}));
}

} // namespace HarvestTests
