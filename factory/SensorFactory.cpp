// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/SensorFactory.h"

#include "factory/FactoryModule.h"
#include "model/SensorHarvest.h"

#include <cstdint>

namespace Vorn::SensorProfileProvider {

const std::string loggerSensorFactory = "Nimbrel.SensorFactory";

namespace {

// A map holds a copy of the last record of each key. The count is cut to 16 bits.
template <typename Record>
void indexRecords(const std::vector<Record>& records, std::map<std::string, Record>& byKey,
    std::string (*keyOf)(Record&))
{
    const auto count = static_cast<std::uint16_t>(records.size());
    for (std::uint16_t i = 0; i < count; ++i) {
        Record record = records[i];
        std::string key = keyOf(record);
        byKey[std::move(key)] = std::move(record);
    }
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
    const PlainTracedOperation traced(factoryModule(), "getNumberOfInstances");
    traced.entering();
    const auto count = static_cast<unsigned short>(sensorMap.size());
    traced.exiting();
    return count;
}

void SensorFactory::_createSensorMap()
{
    const PlainTracedOperation traced(factoryModule(), "_createSensorMap");
    traced.entering();
    indexRecords<Sensor>(
        vectSensor, sensorMap, [](Sensor& sensor) { return sensor.getDeviceID(); });
    traced.exiting();
}

void SensorFactory::_createEnabledLogicalElementCapMap()
{
    const PlainTracedOperation traced(factoryModule(), "_createEnabledLogicalElementCapMap");
    traced.entering();
    indexRecords<SensorEnabledLogCap>(vectSensorEnabledLogCap, sensorEnabledLogCapMap,
        [](SensorEnabledLogCap& capabilities) { return capabilities.getInstanceID(); });
    traced.exiting();
}

} // namespace Vorn::SensorProfileProvider
