// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The provider of ZUMLO_SensorSystemDevice, which associates each computer system of the object
// manager (role GroupComponent) with each sensor (role PartComponent).

#pragma once

#include "providers/AssociationRequests.h"

#include <cmpidt.h>

#include <vector>

namespace Vorn::SensorProfileProvider {

namespace SystemDevice {

extern ModuleBroker broker;

AssociationClass served();

} // namespace SystemDevice

// Appends every instance of the association, system by system; an instance that the broker cannot
// make is null or has no handle. Returns 0, or 1 when it failed or there is a system but no sensor.
// Failures are only traced.
int sensorSystemDeviceCMPIInstances(const CMPIObjectPath* op, const char** properties,
    const CMPIContext* ctx, std::vector<CMPIInstance*>& out);

CMPIStatus SensorSystemDevice_EnumInstanceNames(
    CMPIInstanceMI* mi, const CMPIContext* ctx, const CMPIResult* rslt, const CMPIObjectPath* op);
CMPIStatus SensorSystemDevice_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);
CMPIStatus SensorSystemDevice_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties);

CMPIStatus SensorSystemDevice_Associators(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char* role, const char* resultRole, const char** properties);
CMPIStatus SensorSystemDevice_AssociatorNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char* role, const char* resultRole);
CMPIStatus SensorSystemDevice_References(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* resultClass, const char* role,
    const char** properties);
CMPIStatus SensorSystemDevice_ReferenceNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* resultClass, const char* role);

} // namespace Vorn::SensorProfileProvider
