// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/SensorFactory.h"
#include "factory/TraceLines.h"

#include "model/SensorHarvest.h"

#include <algorithm>
#include <cstdint>
#include <utility>

namespace Vorn::SensorProfileProvider {

const std::string loggerSensorFactory = "Nimbrel.SensorFactory";

namespace {

// Moves the records into a map, where the last one of a key replaces the others. The count is
// truncated to 16 bits. Records are inserted in the order of their keys, so that iteration reads
// memory in order; in harvest order, every step over ten thousand records misses the cache.
template <typename Record, typename KeyOf>
void indexRecords(std::vector<Record>& records, std::map<std::string, Record>& byKey, KeyOf keyOf)
{
    const auto count = static_cast<std::uint16_t>(records.size());
    std::vector<std::pair<std::string, Record*>> ordered;
    ordered.reserve(count);
    for (std::uint16_t i = 0; i < count; ++i)
        ordered.emplace_back(keyOf(records[i]), &records[i]);
    std::stable_sort(ordered.begin(), ordered.end(),
        [](const auto& one, const auto& other) { return one.first < other.first; });
    for (auto& [key, record] : ordered)
        byKey.insert_or_assign(byKey.end(), std::move(key), std::move(*record));
}

} // namespace

SensorFactory::SensorFactory(bool isSen, bool isCap)
{
    const TracedOperation traced(factoryModule(), "SensorFactory",
        [&] { return parameterList(" isSen=", isSen, " isCap=", isCap); });
    traced.entering();
    if (isSen && !getSensorInstances(vectSensor))
        _createSensorMap();
    if (isCap && !getSensorEnabledLogCapInstances(vectSensorEnabledLogCap))
        _createEnabledLogicalElementCapMap();
    traced.exiting();
}

unsigned short SensorFactory::getNumberOfInstances()
{
    const TracedOperation traced(factoryModule(), "getNumberOfInstances");
    traced.entering();
    const auto count = static_cast<unsigned short>(sensorMap.size());
    traced.exiting();
    return count;
}

void SensorFactory::_createSensorMap()
{
    const TracedOperation traced(factoryModule(), "_createSensorMap");
    traced.entering();
    indexRecords(vectSensor, sensorMap, [](const Sensor& sensor) { return sensor.getDeviceID(); });
    traced.exiting();
}

void SensorFactory::_createEnabledLogicalElementCapMap()
{
    const TracedOperation traced(factoryModule(), "_createEnabledLogicalElementCapMap");
    traced.entering();
    indexRecords(vectSensorEnabledLogCap, sensorEnabledLogCapMap,
        [](SensorEnabledLogCap capabilities) { return capabilities.getInstanceID(); });
    traced.exiting();
}

} // namespace Vorn::SensorProfileProvider
