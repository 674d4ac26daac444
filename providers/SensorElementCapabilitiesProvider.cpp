// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The function tables and factories of the provider of ZUMLO_SensorElementCapabilities.

#include "factory/ClassNames.h"
#include "providers/NotSupported.h"
#include "providers/SensorElementCapabilities.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

const std::string loggerSensorElementCapabilities = "Nimbrel.SensorElementCapabilities";

} // namespace

constinit ModuleBroker ElementCapabilities::broker = nullptr;

AssociationClass ElementCapabilities::served()
{
    return {
        .module = {loggerSensorElementCapabilities, "SensorElementCapabilitiesProvider"},
        .provider = SensorElementCapabilitiesProvider,
        .name = SensorElementCapabilitiesClass,
        .isCap = true,
        .pair = [](const CMPIObjectPath* sensor, const CMPIObjectPath* other) -> References {
            return {referenceTo("ManagedElement", sensor), referenceTo("Capabilities", other)};
        },
    };
}

namespace {

constexpr auto SensorElementCapabilities_Cleanup = cleanUpNothing;
constexpr auto SensorElementCapabilities_CreateInstance = createNotSupported;
constexpr auto SensorElementCapabilities_ModifyInstance = modifyNotSupported;
constexpr auto SensorElementCapabilities_DeleteInstance = deleteNotSupported;
constexpr auto SensorElementCapabilities_ExecQuery = queryNotSupported;

const CMPIInstanceMIFT instMIFT__ = {200, 200, "instanceSensorElementCapabilitiesProvider",
    SensorElementCapabilities_Cleanup, SensorElementCapabilities_EnumInstanceNames,
    SensorElementCapabilities_EnumInstances, SensorElementCapabilities_GetInstance,
    SensorElementCapabilities_CreateInstance, SensorElementCapabilities_ModifyInstance,
    SensorElementCapabilities_DeleteInstance, SensorElementCapabilities_ExecQuery};

constexpr auto SensorElementCapabilities_AssociationCleanup = cleanUpNoAssociation;

const CMPIAssociationMIFT assocMIFT__ = {200, 200, "associationSensorElementCapabilitiesProvider",
    SensorElementCapabilities_AssociationCleanup, SensorElementCapabilities_Associators,
    SensorElementCapabilities_AssociatorNames, SensorElementCapabilities_References,
    SensorElementCapabilities_ReferenceNames};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI*
SensorElementCapabilitiesProvider_Create_InstanceMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIInstanceMI mi = {nullptr, &instMIFT__};
    ElementCapabilities::broker = theBroker;
    return &mi;
}

extern "C" [[gnu::visibility("default")]] CMPIAssociationMI*
SensorElementCapabilitiesProvider_Create_AssociationMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIAssociationMI mi = {nullptr, &assocMIFT__};
    ElementCapabilities::broker = theBroker;
    return &mi;
}

} // namespace Vorn::SensorProfileProvider
