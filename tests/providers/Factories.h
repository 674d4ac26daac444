// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The factory functions that the library exports.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

namespace Testing {
using InstanceFactory = CMPIInstanceMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
using AssociationFactory = CMPIAssociationMI* (*)(const CMPIBroker*, const CMPIContext*,
    CMPIStatus*);
} // namespace Testing

extern "C" {
CMPIInstanceMI* SensorProfileProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
CMPIInstanceMI* SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
CMPIInstanceMI* SensorElementCapabilitiesProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
CMPIAssociationMI* SensorElementCapabilitiesProvider_Create_AssociationMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
CMPIInstanceMI* SensorSystemDeviceProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
CMPIAssociationMI* SensorSystemDeviceProvider_Create_AssociationMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
}
