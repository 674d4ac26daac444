// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of ZUMLO_SensorEnabledLogicalElementCapabilities.

#include "providers/NotSupported.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

// Set by the factories; the handlers that will use it are not served yet.
[[maybe_unused]] const CMPIBroker* broker = nullptr;

[[maybe_unused]] const std::string loggerSensorEnabledLogicalElementCapabilitiesProvider =
    "Nimbrel.SensorEnabledLogicalElementCapabilitiesProvider";

constexpr auto SensorEnabledLogicalElementCapabilities_Cleanup = cleanUpNothing;
constexpr auto SensorEnabledLogicalElementCapabilities_EnumInstanceNames =
    enumerateNamesNotSupported;
constexpr auto SensorEnabledLogicalElementCapabilities_EnumInstances = readNotSupported;
constexpr auto SensorEnabledLogicalElementCapabilities_GetInstance = readNotSupported;
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
