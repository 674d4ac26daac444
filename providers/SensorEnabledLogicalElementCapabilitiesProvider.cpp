// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of ZUMLO_SensorEnabledLogicalElementCapabilities.

#include "factory/ClassNames.h"
#include "providers/InstanceRequests.h"
#include "providers/NotSupported.h"
#include "providers/RequestHandler.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

constinit ModuleBroker broker = nullptr;

const std::string loggerSensorEnabledLogicalElementCapabilitiesProvider =
    "Nimbrel.SensorEnabledLogicalElementCapabilitiesProvider";

RecordClass capabilities()
{
    return {
        .module = {loggerSensorEnabledLogicalElementCapabilitiesProvider,
            "SensorEnabledLogicalElementCapabilitiesProvider"},
        .provider = SensorEnabledLogicalElementCapabilitiesProvider,
        .key = "InstanceID",
        .isCap = true,
        .paths = &SensorFactory::getAllSensorEnabledLogicalElementCapCMPIObjPaths,
        .instances = &SensorFactory::getAllSensorEnabledLogicalElementCapCMPIInstances,
        .one = &SensorFactory::getOneSensorEnabledLogicalElementCapCMPIInstance,
        .pathsFailed = "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed",
        .instancesFailed = "getAllSensorEnabledLogicalElementCapCMPIInstances failed",
        .oneFailed = "getOneSensorEnabledLogicalElementCapCMPIInstance failed",
    };
}

} // namespace

CMPIStatus SensorEnabledLogicalElementCapabilities_EnumInstanceNames(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt, const CMPIObjectPath* ref)
{
    return enumerateInstanceNames(capabilities(), broker,
        "SensorEnabledLogicalElementCapabilities_EnumInstanceNames",
        CapabilitiesLines::enumInstanceNames, rslt, ref);
}

CMPIStatus SensorEnabledLogicalElementCapabilities_EnumInstances(CMPIInstanceMI*,
    const CMPIContext*, const CMPIResult* rslt, const CMPIObjectPath* ref, const char** properties)
{
    return enumerateInstances(capabilities(), broker,
        "SensorEnabledLogicalElementCapabilities_EnumInstances", CapabilitiesLines::enumInstances,
        rslt, ref, properties);
}

CMPIStatus SensorEnabledLogicalElementCapabilities_GetInstance(CMPIInstanceMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* ref, const char** properties)
{
    return getInstance(capabilities(), broker,
        "SensorEnabledLogicalElementCapabilities_GetInstance", CapabilitiesLines::getInstance, rslt,
        ref, properties);
}

namespace {

constexpr auto SensorEnabledLogicalElementCapabilities_Cleanup = cleanUpNothing;
constexpr auto SensorEnabledLogicalElementCapabilities_CreateInstance = createNotSupported;
constexpr auto SensorEnabledLogicalElementCapabilities_ModifyInstance = modifyNotSupported;
constexpr auto SensorEnabledLogicalElementCapabilities_DeleteInstance = deleteNotSupported;
constexpr auto SensorEnabledLogicalElementCapabilities_ExecQuery = queryNotSupported;

const CMPIInstanceMIFT instMIFT__ = {200, 200,
    "instanceSensorEnabledLogicalElementCapabilitiesProvider",
    SensorEnabledLogicalElementCapabilities_Cleanup,
    SensorEnabledLogicalElementCapabilities_EnumInstanceNames,
    SensorEnabledLogicalElementCapabilities_EnumInstances,
    SensorEnabledLogicalElementCapabilities_GetInstance,
    SensorEnabledLogicalElementCapabilities_CreateInstance,
    SensorEnabledLogicalElementCapabilities_ModifyInstance,
    SensorEnabledLogicalElementCapabilities_DeleteInstance,
    SensorEnabledLogicalElementCapabilities_ExecQuery};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI*
SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIInstanceMI mi = {nullptr, &instMIFT__};
    broker = theBroker;
    return &mi;
}

} // namespace Vorn::SensorProfileProvider
