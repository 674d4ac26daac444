// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of ZUMLO_NumericSensor.

#include "factory/ClassNames.h"
#include "providers/InstanceRequests.h"
#include "providers/NotSupported.h"
#include "providers/RequestHandler.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

constinit ModuleBroker broker = nullptr;

const std::string loggerSensorProvider = "Nimbrel.SensorProfileProvider";

RecordClass sensors()
{
    return {
        .module = {loggerSensorProvider, "SensorProvider"},
        .provider = SensorProfileProvider,
        .key = "DeviceID",
        .isCap = false,
        .paths = &SensorFactory::getAllSensorCMPIObjPaths,
        .instances = &SensorFactory::getAllSensorCMPIInstances,
        .one = &SensorFactory::getOneSensorCMPIInstance,
        .pathsFailed = "getAllSensorCMPIObjPaths failed",
        .instancesFailed = "getAllSensorCMPIInstances failed",
        .oneFailed = "getOneSensorCMPIInstance failed",
    };
}

} // namespace

CMPIStatus Sensor_EnumInstanceNames(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt, const CMPIObjectPath* ref)
{
    return enumerateInstanceNames(
        sensors(), broker, "Sensor_EnumInstanceNames", SensorLines::enumInstanceNames, rslt, ref);
}

CMPIStatus Sensor_EnumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt,
    const CMPIObjectPath* ref, const char** properties)
{
    return enumerateInstances(sensors(), broker, "Sensor_EnumInstances", SensorLines::enumInstances,
        rslt, ref, properties);
}

CMPIStatus Sensor_GetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt,
    const CMPIObjectPath* ref, const char** properties)
{
    return getInstance(
        sensors(), broker, "Sensor_GetInstance", SensorLines::getInstance, rslt, ref, properties);
}

namespace {

constexpr auto Sensor_Cleanup = cleanUpNothing;
constexpr auto Sensor_CreateInstance = createNotSupported;
constexpr auto Sensor_ModifyInstance = modifyNotSupported;
constexpr auto Sensor_DeleteInstance = deleteNotSupported;
constexpr auto Sensor_ExecQuery = queryNotSupported;

const CMPIInstanceMIFT instMIFT__ = {200, 200, "instanceSensorProfileProvider", Sensor_Cleanup,
    Sensor_EnumInstanceNames, Sensor_EnumInstances, Sensor_GetInstance, Sensor_CreateInstance,
    Sensor_ModifyInstance, Sensor_DeleteInstance, Sensor_ExecQuery};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI* SensorProfileProvider_Create_InstanceMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIInstanceMI mi = {nullptr, &instMIFT__};
    broker = theBroker;
    return &mi;
}

} // namespace Vorn::SensorProfileProvider
