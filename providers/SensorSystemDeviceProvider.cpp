// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The function tables and factories of the provider of ZUMLO_SensorSystemDevice.

#include "factory/ClassNames.h"
#include "providers/NotSupported.h"
#include "providers/SensorSystemDevice.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

const std::string loggerSenosrSystemDeviceProvider = "Nimbrel.SenosrSystemDeviceProvider";

} // namespace

constinit ModuleBroker SystemDevice::broker = nullptr;

AssociationClass SystemDevice::served()
{
    return {
        .module = {loggerSenosrSystemDeviceProvider, "SensorSystemDeviceProvider"},
        .provider = SensorSystemDeviceProvider,
        .name = SensorSystemDeviceClass,
        .isCap = false,
        .pair = [](const CMPIObjectPath* sensor, const CMPIObjectPath* other) -> References {
            return {referenceTo("GroupComponent", other), referenceTo("PartComponent", sensor)};
        },
    };
}

namespace {

constexpr auto SensorSystemDevice_Cleanup = cleanUpNothing;
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
    SystemDevice::broker = theBroker;
    return &mi;
}

extern "C" [[gnu::visibility("default")]] CMPIAssociationMI*
SensorSystemDeviceProvider_Create_AssociationMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIAssociationMI mi = {nullptr, &assocMIFT__};
    SystemDevice::broker = theBroker;
    return &mi;
}

} // namespace Vorn::SensorProfileProvider
