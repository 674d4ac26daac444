// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The provider of ZUMLO_SensorElementCapabilities, which associates each sensor (role
// ManagedElement) with each capabilities instance (role Capabilities).

#pragma once

#include "providers/AssociationRequests.h"

#include <cmpidt.h>

#include <vector>

namespace Vorn::SensorProfileProvider {

namespace ElementCapabilities {

extern ModuleBroker broker;

AssociationClass served();

} // namespace ElementCapabilities

// Appends every instance of the association, sensor by sensor; an instance that the broker cannot
// make is null or has no handle. Returns 0, or 1 when it failed or there are no sensors. Failures
// are only traced.
int sensorElementCapabilitiesCMPIInstances(
    const CMPIObjectPath* op, const char** properties, std::vector<CMPIInstance*>& out);

CMPIStatus SensorElementCapabilities_EnumInstanceNames(
    CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt, const CMPIObjectPath* op);
CMPIStatus SensorElementCapabilities_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);
CMPIStatus SensorElementCapabilities_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);

CMPIStatus SensorElementCapabilities_Associators(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char* role, const char* resultRole, const char** properties);
CMPIStatus SensorElementCapabilities_AssociatorNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char* role, const char* resultRole);
CMPIStatus SensorElementCapabilities_References(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* resultClass, const char* role,
    const char** properties);
CMPIStatus SensorElementCapabilities_ReferenceNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* resultClass, const char* role);

} // namespace Vorn::SensorProfileProvider
