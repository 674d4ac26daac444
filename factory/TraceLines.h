// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The factory's trace lines: the module they name, whichever of its files writes them, and their
// line numbers. Monitoring scripts match the numbers, so they are an interface and do not follow
// the source. Operations that are not listed carry the line of their source.

#pragma once

#include "diagnostics/TracedOperation.h"

#include <string>

namespace Vorn::SensorProfileProvider {

extern const std::string loggerSensorFactory;

inline TraceModule factoryModule()
{
    return {loggerSensorFactory, "SensorFactory"};
}

namespace FactoryLines {

inline constexpr OperationLines makeSensorInstance = {.entry = 269, .exit = 737};
inline constexpr unsigned possibleStatesFailed = 440;
inline constexpr unsigned operationalStatusFailed = 615;

inline constexpr OperationLines makeCapabilitiesInstance = {.entry = 863, .exit = 965};
inline constexpr OperationLines getAllCapabilitiesInstances = {.entry = 996, .exit = 1017};
inline constexpr OperationLines getOneCapabilitiesInstance = {.entry = 1134, .exit = 1158};
inline constexpr OperationLines getAllCapabilitiesPaths = {.entry = 1041, .exit = 1093};
inline constexpr unsigned getAllCapabilitiesPathsOfNone = 1104;

inline constexpr unsigned targetNameEntry = 1185;
inline constexpr unsigned targetOfSystem = 1205;
inline constexpr unsigned targetOfSensorInSystem = 1221;
inline constexpr unsigned targetOfSensorWithCapabilities = 1236;
inline constexpr unsigned targetOfCapabilities = 1252;
inline constexpr unsigned noTarget = 1259;
inline constexpr OperationLines targetPath = {.entry = 1288, .exit = 1316};

} // namespace FactoryLines

} // namespace Vorn::SensorProfileProvider
