// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes that this library serves and refers to, and the names of its providers, which are the
// components of their broker trace messages.

#pragma once

namespace Vorn::SensorProfileProvider {

inline constexpr const char* SensorClass = "ZUMLO_NumericSensor";
inline constexpr const char* ComputerSystemClass = "ZUMLO_ComputerSystem";
inline constexpr const char* SensorSystemDeviceClass = "ZUMLO_SensorSystemDevice";
inline constexpr const char* SensorEnabledLogicalElementCapClass =
    "ZUMLO_SensorEnabledLogicalElementCapabilities";
inline constexpr const char* SensorElementCapabilitiesClass = "ZUMLO_SensorElementCapabilities";

inline constexpr const char* SensorProfileProvider = "SensorProfileProvider";
inline constexpr const char* SensorEnabledLogicalElementCapabilitiesProvider =
    "SensorEnabledLogicalElementCapabilitiesProvider";
inline constexpr const char* SensorElementCapabilitiesProvider =
    "SensorElementCapabilitiesProvider";
inline constexpr const char* SensorSystemDeviceProvider = "SensorSystemDeviceProvider";

} // namespace Vorn::SensorProfileProvider
