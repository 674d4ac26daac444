// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The factory module's identity in trace lines, whichever of its files they come from.

#pragma once

#include "diagnostics/TracedOperation.h"

#include <string>

namespace Vorn::SensorProfileProvider {

extern const std::string loggerSensorFactory;

inline TraceModule factoryModule()
{
    return {loggerSensorFactory, "SensorFactory"};
}

} // namespace Vorn::SensorProfileProvider
