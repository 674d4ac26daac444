// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The factory function that the library exports.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

extern "C" CMPIInstanceMI* ComputerSystemProvider_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*);
