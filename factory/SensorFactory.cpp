// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/SensorFactory.h"
#include "factory/TraceLines.h"

#include "model/SensorHarvest.h"

#include <cstdint>

namespace Vorn::SensorProfileProvider {

const std::string loggerSensorFactory = "Nimbrel.SensorFactory";

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
    const auto count = static_cast<std::uint16_t>(vectSensor.size());
    sensorMap = SensorIndex({vectSensor.data(), count});
    traced.exiting();
}

void SensorFactory::_createEnabledLogicalElementCapMap()
{
    const TracedOperation traced(factoryModule(), "_createEnabledLogicalElementCapMap");
    traced.entering();
    const auto count = static_cast<std::uint16_t>(vectSensorEnabledLogCap.size());
    for (std::uint16_t i = 0; i < count; ++i) {
        SensorEnabledLogCap& capabilities = vectSensorEnabledLogCap[i];
        sensorEnabledLogCapMap.insert_or_assign(capabilities.getInstanceID(), capabilities);
    }
    traced.exiting();
}

} // namespace Vorn::SensorProfileProvider
