// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures the text of a scrape in processor time: of the first one, and of those that follow, in
// which only the readings are serialised.

#include "tools/metrics/HarvestMetrics.h"
#include "tools/serve/FreedMemory.h"

#include <benchmark/benchmark.h>

#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>

namespace {

// Returns sensors in the kinds of a server, each with four limits and three possible states.
Tools::Harvest machineOf(std::int64_t sensors)
{
    Tools::Harvest harvest;
    harvest.sources.emplace("hwmon", true);
    for (std::int64_t i = 0; i < sensors; ++i) {
        Tools::Sensor& sensor = harvest.sensors.emplace_back();
        const std::string number = std::to_string(i);
        sensor.setNames("Sensor " + number, "/hwmon/bench-isa-0290/temp" + number);
        sensor.kind = Tools::sensorKinds.at(static_cast<std::size_t>(i) % 3);
        sensor.reading = Tools::Quantity{41'000 + i, -3};
        for (const std::size_t limit : {0U, 1U, 3U, 4U})
            sensor.limits.at(limit) = Tools::Quantity{95'125, -3};
        sensor.possibleStates = {"Normal", "Warning", "Critical"};
        sensor.state = {"Normal", Tools::Urgency::normal};
        sensor.health = 5;
    }
    return harvest;
}

std::string textOf(
    const Tools::Harvest& harvest, Tools::SensorMetrics& sensors, std::size_t expectedSize = 0)
{
    Tools::Exposition exposition(Tools::ExpositionForm::text, expectedSize);
    addHarvest(exposition, harvest, sensors);
    return std::move(exposition).finish();
}

void FirstScrape(benchmark::State& state)
{
    Tools::keepFreedMemory(1); // as in the server
    const Tools::Harvest harvest = machineOf(state.range(0));
    for (auto _ : state) {
        Tools::SensorMetrics sensors(harvest.sensors.size());
        benchmark::DoNotOptimize(textOf(harvest, sensors));
    }
}
BENCHMARK(FirstScrape)->Arg(1000)->Unit(benchmark::kMillisecond);

void FollowingScrape(benchmark::State& state)
{
    Tools::keepFreedMemory(1);
    const Tools::Harvest harvest = machineOf(state.range(0));
    Tools::SensorMetrics sensors(harvest.sensors.size());
    const std::size_t size = textOf(harvest, sensors).size();
    for (auto _ : state)
        benchmark::DoNotOptimize(textOf(harvest, sensors, size));
}
BENCHMARK(FollowingScrape)->Arg(1000)->Unit(benchmark::kMillisecond);

} // namespace
