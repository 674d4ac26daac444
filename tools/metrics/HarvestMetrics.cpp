// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/HarvestMetrics.h"

#include "tools/metrics/SensorMetrics.h"

#include <algorithm>

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

void addHarvest(Exposition& exposition, const Harvest& harvest)
{
    addSensors(exposition, harvest.sensors);
    exposition.begin(duration);
    exposition.add({}, harvest.duration.count());
    exposition.begin(counts);
    for (const std::string_view kind : sensorKinds)
        exposition.add(Labels().add("kind", kind),
            static_cast<double>(std::ranges::count(harvest.sensors, kind, &Sensor::kind)));
    exposition.begin(sources);
    for (const auto& [source, isUp] : harvest.sources)
        exposition.add(Labels().add("source", source), isUp ? 1 : 0);
    exposition.begin(build);
    exposition.add(Labels().add("version", SENSOR_PROFILE_VERSION), 1);
}

void addResponses(Exposition& exposition, const Host::Http::ResponseCounts& answered)
{
    exposition.begin(responses);
    for (const auto& [status, count] : answered.get())
        exposition.add(Labels().add("code", std::to_string(status)), static_cast<double>(count));
}

void addHeldObjects(Exposition& exposition, std::size_t objects)
{
    exposition.begin(held);
    exposition.add({}, static_cast<double>(objects));
}

} // namespace Tools
