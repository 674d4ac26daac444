// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/HarvestMetrics.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

namespace Tools {

namespace {

constexpr MetricFamily duration{"sensor_profile_harvest_duration_seconds",
    "Time that the harvest of these sensors took.", MetricFamily::Type::gauge, "seconds"};
constexpr MetricFamily counts{"sensor_profile_sensors", "Number of sensors of the kind."};
constexpr MetricFamily sources{"sensor_profile_source_up",
    "1 when the source could be read and no sensor of it is missing, else 0."};
constexpr MetricFamily held{"sensor_profile_held_objects",
    "Objects in the memory of the enumerations that CIM clients have open."};
constexpr MetricFamily responses{"sensor_profile_responses_total",
    "HTTP responses, by their status code.", MetricFamily::Type::counter};
constexpr MetricFamily build{"sensor_profile_build_info", "Version of sensorctl; always 1."};

} // namespace

void addHarvest(Exposition& exposition, const Harvest& harvest, SensorMetrics& sensors)
{
    sensors.addTo(exposition, harvest.sensors);
    exposition.add(duration, {{{}, harvest.duration.count()}});
    std::vector<Series> kinds;
    kinds.reserve(sensorKinds.size());
    for (const std::string_view kind : sensorKinds)
        kinds.push_back({Labels().add("kind", kind),
            static_cast<double>(std::ranges::count(harvest.sensors, kind, &Sensor::kind))});
    exposition.add(counts, kinds);
    std::vector<Series> states;
    for (const auto& [source, isUp] : harvest.sources)
        states.push_back({Labels().add("source", source), isUp ? 1.0 : 0.0});
    exposition.add(sources, states);
    exposition.add(build, {{Labels().add("version", SENSOR_PROFILE_VERSION), 1}});
}

void addResponses(Exposition& exposition, const Host::Http::ResponseCounts& answered)
{
    std::vector<Series> series;
    for (const auto& [status, count] : answered.get())
        series.push_back(
            {Labels().add("code", std::to_string(status)), static_cast<double>(count)});
    exposition.add(responses, series);
}

void addHeldObjects(Exposition& exposition, std::size_t objects)
{
    exposition.add(held, {{{}, static_cast<double>(objects)}});
}

} // namespace Tools
