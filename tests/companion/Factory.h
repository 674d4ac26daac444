// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The factory functions that the library exports.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

extern "C" CMPIInstanceMI* ComputerSystemProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
extern "C" CMPIInstanceMI* SensorRegisteredProfileProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
extern "C" CMPIInstanceMI* SensorElementConformsToProfileProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
extern "C" CMPIAssociationMI* SensorElementConformsToProfileProvider_Create_AssociationMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
