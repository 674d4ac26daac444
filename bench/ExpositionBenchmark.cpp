// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures the text of a scrape in processor time, and that of the same series by the serializer of
// prometheus-cpp, where this is installed. Its series are made beforehand, ours each time.

#include "tests/tools/Scrape.h"
#include "tools/metrics/HarvestMetrics.h"

#include <benchmark/benchmark.h>

#if SENSOR_PROFILE_PROMETHEUS_CPP
#include <prometheus/metric_family.h>
#include <prometheus/text_serializer.h>
#endif

#include <cstdint>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

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

std::string textOf(const Tools::Harvest& harvest)
{
    Tools::Exposition exposition(Tools::ExpositionForm::text);
    addHarvest(exposition, harvest);
    return std::move(exposition).finish();
}

void Exposition(benchmark::State& state)
{
    const Tools::Harvest harvest = machineOf(state.range(0));
    for (auto _ : state)
        benchmark::DoNotOptimize(textOf(harvest));
}
BENCHMARK(Exposition)->Arg(1000)->Unit(benchmark::kMillisecond);

#if SENSOR_PROFILE_PROMETHEUS_CPP
std::vector<prometheus::MetricFamily> familiesIn(const std::string& text)
{
    std::vector<prometheus::MetricFamily> families;
    for (const Testing::Series& each : Testing::seriesIn(text)) {
        if (families.empty() || families.back().name != each.name)
            families.push_back({each.name, "A help.", prometheus::MetricType::Gauge, {}});
        prometheus::ClientMetric& metric = families.back().metric.emplace_back();
        for (const auto& [name, value] : each.labels)
            metric.label.push_back({name, value});
        metric.gauge.value = each.value;
    }
    return families;
}

void PrometheusCpp(benchmark::State& state)
{
    const std::string ours = textOf(machineOf(state.range(0)));
    const auto families = familiesIn(ours);
    const prometheus::TextSerializer serializer;
    if (Testing::seriesIn(serializer.Serialize(families)).size() != Testing::seriesIn(ours).size())
        throw std::runtime_error("the texts have different series");
    for (auto _ : state)
        benchmark::DoNotOptimize(serializer.Serialize(families));
}
BENCHMARK(PrometheusCpp)->Arg(1000)->Unit(benchmark::kMillisecond);
#endif

} // namespace
