// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance and association provider of ZUMLO_SensorSystemDevice.

#include "providers/NotSupported.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

// Set by the factories; the handlers that will use it are not served yet.
[[maybe_unused]] const CMPIBroker* broker = nullptr;

[[maybe_unused]] const std::string loggerSenosrSystemDeviceProvider =
    "Nimbrel.SenosrSystemDeviceProvider";

constexpr auto SensorSystemDevice_Cleanup = cleanUpNothing;
constexpr auto SensorSystemDevice_EnumInstanceNames = enumerateNamesNotSupported;
constexpr auto SensorSystemDevice_EnumInstances = readNotSupported;
constexpr auto SensorSystemDevice_GetInstance = readNotSupported;
constexpr auto SensorSystemDevice_CreateInstance = createNotSupported;
constexpr auto SensorSystemDevice_ModifyInstance = modifyNotSupported;
constexpr auto SensorSystemDevice_DeleteInstance = deleteNotSupported;
constexpr auto SensorSystemDevice_ExecQuery = queryNotSupported;

const CMPIInstanceMIFT instMIFT__ = {200, 200, "instanceSensorSystemDeviceProvider",
    SensorSystemDevice_Cleanup, SensorSystemDevice_EnumInstanceNames,
    SensorSystemDevice_EnumInstances, SensorSystemDevice_GetInstance,
    SensorSystemDevice_CreateInstance, SensorSystemDevice_ModifyInstance,
    SensorSystemDevice_DeleteInstance, SensorSystemDevice_ExecQuery};

constexpr auto SensorSystemDevice_AssociationCleanup = cleanUpNoAssociation;
constexpr auto SensorSystemDevice_Associators = associatorsNotSupported;
constexpr auto SensorSystemDevice_AssociatorNames = associatorNamesNotSupported;
constexpr auto SensorSystemDevice_References = referencesNotSupported;
constexpr auto SensorSystemDevice_ReferenceNames = referenceNamesNotSupported;

const CMPIAssociationMIFT assocMIFT__ = {200, 200, "associationSensorSystemDeviceProvider",
    SensorSystemDevice_AssociationCleanup, SensorSystemDevice_Associators,
    SensorSystemDevice_AssociatorNames, SensorSystemDevice_References,
    SensorSystemDevice_ReferenceNames};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI*
SensorSystemDeviceProvider_Create_InstanceMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIInstanceMI mi = {nullptr, &instMIFT__};
    broker = theBroker;
    return &mi;
}

extern "C" [[gnu::visibility("default")]] CMPIAssociationMI*
SensorSystemDeviceProvider_Create_AssociationMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIAssociationMI mi = {nullptr, &assocMIFT__};
    broker = theBroker;
    return &mi;
}

} // namespace Vorn::SensorProfileProvider
