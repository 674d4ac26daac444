// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance and association provider of ZUMLO_SensorElementCapabilities.

#include "providers/NotSupported.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

// Set by the factories; the handlers that will use it are not served yet.
[[maybe_unused]] const CMPIBroker* broker = nullptr;

[[maybe_unused]] const std::string loggerSensorElementCapabilities =
    "Nimbrel.SensorElementCapabilities";

constexpr auto SensorElementCapabilities_Cleanup = cleanUpNothing;
constexpr auto SensorElementCapabilities_EnumInstanceNames = enumerateNamesNotSupported;
constexpr auto SensorElementCapabilities_EnumInstances = readNotSupported;
constexpr auto SensorElementCapabilities_GetInstance = readNotSupported;
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
constexpr auto SensorElementCapabilities_Associators = associatorsNotSupported;
constexpr auto SensorElementCapabilities_AssociatorNames = associatorNamesNotSupported;
constexpr auto SensorElementCapabilities_References = referencesNotSupported;
constexpr auto SensorElementCapabilities_ReferenceNames = referenceNamesNotSupported;

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
    broker = theBroker;
    return &mi;
}

extern "C" [[gnu::visibility("default")]] CMPIAssociationMI*
SensorElementCapabilitiesProvider_Create_AssociationMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIAssociationMI mi = {nullptr, &assocMIFT__};
    broker = theBroker;
    return &mi;
}

} // namespace Vorn::SensorProfileProvider
